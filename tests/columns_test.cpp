#include "dpxlsx/model/columns.h"

#include <algorithm>
#include <functional>
#include <sstream>

#include "dpxlsx/model/host/reference.h"
#include "tests/provider_fixture.h"

// Columns as a host asks for them, from cells filed by hand.
namespace dp {
namespace {

using Basic = IVariable::BasicDataType;
using Options = std::function<void(HandFilledProvider&)>;

constexpr double kMissing = 1.23456e30;

class ColumnsOnDemand : public ProviderTest {
  protected:
    // Files a column of cells separated by "|", from row 0 on.
    static void file(HandFilledProvider& filed, unsigned column, const std::string& cells) {
        std::istringstream codes(cells);
        std::string code;
        for (unsigned row = 0; std::getline(codes, code, '|'); ++row)
            if (!code.empty()) filed.file(row, column, cellOf(code));
    }
    // Starts anew with one worksheet.
    void fileSheet(const std::string& first, const Options& options) {
        provider.ClearWorksheets();
        provider.SetMissingText("", "");
        provider.SetDateTimeVariableFormatHelper(nullptr);
        provider.AddWorksheet("sheet");
        provider.SetWorksheetIndex(0);
        file(provider, 0, first);
        if (options) options(provider);
        provider.GetWorksheetPrimeKeys();
    }
    std::string brief(int key) {
        const ColumnFacts facts = factsOf(provider, key);
        return facts.name + ": " + facts.rows();
    }
};

TEST_F(ColumnsOnDemand, LiesInRowsAsTheHostSays) {
    const Options blank = [](auto& p) { p.SetReadOptionIgnoreBlankRows(true); };
    const Options pad = [](auto& p) { p.SetReadOptionPadColumnsWithMissingValues(true); };
    const Options unpad = [](auto& p) { p.SetReadOptionPadColumnsWithMissingValues(false); };
    const Options limit = [](auto& p) { p.SetReadOptionDataRowCount(1, 3); };
    const Options hide = [](auto& p) { p.SetReadOptionExclude(1, true); };
    const Options show = [](auto& p) { p.SetReadOptionExclude(1, false); };
    const Options hideColumn = [](auto& p) { p.SetReadColumnOptionExclude(1, 2, true); };
    const Options fileLater = [](auto& p) { p.file(9, 0, cellOf("9")); };
    const Options numbers = [](auto& p) { p.SetMissingNumeric(kMissing, -1); };
    const Options codes = [](auto& p) { p.SetAlphaMissingNumeric("NA", -1); };
    const Options texts = [](auto& p) { p.SetMissingText("", "?"); };
    const Options date = [](auto& p) { p.file(0, 9, cellOf("@12")); };
    const Options boolean = [](auto& p) { p.file(0, 9, cellOf("?1")); };
    const auto rows = [](unsigned setting, unsigned name, unsigned data) {
        return [=](auto& p) { p.SetReadOptionDataRowPositions(1, EVariableNameRowSetting{setting}, name, data); };
    };
    const struct {
        std::vector<Options> options;
        std::string expected;
    } cases[] = {
        {{}, "a: 1 * 3 * 5, b: 'x' '' '' '' '' 'y'"},
        {{rows(VNR_GIVEN, 2, 0)}, "1: * 3 * 5, x: '' '' '' '' 'y'"},
        {{rows(VNR_GIVEN, 1, 6)}, "a: 5, b: '' 'y'"},
        {{rows(VNR_NONE, 1, 4)}, ": 3 * 5, : '' '' '' 'y'"},
        {{rows(7, 1, 0)}, ": 'a' '1' '' '3' '' '5', : 'b' 'x' '' '' '' '' 'y'"},
        {{boolean, rows(VNR_INFER, 0, 0)}, "a: 1 * 3 * 5, b: 'x' '' '' '' '' 'y'"},
        {{date, rows(VNR_INFER, 0, 0)}, ": 'a' '1' '' '3' '' '5', : 'b' 'x' '' '' '' '' 'y'"},
        {{limit}, "a: 1 * 3, b: 'x'"},
        {{blank}, "a: 1 3 5, b: 'x' '' '' 'y'"},
        {{blank, limit}, "a: 1 3, b: 'x'"},
        {{pad}, "a: 1 * 3 * 5 *, b: 'x' '' '' '' '' 'y'"},
        {{pad, blank}, "a: 1 3 5 *, b: 'x' '' '' 'y'"},
        {{hideColumn, pad, blank}, "a: 1 3 5, : "},
        {{hide, blank, show}, "a: 1 3 5, b: 'x' '' '' 'y'"},
        {{pad, fileLater}, "a: 1 * 3 * 5 *, b: 'x' '' '' '' '' 'y'"},
        {{pad, fileLater, blank, unpad}, "a: 1 3 5 * * * 9, b: 'x' '' '' 'y'"},
        {{pad, numbers, texts}, "a: 1 -1 3 -1 5 *, b: 'x' '?' '?' '?' '?' 'y'"},
        {{numbers, codes}, "a: 1 * 3 * 5, b: 'x' '' '' '' '' 'y'"},
    };
    for (const auto& [options, expected] : cases) {
        fileSheet("'a|1||3||5", [&options = options](HandFilledProvider& p) {
            file(p, 1, "'b|'x|||||'y");
            for (const Options& option : options) option(p);
        });
        EXPECT_EQ(brief(1) + ", " + brief(2), expected) << "case " << &expected - &cases->expected;
    }
}

// An excluded column may have cells in rows that count as blank. Its gaps then have slots that texts already occupy,
// and fill over them.
TEST_F(ColumnsOnDemand, FillsTheGapsOfExcludedColumnsFromTheRowsThatCount) {
    fileSheet("'p||'q|||'r", [](HandFilledProvider& p) {
        file(p, 1, "|1||3|4|5|6|7");
        p.SetReadOptionDataRowPositions(1, VNR_NONE, 0, 1);
        p.SetReadColumnOptionExclude(1, 1, true);
        p.SetReadOptionIgnoreBlankRows(true);
        p.SetReadOptionPadColumnsWithMissingValues(true);
    });
    EXPECT_EQ(factsOf(provider, 1, ColumnType::Automatic, true).rows(), "'p' '' '' '' '' 'r'");
}

TEST_F(ColumnsOnDemand, HandlesBlankRowsForProvidersThatLoadThemselves) {
    const Options numbers = [](auto& p) { p.SetMissingNumeric(kMissing, -1); };
    const Options others = [](auto& p) { p.SetMissingNumeric(-99, -1); };
    const Options words = [](auto& p) { p.SetAlphaMissingNumeric("NA", -1); };
    const Options blank = [](auto& p) { p.SetReadOptionIgnoreBlankRows(true); };
    const struct {
        const char* name;
        std::vector<Options> options;
        unsigned rowCount, slots;
        std::vector<double> values;
    } cases[] = {{"other numbers are replaced", {others}, 5, 3, {9, 9, 9, 9, 9}},
                 {"missing numbers are replaced", {numbers}, 5, 3, {9, -1, -1, -1, 9}},
                 {"up to the last row", {numbers}, 3, 3, {9, -1, -1, 9, 9}},
                 {"not with a missing word", {numbers, words}, 5, 3, {9, 9, 9, 9, 9}},
                 {"blank rows have no slot", {numbers, blank}, 5, 1, {9, -1, 9, 9, 9}}};
    for (const auto& [name, options, rowCount, slots, values] : cases) {
        fileSheet("'n|1||||5", [&options = options](HandFilledProvider& p) {
            file(p, 1, "'m|||'x");
            for (const Options& option : options) option(p);
        });
        NumericColumn column;
        column.values.reset(new double[values.size()]);
        std::fill_n(column.values.get(), values.size(), 9);
        const CellColumn& cells = provider._cells[0].begin()->second;
        EXPECT_EQ(provider.HandleBlankRows(&column, 1, 2, rowCount, cells.find(5)), slots) << name;
        EXPECT_EQ(std::vector(column.values.get(), column.values.get() + values.size()), values) << name;
    }
}

TEST_F(ColumnsOnDemand, TakesItsKindFromItsFirstCell) {
    const auto type = [](Basic kind) { return [kind](auto& p) { p.SetReadColumnOptionColumnType(1, 1, kind); }; };
    const Options none;
    const Options helped = [](auto& p) {
        p.SetReadColumnOptionColumnType(1, 1, Basic::DateTime);
        p.SetDateTimeVariableFormatHelper(new HandHelper);
    };
    const Options toText = [](auto& p) { p.SetReadOptionConvertDateTimeToText(true); };
    const Options number = [](auto& p) { p.SetMissingNumeric(-99, kMissing); };
    const Options code = [](auto& p) {
        p.SetMissingNumeric(7, 0);
        p.SetAlphaMissingNumeric("NA", -5);
    };
    const Options clean = [](auto& p) {
        p.SetReadOptionCleanTextValues(true);
        p.SetMissingText("NA", "none");
    };
    const struct {
        const char* cells;
        Options options;
        std::string expected;  // format, data type, converted cells, values
    } cases[] = {
        {"|'a|1.5|1.5f|?1|i12", none, "text 12 4 0: 'a' '1.5' '1.50' 'TRUE' '          12'"},
        {"|1|' 12.5 |'abc|?-1|i7", none, "auto numeric 0.0 0 1: 1 12.5 * -1 7"},
        {"|?0|2f", none, "auto numeric 0.0 0 0: 0 2"},
        {"|2e18|2f", none, "numeric 0.2 0 1: * 2"},
        {"|1.001e18|-1.001e18|1.0011e18", none, "auto numeric 0.0 0 1: 1.001e+18 -1.001e+18 *"},
        {"|@3|4|'d5", none, "auto date-time M/d/yyyy 2 1: 3 4 *"},
        {"|@25569|@0.5t", toText, "text 8 4 0: '1/1/1970' '12:00'"},
        {"|1|@3", toText, "auto numeric 0.0 0 1: 1 *"},
        {"|1|0.5%", type(Basic::Text), "text 3 4 0: '1' '50%'"},
        {"|@3|'4", type(Basic::Numeric), "auto numeric 0.0 0 0: 3 4"},
        {"|@3n|'4", type(Basic::DateTime), "auto date-time  2 1: 3 *"},
        {"|'d5|@3|'d5|-1", helped, "auto date-time  2 1: 5 3 5 *"},
        {"|@3|'d5|'5", helped, "auto date-time M/d/yyyy 2 1: 3 5.008 *"},
        {"|1|-99", number, "auto numeric 0.0 0 1: 1 *"},
        {"|1|'NA|7", code, "auto numeric 0.0 0 1: 1 -5 7"},
        {"|' a\t  b |'   |'NA", clean, "text 4 4 0: 'a b' '' 'none'"},
        {"|'a|1.23456e30", none, "text 1 4 0: 'a' '*'"},
    };
    for (const auto& [cells, options, expected] : cases) {
        fileSheet(cells, options);
        const ColumnFacts facts = factsOf(provider, 1);
        const std::string numbers = " " + std::to_string(facts.dataType) + " " + std::to_string(facts.converted);
        EXPECT_EQ(facts.format + numbers + ": " + facts.rows(), expected) << cells;
    }
}

TEST_F(ColumnsOnDemand, BearsACleanName) {
    const struct {
        std::string cell;
        unsigned limit;
        std::string name;
    } cases[] = {{"'#Sales 'Q1'\n", 0xFFFFFFFF, "_Sales _Q1_"},
                 {"'*x", 99, "_x"},
                 {"'x*", 99, "x*"},
                 {"'a\tb", 99, "a_b"},
                 {"'R\u00E9sum\u00E9", 3, "R\u00E9s"},
                 {"'abc", 0x10002, "ab"},
                 {"0.5%", 99, "50%"},
                 {"'" + std::string(100, 'n'), 99, std::string(80, 'n')}};
    for (const auto& [cell, limit, name] : cases) {
        fileSheet(cell, {});
        provider.SetMaxVariableNameLength(limit);
        EXPECT_EQ(factsOf(provider, 1).name, name);
    }
    provider.SetReadColumnOptionName(1, 1, " 'given' ");
    EXPECT_EQ(factsOf(provider, 1).name, "_given_");
}

TEST_F(ColumnsOnDemand, AnswersToKeysOverAllWorksheets) {
    const auto keysOf = [this](int worksheet) {
        std::string keys;
        const auto* listed = provider.GetColumnPrimeKeys(worksheet);
        for (unsigned long i = 0; i < listed->Count(); ++i) keys += " " + std::to_string(listed->Item(i));
        return keys;
    };
    fileSheet("|1", [](HandFilledProvider& p) { p.file(1, 7, cellOf("2")); });
    provider.AddWorksheet("second");
    EXPECT_EQ(keysOf(1) + keysOf(2), " 1 2");
    provider.SetWorksheetIndex(1);
    file(provider, 4, "|5");
    file(provider, 2, "|4");
    provider.AddWorksheet("third");
    provider.SetWorksheetIndex(2);
    file(provider, 0, "|6");
    EXPECT_EQ(keysOf(3), " 5");
    provider.SetWorksheetIndex(0);
    file(provider, 3, "|3");  // moves all later keys
    provider.GetWorksheetPrimeKeys();
    EXPECT_EQ(keysOf(1) + "," + keysOf(2) + keysOf(0) + keysOf(3) + keysOf(-1), " 1 2 3, 4 5 6");
    std::string values;
    for (int key = -1; key < 8; ++key) values += factsOf(provider, key).rows();
    EXPECT_EQ(values, "132456");

    provider.SetReadColumnOptionDestinationId(2, 5, 9);
    provider.SetReadColumnOptionExclude(2, 5, true);
    EXPECT_FALSE(factsOf(provider, 5).found);
    EXPECT_EQ(factsOf(provider, 5, ColumnType::Automatic, true).position, 9);
    EXPECT_TRUE(provider.FindColumn(4, nullptr, ColumnType::Automatic, nullptr, false));

    provider.RemoveWorksheet(0);
    EXPECT_EQ(keysOf(1) + keysOf(2) + keysOf(3), " 1 2 3");
    EXPECT_EQ(factsOf(provider, 1).rows(), "4");
    IColumn* column = nullptr;
    ASSERT_TRUE(provider.GetVariableFinder()->FindColumn(2, &column, true));
    EXPECT_EQ(Reference(column)->GetPrimeKey(), 2);
    provider.ClearWorksheets();
    EXPECT_FALSE(factsOf(provider, 1).found);
}

TEST_F(ColumnsOnDemand, KeepsTheRegistryThroughRemovals) {
    for (const char* name : {"a", "b", "c"}) provider.AddWorksheet(name);
    for (const int position : {-1, 3, 99}) {
        provider.RemoveWorksheet(position);
        provider.SetWorksheetIndex(position);
        provider.file(0, 0, cellOf("1"));
    }
    for (int position = 0; position < 3; ++position) {
        provider.SetWorksheetIndex(position);
        provider.file(1, 0, cellOf(std::to_string(position)));
    }
    provider.GetWorksheetPrimeKeys();
    EXPECT_EQ(brief(3), ": 2");
    provider.RemoveWorksheet(1);
    EXPECT_EQ(provider.GetColumnPrimeKeys(2)->Count() + provider.GetWorksheetRowCount(2), 0U) << "no such key";
    EXPECT_EQ(provider.GetWorksheetPosition(3), 1U);
    EXPECT_EQ(brief(2), ": 2");
    provider.AddWorksheet("d");
    EXPECT_EQ(provider.GetWorksheetPrimeKey(2), 4) << "never a key in use";
}

// A provider that was used in every way and then cleared must show a workbook as a new provider does.
TEST_F(ColumnsOnDemand, ForgetsEverythingWithItsWorksheets) {
    const auto shown = [](HandFilledProvider& p) {
        std::ostringstream out;
        out << p.IsPreviewing() << p.GetWriteOptionVariableNames() << p.GetError();
        out << (p.GetMissingNumericFrom() == kMissing && p.GetMissingNumericTo() == kMissing) << ", ";
        p.AddWorksheet("S:1");
        p.file(9, 9, cellOf("9"));  // goes nowhere: no worksheet was selected
        p.SetWorksheetIndex(0);
        file(p, 0, "'name|1||3||'NA");
        file(p, 1, "'d|@3");
        file(p, 2, "'t|'a  b");
        IWorksheet* worksheet = nullptr;
        for (unsigned long n = p.GetWorksheetPrimeKeys()->Count(); n > 0 && p.FindWorksheet(1, &worksheet); n = 0)
            out << Reference(worksheet)->GetTitle();
        const auto columns = [&] {
            p.GetWorksheetPrimeKeys();
            for (int key = 1; key <= 3; ++key) out << ", " << factsOf(p, key).name << ": " << factsOf(p, key).rows();
        };
        columns();
        p.SetMissingNumeric(kMissing, -1);
        columns();
        p.SetReadOptionPadColumnsWithMissingValues(true);
        p.SetReadOptionIgnoreBlankRows(true);
        columns();
        return out.str();
    };
    const std::string expected =
        "0101, S:1, name: 1 * 3 * *, d: 3, t: 'a  b', name: 1 -1 3 -1 -1, d: 3, t: 'a  b', name: 1 3 -1, d: 3 * *, "
        "t: 'a  b' '' ''";
    EXPECT_EQ(shown(provider), expected);

    provider.RemoveWorksheet(0);
    provider.SetReadOptionCleanTextValues(true);
    provider.SetReadOptionCleanWorksheetNames(true);
    provider.SetReadOptionConvertDateTimeToText(true);
    provider.SetReadOptionDefaultUseVariableNameRow(VNR_NONE);
    provider.AddWorksheet("a");
    provider.AddWorksheet("b");
    provider.SetWorksheetIndex(0);
    file(provider, 3, "1||2");
    const auto* worksheets = provider.GetWorksheetPrimeKeys();
    const auto* columns = provider.GetColumnPrimeKeys(1);
    EXPECT_EQ(worksheets->Count() + columns->Count(), 3U);
    provider.SetReadOptionDataRowPositions(1, VNR_NONE, 0, 2);
    provider.SetReadColumnOptionName(1, 1, "given");
    provider.SetMaxVariableNameLength(2);
    provider.SetWriteOptionVariableNames(false);
    provider.SetMissingNumeric(1, 2);
    provider.SetAlphaMissingNumeric("NA", 3);
    provider.SetPreviewing(true);
    provider.SetError(5);
    provider.ClearWorksheets();
    EXPECT_EQ(worksheets->Count() + columns->Count(), 0U);
    provider.SetMissingValue(-9);
    provider.ClearWorksheets();
    provider.SetMissingValue(kMissing);
    EXPECT_EQ(shown(provider), expected);
}

TEST_F(ColumnsOnDemand, GivesAKeyOutAgainWithoutItsRows) {
    fileSheet("'a|1", [](auto& p) {
        p.SetReadOptionPadColumnsWithMissingValues(true);
        p.SetReadOptionIgnoreBlankRows(true);
    });
    provider.RemoveWorksheet(0);
    provider.AddWorksheet("again");
    file(provider, 0, "'b||2|3");
    file(provider, 1, "'c");
    provider.GetWorksheetPrimeKeys();
    EXPECT_EQ(brief(1) + ", " + brief(2), "b: 2 3, c: * *");
    provider.SetReadOptionExclude(1, true);
    provider.SetReadOptionIgnoreBlankRows(false);
    provider.SetReadOptionIgnoreBlankRows(true);
    provider.SetReadOptionExclude(1, false);
    EXPECT_EQ(brief(1), "b: 2 3") << "found when the worksheet is shown again";
    provider.SetReadOptionIgnoreBlankRows(false);
    EXPECT_EQ(brief(1), "b: * 2 3");
    file(provider, 1, "|1");
    provider.SetReadOptionIgnoreBlankRows(true);
    EXPECT_EQ(brief(1), "b: * 2 3") << "the blank rows are those at the time of the call";
}

TEST_F(ColumnsOnDemand, TakesItsOwnAnswersAsArguments) {
    struct Counted : HandHelper {
        explicit Counted(int& count) : deleted(count) {}
        ~Counted() override { ++deleted; }
        int& deleted;
    };
    int deleted = 0;
    provider.SetDateTimeVariableFormatHelper(new Counted(deleted));
    provider.SetDateTimeVariableFormatHelper(provider.GetDateTimeVariableFormatHelper());
    EXPECT_EQ(deleted, 0);
    provider.SetDateTimeVariableFormatHelper(nullptr);
    EXPECT_EQ(deleted, 1);
    provider.SetMissingText("from", "to");
    provider.SetMissingText(provider.GetMissingTextTo(), provider.GetMissingTextFrom());
    EXPECT_EQ(std::string(provider.GetMissingTextFrom()) + provider.GetMissingTextTo(), "tofrom");
}

TEST_F(ColumnsOnDemand, ConvertsAPreviewAndAsksForAFormatOnceAStyle) {
    fileSheet("'n", [](HandFilledProvider& p) {
        for (unsigned row = 1; row <= 500; ++row)
            p.file(row, 0, cellOf("@" + std::to_string(row) + (row % 2 ? "t" : "")));
    });
    provider.formatsMade = 0;
    EXPECT_EQ(factsOf(provider, 1, ColumnType::Text).missing, 0);
    EXPECT_EQ(provider.formatsMade, 2);
    provider.SetPreviewing(true);
    const std::vector<double> numbers = factsOf(provider, 1).values;
    EXPECT_EQ(numbers[100], 101);
    EXPECT_EQ(std::count(numbers.begin(), numbers.end(), kMissing), 399);
    EXPECT_EQ(factsOf(provider, 1, ColumnType::Text).missing, 399);
}

TEST_F(ColumnsOnDemand, BearsRowsBeyondEverySheet) {
    fileSheet("|1", [](HandFilledProvider& p) {
        p.file(0xFFFFFFFE, 0, cellOf("2"));
        p.SetReadOptionIgnoreBlankRows(true);
    });
    EXPECT_EQ(provider.GetWorksheetRowCount(1), 0xFFFFFFFFU);
    EXPECT_EQ(provider._blankRows[1].size(), 0xFFFFFFFDU);
    EXPECT_EQ(brief(1), ": ") << "more rows than a host can count";
    EXPECT_EQ(factsOf(provider, 1, ColumnType::Text).rows(), "");
    provider.SetReadOptionDataRowCount(1, 5);
    EXPECT_EQ(brief(1), ": 1");
    provider.SetReadOptionIgnoreBlankRows(false);
    provider.SetReadOptionDataRowPositions(1, VNR_NONE, 0, 0xFFFFFFFE);
    EXPECT_EQ(brief(1), ": * 2");

    // The first data row is so far below the cells that their difference, as a signed number, wraps to a positive one.
    fileSheet("|1", [](auto& p) { p.SetReadOptionDataRowPositions(1, VNR_NONE, 0, 0x90000000); });
    EXPECT_EQ(brief(1), ": ");
    EXPECT_EQ(factsOf(provider, 1, ColumnType::Text).rows(), "");
}

}  // namespace
}  // namespace dp
