#include <functional>
#include <initializer_list>
#include <random>
#include <utility>

#include "tests/naive_columns.h"

// Random worksheets and random calls of a host, made to the provider and to the naive model, whose results must agree.
// A failing round prints its seed.
namespace dp {
namespace {

class Round {
  public:
    explicit Round(unsigned seed) : random_(seed) {}

    void run() {
        for (unsigned sheets = 1 + below(3); sheets-- > 0;) fileWorksheet();
        if (below(6) == 0) {
            provider_.RemoveWorksheet(0);
            naive_.sheets.erase(naive_.sheets.begin());
        }
        for (const unsigned calls : {below(14), below(4)}) {
            for (unsigned i = 0; i < calls; ++i) change();
            if (below(8)) compareWorksheets();
            compareColumns();
        }
    }

  private:
    unsigned below(unsigned bound) { return static_cast<unsigned>(random_() % bound); }
    bool coin() { return below(2) == 0; }
    template <typename Value>
    Value oneOf(std::initializer_list<Value> values) {
        return values.begin()[below(static_cast<unsigned>(values.size()))];
    }

    std::string anyText() {
        return oneOf<std::string>({"", " ", "  a  b ", " 12.5 ", "(3)", "1,5", "NA", "x\ny\tz", "\x01#it's", "*\r\nx*",
                                   "R\u00e9s", "2d4", "d400", "a \x01", "e\u0301 \u0301f", "d", "* it"});
    }
    ExternalDataRecordCell anyCell(unsigned kind) {
        if (below(5) == 0) kind = below(6);
        const auto number = oneOf<const char*>(
            {"0", "-0.0", "1.5", "-99", "12.25", "40000.5", "123456.7", "2e18", "1.23456e30", "1e-7", "nan", "-7"});
        ExternalDataRecordCell cell = cellOf(kind == 2 || kind == 5 ? "'" + anyText()
                                             : kind == 3            ? std::string("@") + number
                                             : kind == 4 ? oneOf<std::string>({"i7", "i-99", "?0", "?1", "?-2"})
                                                         : number);
        if (kind == 5) cell.type = oneOf({CELL_EMPTY, ExternalCellType{7}, CELL_NUMBER});
        cell.formatIndex = oneOf({-1, -1, -1, 0, 1, 2, 3, 4, 99, -2, -3});
        return cell;
    }
    void fileWorksheet() {
        naive::Sheet sheet{static_cast<unsigned>(naive_.sheets.size()) + 1, {}};
        provider_.AddWorksheet("sheet");
        provider_.SetWorksheetIndex(static_cast<int>(naive_.sheets.size()));
        const unsigned height = below(12) ? 1 + below(12) : 100 + below(20);
        std::vector<bool> blank(height);
        for (unsigned row = 0; row < height; ++row) blank[row] = below(4) == 0;
        sheet.columns.resize(below(6));
        for (unsigned column = 0; column < sheet.columns.size(); ++column) {
            const unsigned kind = below(6);
            const unsigned density = below(5);
            const bool named = coin();
            for (unsigned i = 0; i < height; ++i) {
                const unsigned row = (i * 7 + 3) % height;  // out of order, and some twice
                if (blank[row] || below(5) > density) continue;
                const auto cell = row == 0 && named ? cellOf("'" + anyText()) : anyCell(kind);
                provider_.file(row, column, cell);
                sheet.columns[column].resize(height);
                sheet.columns[column][row] = cell;
            }
        }
        naive_.sheets.push_back(std::move(sheet));
    }

    // One call of the host, on both.
    template <typename Call>
    void both(const Call& call) {
        call(provider_);
        call(naive_);
    }
    using Change = std::function<void()>;
    void change() {
        const unsigned key = below(12) ? 1 + below(3) : 99;
        oneOf<Change>(
            {[&] { changeColumn(key, 1 + below(6)); }, [&] { changeSettings(); }, [&] { changeLayout(key); }})();
    }
    void changeLayout(unsigned key) {
        const bool on = below(3) != 0;
        const auto setting = EVariableNameRowSetting{oneOf<unsigned>({0, 1, 1, 2, 2, 7})};
        const unsigned name = below(4);
        const unsigned first = coin() ? 0 : below(16);
        const unsigned count = oneOf<unsigned>({0, below(12), below(12), 0xFFFFFFFF, 0xFFFFFFF5});
        const Change positions = [&] {
            both([&](auto& p) { p.SetReadOptionDataRowPositions(key, setting, name, first); });
        };
        oneOf<Change>({
            positions,
            positions,
            [&] { both([&](auto& p) { p.SetReadOptionIgnoreBlankRows(on); }); },
            [&] { both([&](auto& p) { p.SetReadOptionPadColumnsWithMissingValues(on); }); },
            [&] { both([&](auto& p) { p.SetReadOptionExclude(key, on && first < 8); }); },
            [&] {
                provider_.SetReadOptionDataRowCount(key, count);
                naive_.options[key].dataRowCount = count;
            },
            [&] { provider_.SetReadOptionDefaultUseVariableNameRow(naive_.defaultSetting = setting); },
        })();
    }
    void changeColumn(unsigned key, unsigned column) {
        if (below(9) == 0) {
            provider_.ClearReadColumnOptions();
            naive_.columnOptions.clear();
        }
        ColumnReadOptions& option = naive_.columnOptions[key][column];
        if (coin()) option.exclude = below(3) != 0;
        if (coin()) option.name = anyText();
        if (coin()) option.destinationId = oneOf<unsigned>({5, 0, 0xFFFFFFFF});
        if (coin()) option.columnType = IVariable::BasicDataType{oneOf({0, 0, 1, 2, 3})};
        provider_.SetReadColumnOptionExclude(key, column, option.exclude);
        provider_.SetReadColumnOptionName(key, column, option.name.c_str());
        provider_.SetReadColumnOptionDestinationId(key, column, option.destinationId);
        provider_.SetReadColumnOptionColumnType(key, column, option.columnType);
    }
    void changeSettings() {
        if (coin()) naive_.convert = coin();
        if (coin()) naive_.previewing = coin();
        if (coin()) naive_.nameLength = oneOf<unsigned>({0, 1, 2, 0x10002, 0xFFFFFFFF});
        if (coin()) naive_.from = oneOf({1.23456e30, 1.23456e30, -99.0, 1.5});
        if (coin()) naive_.to = oneOf({1.23456e30, -1.0, 0.0});
        if (coin()) naive_.alpha = oneOf<std::string>({"", "", "NA"});
        if (coin()) naive_.missingText = oneOf<std::string>({"", "", "NA", "(3)", " "});
        if (coin()) naive_.missingTextTo = oneOf<std::string>({"", "?", "none"});
        if (coin()) naive_.clean = coin();
        if (coin()) naive_.helped = coin();
        if (coin()) naive_.most = oneOf({1e5, 1e31});
        if (coin()) naive_.textLength = oneOf({80, 4, 0});
        if (coin()) naive_.none = oneOf({1.23456e30, -99.0});
        if (coin()) naive_.missingShown = oneOf<std::string>({"*", " n. a. "});
        if (coin()) naive_.trueText = oneOf<std::string>({"TRUE", "  y"});
        if (coin()) naive_.falseText = oneOf<std::string>({"", "n\x01o"});
        provider_.SetReadOptionConvertDateTimeToText(naive_.convert);
        provider_.SetPreviewing(naive_.previewing);
        provider_.SetMaxVariableNameLength(naive_.nameLength);
        provider_.SetMissingNumeric(naive_.from, naive_.to);
        provider_.SetAlphaMissingNumeric(naive_.alpha.c_str(), naive_.to);
        provider_.SetMissingText(naive_.missingText.c_str(), naive_.missingTextTo.c_str());
        provider_.SetReadOptionCleanTextValues(naive_.clean);
        provider_.SetDateTimeVariableFormatHelper(naive_.helped ? new HandHelper : nullptr);
        provider_.SetNumericRange(naive_.least = -99, naive_.most);
        provider_.SetMaximumTextLength(naive_.textLength);
        provider_.SetMissingValue(naive_.none);
        provider_.SetMissingValueTextRepresentation(naive_.missingShown.c_str());
        provider_.SetBooleanTrueValue(naive_.trueText.c_str());
        provider_.SetBooleanFalseValue(naive_.falseText.c_str());
    }

    void compareWorksheets() {
        std::vector<int> keys;
        const auto* listed = provider_.GetWorksheetPrimeKeys();
        for (unsigned long i = 0; i < listed->Count(); ++i) keys.push_back(listed->Item(i));
        EXPECT_EQ(keys, naive_.worksheetKeys());
    }
    void compareColumns() {
        for (int key = 0; key < 18; ++key) {
            const auto requested = static_cast<ColumnType>(oneOf({2, 2, 1, 0}));
            const bool ignoreExclusion = coin();
            EXPECT_EQ(factsOf(provider_, key, requested, ignoreExclusion).all(),
                      naive_.find(key, requested, ignoreExclusion).all())
                << "column " << key << ", requested " << static_cast<int>(requested);
        }
    }

    testkit::KeptSettings settings_;
    std::mt19937 random_;
    HandFilledProvider provider_;
    naive::Provider naive_;
};

TEST(Columns, AgreeWithTheNaiveModel) {
    for (unsigned seed = 1; seed <= 3000 && !testing::Test::HasFailure(); ++seed) {
        SCOPED_TRACE("seed " + std::to_string(seed));
        Round(seed).run();
    }
}

}  // namespace
}  // namespace dp
