#include <functional>
#include <map>

#include <gmock/gmock.h>

#include "dpxlsx/formats/date_time_variable_format.h"
#include "dpxlsx/model/host/entry_points.h"
#include "dpxlsx/provider/xlsx_data_provider.h"
#include "tests/abi.h"
#include "tests/provider_fixture.h"

// The provider as a separately compiled host sees it: its operations are called by their slots.
namespace {

using namespace raw;
using Settings = dp::ExcelDataProviderBase;  // for the exported settings of the process alone

const Contract kProvider = contractOf("Provider");

// The memory layout of a cell record as hosts and readers know it.
struct RawCell {
    std::uint32_t type = 0;
    std::int32_t intValue = 0;
    std::int32_t boolValue = 0;
    double numValue = 0.0;
    std::string textValue;
    std::int32_t formatIndex = -1;
};
struct RawRecord {
    std::uint32_t reserved0 = 0;
    std::uint32_t reserved1 = 0;
    std::uint32_t row = 0;
    std::uint32_t column = 0;
    RawCell cell;
};
using Cell = dp::ExternalDataRecordCell;
static_assert(sizeof(RawRecord) == sizeof(dp::ExternalDataRecord) && offsetof(Cell, intValue) == 4 &&
              offsetof(Cell, boolValue) == 8 && offsetof(dp::ExternalDataRecord, reserved1) == 4);

class ProviderContract : public testing::Test {
  protected:
    void SetUp() override {
        dp::IDataProvider* made = nullptr;
        ASSERT_EQ(dp::CreateDataProvider("xlsx", &made), 0);
        provider = made;
        EXPECT_EQ(op<unsigned>("AddRef"), 1U);
    }
    void TearDown() override { op<void>("Release"); }

    template <class Result, class... Arguments>
    Result op(std::string_view name, Arguments... arguments) {
        return call<Result>(provider, slotOf(kProvider, name), arguments...);
    }

    void file(unsigned row, unsigned column, RawCell cell) {
        const RawRecord record{0, 0, row, column, std::move(cell)};
        op<void>("AddExternalDataRecord", &record);
    }
    // Files a worksheet with a numeric and a text column, names in the first row, and a blank third row.
    void fileWorksheet(const char* name) {
        op<void>("AddWorksheet", name);
        op<void>("SetWorksheetIndex", 0);
        file(0, 0, {5, 0, 0, 0.0, "n", -1});
        file(0, 1, {5, 0, 0, 0.0, "t", -1});
        file(1, 0, {4, 0, 0, 1.5, "", -1});
        file(3, 0, {4, 0, 0, 2.5, "", -1});
        file(1, 1, {5, 0, 0, 0.0, "a  b", -1});
    }
    // The settings of the process, as the provider's getters return them.
    static std::string processSettings() {
        std::ostringstream out;
        out << Settings::GetMissingValue() << ' ' << Settings::GetMissingValueTextRepresentation() << ' '
            << Settings::GetNumericMinimumValue() << ' ' << Settings::GetNumericMaximumValue() << ' '
            << Settings::GetNumericMaximumInt() << ' ' << Settings::GetMaximumTextLength() << ' '
            << Settings::GetInputDecimal() << ' ' << Settings::GetOutputDecimal() << ' '
            << Settings::GetOutputGroupingSymbol() << ' ' << Settings::GetBooleanTrueValue() << ' '
            << Settings::GetBooleanFalseValue();
        return out.str();
    }
    unsigned long count(const void* collection) { return call<unsigned long>(collection, 2); }
    int item(const void* collection, unsigned long index) { return call<int>(collection, 3, index); }
    // A column's name and rows, read through its slots.
    std::string describe(void* column) {
        const char* name = call<const char*>(call<void*>(column, 6), 2);
        std::string text = std::string(name) + "/" + std::to_string(call<int>(column, 10));
        call<unsigned>(column, 2);
        call<void>(column, 3);
        return text;
    }
    std::string columnThrough(std::string_view operation) {
        void* column = nullptr;
        int format = -1;
        bool found = false;
        if (operation == "FindColumn")
            found = op<bool>(operation, 1, &column, false);
        else
            found = op<bool>(operation, 1, &column, 0, &format, false);
        return found ? describe(column) : "none";
    }

    void* provider = nullptr;
};

TEST_F(ProviderContract, WriteSideIsRefused) {
    for (std::size_t slot = 7; slot <= 27; ++slot) EXPECT_EQ(call<long>(provider, slot, nullptr), -50) << slot;
    EXPECT_EQ(op<void*>("GetDOEReader"), nullptr);
    EXPECT_EQ(op<long>("RereadFile"), -1);
    const auto bytes = [this] { return std::string(static_cast<const char*>(provider), sizeof(dp::xlsxDataProvider)); };
    const std::string before = bytes() + processSettings();
    for (const char* ignored :
         {"SetFieldDelimiter", "SetTextDelimiter", "SetDecimalSeparator", "SetReadOptionFoldTextValues",
          "SetInferFormatPolicy", "SetUnitTesting", "SetTestNoTempFile", "RegisterSharedVariableBody"})
        for (const int argument : {1, 0}) {
            op<void>(ignored, argument, nullptr);
            EXPECT_TRUE(bytes() + processSettings() == before) << ignored;
        }
}

TEST_F(ProviderContract, SettingsLandWhereTheyBelong) {
    const testkit::KeptSettings kept;
    EXPECT_EQ(processSettings(), "1.23456e+30 * -1.001e+18 1.001e+18 2.147e+09 80 . . , TRUE FALSE");
    op<void>("SetMissingValue", -99.0);
    EXPECT_EQ(op<double>("GetMissingVxlValue"), -99.0);
    op<void>("SetMissingValueTextRepresentation", "?");
    op<void>("SetNumericRange", -1.0, 1.0);
    op<void>("SetMaximumTextLength", 7);
    op<void>("SetInputDecimal", 'i');
    op<void>("SetOutputDecimal", 'o');
    op<void>("SetOutputGroupingSymbol", 'g');
    op<void>("SetBooleanTrueValue", "yes");
    op<void>("SetBooleanFalseValue", "no");
    EXPECT_EQ(processSettings(), "-99 ? -1 1 2.147e+09 7 i o g yes no");
    for (const char* setter : {"SetMissingValueTextRepresentation", "SetBooleanTrueValue", "SetBooleanFalseValue"})
        op<void>(setter, nullptr);  // counts as the empty text
    EXPECT_EQ(processSettings(), "-99  -1 1 2.147e+09 7 i o g  ");
    op<void>("SetWriteOptionVariableNames", false);
    EXPECT_FALSE(op<bool>("GetWriteOptionVariableNames"));
    op<void>("SetMissingText", "from", "to");
    EXPECT_STREQ(op<const char*>("GetMissingTextFrom"), "from");
    EXPECT_STREQ(op<const char*>("GetMissingTextTo"), "to");
    op<void>("SetMissingNumeric", 1.0, 2.0);
    EXPECT_EQ(op<double>("GetMissingNumericFrom"), 1.0);
    EXPECT_EQ(op<double>("GetMissingNumericTo"), 2.0);
    op<void>("SetAlphaMissingNumeric", "NA", 3.0);
    EXPECT_STREQ(op<const char*>("GetAlphaMissingNumericFrom"), "NA");
    EXPECT_EQ(op<double>("GetMissingNumericTo"), 3.0);
    op<void>("SetPreviewing", true);
    EXPECT_TRUE(op<bool>("IsPreviewing"));
    EXPECT_EQ(op<int>("GetPreviewNumberOfRows"), 100);
    EXPECT_EQ(op<int>("GetPreviewNumberOfColumns"), 100);
    op<void>("SetError", 5L);
    EXPECT_EQ(op<long>("GetError"), 5L);
    auto* helper = new dp::DateTimeVariableFormat;
    op<void>("SetDateTimeVariableFormatHelper", static_cast<void*>(helper));
    EXPECT_EQ(op<void*>("GetDateTimeVariableFormatHelper"), helper);
    op<void>("ClearWorksheets");
    EXPECT_FALSE(op<bool>("IsPreviewing"));
    EXPECT_EQ(op<long>("GetError"), 0L);
    EXPECT_EQ(op<void*>("GetDateTimeVariableFormatHelper"), helper);
}

TEST_F(ProviderContract, FilesAreOpenedAndClosed) {
    std::vector<std::string> names;
    EXPECT_EQ(op<long>("GetWorksheets", "nowhere.xlsx", &names), -17);
    EXPECT_EQ(op<long>("OpenFile", "nowhere.xlsx", 0), -17);
    EXPECT_EQ(op<long>("OpenFile", "nowhere.xlsx", 1), -1);
    EXPECT_EQ(op<long>("CloseFile"), 0);
    EXPECT_EQ(op<std::string>("GetTempDirectoryPath"), "");
}

TEST_F(ProviderContract, EverySlotHoldsItsOperation) {
    const std::map<std::string, std::string> overloads = {
        {"AddWorksheetObject", "AddWorksheet(dp::IWorksheet*)"},
        {"AddWorksheet", "AddWorksheet(char const*)"},
        {"AddNumericColumn", "AddColumn(dp::INumericColumn*)"},
        {"AddTextColumn", "AddColumn(dp::ITextColumn*)"},
        {"AddNumericConstant", "AddConstant(dp::INumericConstant*)"},
        {"AddTextConstant", "AddConstant(dp::ITextConstant*)"},
        {"FindColumn", "FindColumn(int, dp::IColumn**, bool) const"},
        {"FindColumnOfStorage",
         "FindColumn(int, dp::IColumn**, dp::IVariable::StorageType, "
         "dp::IVariableFormat::FormatType*, bool) const"},
        {"FindColumnOfType",
         "FindColumn(int, dp::IColumn**, dp::ColumnType, dp::IVariableFormat::FormatType*, bool) const"}};
    // The finders are bases with tables of their own, which repeat a range of the provider's slots.
    struct Table {
        std::size_t offset;
        std::string first, last;
    };
    for (const Table& table : {Table{0, "AddRef", kProvider.slots.back()},
                               {8, "GetWorksheetPrimeKeys", "FindWorksheet"},
                               {16, "GetColumnPrimeKeys", "RegisterSharedVariableBody"}})
        for (std::size_t i = slotOf(kProvider, table.first), slot = 2; i <= slotOf(kProvider, table.last);
             ++i, ++slot) {
            const auto overload = overloads.find(kProvider.slots[i]);
            const std::string expected = overload == overloads.end() ? kProvider.slots[i] + "(" : overload->second;
            const void* facet = static_cast<const char*>(provider) + table.offset;
            EXPECT_THAT(operationsIn(facet, slot), testing::Contains(testing::StartsWith(expected)))
                << table.offset << ' ' << slot;
        }
}

TEST_F(ProviderContract, WorksheetsAndColumnsComeThroughEveryRoad) {
    fileWorksheet("S:1");
    EXPECT_EQ(op<unsigned>("GetWorksheetRowCount", 1U), 4U);
    EXPECT_EQ(op<unsigned>("GetColumnCount", 0), 0U);
    EXPECT_EQ(op<void*>("GetColumn", 0, 0), nullptr);

    void* worksheets = op<void*>("GetWorksheetFinder");
    void* variables = op<void*>("GetVariableFinder");
    EXPECT_EQ(worksheets, static_cast<char*>(provider) + 8);
    EXPECT_EQ(variables, static_cast<char*>(provider) + 16);
    EXPECT_EQ(count(op<void*>("GetWorksheetPrimeKeys")), 1UL);
    EXPECT_EQ(item(call<void*>(worksheets, 2), 0), 1);
    void* sheet = nullptr;
    ASSERT_TRUE(op<bool>("FindWorksheet", 1, &sheet));
    EXPECT_EQ(*call<const std::string*>(sheet, 6), "S:1");
    call<unsigned>(sheet, 2);
    call<void>(sheet, 3);
    EXPECT_FALSE(call<bool>(worksheets, 3, 2, &sheet));

    EXPECT_EQ(count(op<void*>("GetColumnPrimeKeys", 1)), 2UL);
    EXPECT_EQ(item(call<void*>(variables, 2, 1), 1), 2);
    for (const char* road : {"FindColumn", "FindColumnOfStorage", "FindColumnOfType"})
        EXPECT_EQ(columnThrough(road), "n/3") << road;
    void* column = nullptr;
    ASSERT_TRUE(call<bool>(variables, 6, 1, &column, false));
    EXPECT_EQ(describe(column), "n/3");
    int format = -1;
    ASSERT_TRUE(call<bool>(variables, 7, 2, &column, 1, &format, false));
    EXPECT_EQ(format, 2);
    EXPECT_EQ(describe(column), "t/1");

    for (const char* keys : {"GetConstantPrimeKeys", "GetMatrixPrimeKeys", "GetModelPrimeKeys"})
        EXPECT_EQ(count(op<void*>(keys, 1, 1)), 0UL) << keys;
    for (std::size_t slot = 3; slot <= 5; ++slot) EXPECT_EQ(count(call<void*>(variables, slot, 1, 1)), 0UL) << slot;
    for (std::size_t slot = 8; slot <= 11; ++slot) {
        EXPECT_FALSE(call<bool>(variables, slot, 1, &sheet)) << slot;
        EXPECT_FALSE(call<bool>(provider, slot + 90, 1, &sheet)) << slot;
    }
    call<void>(variables, 12, 1, nullptr);

    op<void>("RemoveWorksheet", 0);
    EXPECT_EQ(count(op<void*>("GetWorksheetPrimeKeys")), 0UL);
}

TEST_F(ProviderContract, ReadOptionsTakeEffect) {
    struct Case {
        const char* name;
        std::function<void()> set;
        const char* expected;
    };
    const std::vector<Case> cases = {
        {"SetReadOptionIgnoreBlankRows", [&] { op<void>("SetReadOptionIgnoreBlankRows", true); }, "n/2 t/1"},
        {"SetReadOptionPadColumnsWithMissingValues",
         [&] { op<void>("SetReadOptionPadColumnsWithMissingValues", true); }, "n/3 t/3"},
        {"SetReadOptionDataRowPositions", [&] { op<void>("SetReadOptionDataRowPositions", 1U, 0, 0U, 4U); }, "/1 /0"},
        {"SetReadOptionDefaultUseVariableNameRow", [&] { op<void>("SetReadOptionDefaultUseVariableNameRow", 0); },
         "/4 /2"},
        {"SetReadOptionDataRowCount", [&] { op<void>("SetReadOptionDataRowCount", 1U, 2U); }, "n/1 t/1"},
        {"SetReadOptionExclude", [&] { op<void>("SetReadOptionExclude", 1U, true); }, ""},
        {"SetReadColumnOptionExclude", [&] { op<void>("SetReadColumnOptionExclude", 1U, 2U, true); }, "n/3 none"},
        {"SetReadColumnOptionName", [&] { op<void>("SetReadColumnOptionName", 1U, 2U, "x"); }, "n/3 x/1"},
        {"ClearReadColumnOptions",
         [&] {
             op<void>("SetReadColumnOptionName", 1U, 2U, "x");
             op<void>("ClearReadColumnOptions");
         },
         "n/3 t/1"},
        {"SetMaxVariableNameLength",
         [&] {
             op<void>("SetReadColumnOptionName", 1U, 1U, "long");
             op<void>("SetMaxVariableNameLength", 2U);
         },
         "lo/3 t/1"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.name);
        op<void>("ClearWorksheets");
        fileWorksheet("S");
        c.set();
        std::string columns;
        const void* sheets = op<void*>("GetWorksheetPrimeKeys");
        for (int key = 1; count(sheets) == 1 && key <= 2; ++key) {
            void* column = nullptr;
            if (key > 1) columns += ' ';
            columns += op<bool>("FindColumn", key, &column, false) ? describe(column) : "none";
        }
        EXPECT_EQ(columns, c.expected);
    }
}

TEST_F(ProviderContract, ColumnAndTextOptionsTakeEffect) {
    op<void>("SetReadOptionCleanWorksheetNames", true);
    fileWorksheet("S:1");
    void* sheet = nullptr;
    ASSERT_TRUE(op<bool>("FindWorksheet", 1, &sheet));
    EXPECT_EQ(*call<const std::string*>(sheet, 6), "S_1");
    call<unsigned>(sheet, 2);
    call<void>(sheet, 3);
    op<void>("GetWorksheetPrimeKeys");

    op<void>("SetReadColumnOptionColumnType", 1U, 1U, 2);
    op<void>("SetReadColumnOptionDestinationId", 1U, 1U, 9U);
    void* column = nullptr;
    ASSERT_TRUE(op<bool>("FindColumn", 1, &column, false));
    EXPECT_EQ(call<int>(column, 4), 4) << "a text column now";
    EXPECT_EQ(call<int>(static_cast<char*>(column) + 8, 10), 9) << "its position";
    describe(column);

    const RawCell text{5, 0, 0, 0.0, "a  b", -1};
    op<void>("SetReadOptionCleanTextValues", true);
    EXPECT_EQ(op<std::string>("ConvertCellToString", &text, false), "a b");
    const RawCell number{4, 0, 0, 2.5, "", -1};
    EXPECT_EQ(op<std::string>("ConvertNumericCellToString", &number), "2.5");
    void* format = op<void*>("CreateVextralNumericFormat", &number);
    EXPECT_TRUE(call<bool>(format, 3)) << "automatic without an open file";
    call<void>(format, 1);
    EXPECT_FALSE(op<bool>("IsDateTimeFormatType", &number));

    file(1, 2, {8, 0, 0, 40179.0, "", -1});
    op<void>("SetReadOptionConvertDateTimeToText", true);
    ASSERT_TRUE(op<bool>("FindColumn", 3, &column, false));
    EXPECT_EQ(call<int>(column, 15), 1) << "a date becomes missing in a numeric column";
    describe(column);
}

}  // namespace
