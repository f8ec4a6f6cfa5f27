#include <algorithm>
#include <optional>
#include <regex>

#include "dpxlsx/model/host/entry_points.h"
#include "dpxlsx/readers/limits.h"
#include "dpxlsx/readers/standard/cell_position.h"
#include "dpxlsx/readers/standard/cell_values.h"
#include "dpxlsx/readers/standard/part_name.h"
#include "dpxlsx/readers/xml/xml_reader.h"
#include "dpxlsx/store/text_cleaning.h"
#include "testkit/package_builder.h"
#include "testkit/process_settings.h"
#include "testkit/recording_provider.h"
#include "tests/case_table.h"
#include "tests/provider_fixture.h"
#include "tests/temporary_files.h"

// Reading by the standard: the values, the switch, and packages with it off and on.
namespace {

using Access = dp::IDataProvider::FileAccess;
using testkit::PackageBuilder;
using testkit::RecordingProvider;

constexpr int kDefault = 0;
constexpr int kStandard = 1;

class Standard : public TemporaryFiles {
  protected:
    long open(RecordingProvider& provider, const PackageBuilder& package, int rules) {
        EXPECT_EQ(dp::SetReadingRules(&provider, rules), 0);
        package.write(file("book.xlsx"));
        return provider.OpenFile(file("book.xlsx").c_str(), Access::Read);
    }
    // The cells that the provider receives, and the code of the failure.
    std::string read(const PackageBuilder& package, int rules) {
        RecordingProvider provider;
        std::string failure;
        try {
            const long result = open(provider, package, rules);
            if (result != 0) failure = " !" + std::to_string(result);
        } catch (const CmXmlException& e) {
            failure = " !" + std::to_string(e.code());
        }
        provider.CloseFile();
        const std::regex calls("(^| )(\\+S1|@0|-0)(?= |$)");
        const std::string cells = std::regex_replace(provider.taken(), calls, "") + failure;
        return cells.substr(std::min(cells.size(), cells.find_first_not_of(' ')));
    }
    const PackageBuilder oneCell = PackageBuilder::of({"<row><c><v>1</v></c></row>"});
};

TEST_F(Standard, OffAndOn) {
    const std::pair<const char*, const char*> names[] = {
        {"\\{m\\}", "http://schemas.openxmlformats.org/spreadsheetml/2006/main"},
        {"\\{s\\}", "http://purl.oclc.org/ooxml/spreadsheetml/main"},
        {"\\{r\\}", "http://schemas.openxmlformats.org/officeDocument/2006/relationships"},
        {"\\{q\\}", "http://purl.oclc.org/ooxml/officeDocument/relationships"},
        {"\\{p\\}", "http://schemas.openxmlformats.org/package/2006/relationships"},
        {"\\{mc\\}", "http://schemas.openxmlformats.org/markup-compatibility/2006"}};
    for (auto c : caseTable("standard.txt")) {
        for (const auto& [mark, name] : names)
            for (std::string& column : c) column = std::regex_replace(column, std::regex(mark), name);
        auto package = PackageBuilder::of({c[1]});
        for (std::string parts = c[2]; parts.starts_with('@');) {
            const std::size_t next = std::min(parts.find(" @"), parts.size());
            const std::size_t colon = parts.find(':');
            package.set(parts.substr(1, colon - 1), parts.substr(colon + 1, next - colon - 1));
            parts.erase(0, next + 1);
        }
        EXPECT_EQ(read(package, kDefault), c[3]) << c[0] << ", off";
        EXPECT_EQ(read(package, kStandard), c[4]) << c[0] << ", on";
    }
}

TEST_F(Standard, SwitchHoldsFromTheNextOpenOrListing) {
    RecordingProvider provider;
    for (const int rules : {-1, 2}) EXPECT_EQ(dp::SetReadingRules(&provider, rules), -50) << rules;
    EXPECT_EQ(dp::SetReadingRules(nullptr, kStandard), -50);

    const PackageBuilder curable = PackageBuilder(oneCell).set("xl/styles.xml", "");
    std::vector<std::string> names;
    const auto list = [&] { return provider.GetWorksheets(file("book.xlsx").c_str(), names); };
    EXPECT_EQ(open(provider, curable, kStandard), 0);
    EXPECT_EQ(list(), 0);
    EXPECT_EQ(names, std::vector<std::string>{"S1"});
    provider.ClearWorksheets();
    EXPECT_EQ(list(), 0) << "after clearing";
    EXPECT_EQ(dp::SetReadingRules(&provider, 7), -50);
    EXPECT_EQ(list(), 0) << "after a refusal";
    EXPECT_EQ(dp::SetReadingRules(&provider, kDefault), 0);
    EXPECT_EQ(list(), -25);
}

TEST_F(Standard, ColumnsOfCellsWithoutValues) {
    const std::string rows =
        "<row><c t='str'><v>N</v></c></row><row><c t='e'><v>#N/A</v></c></row>"
        "<row><c t='str'><v>Grüße</v></c></row><row><c t='e'><v>#N/A</v></c></row>";
    const testkit::KeptSettings kept;
    RecordingProvider provider;
    const auto facts = [&](int rules) {
        provider.ClearWorksheets();
        EXPECT_EQ(open(provider, PackageBuilder::of({rows}), rules), 0);
        provider.SetReadOptionDefaultUseVariableNameRow(dp::VNR_GIVEN);
        provider.SetMaximumTextLength(3);
        provider.GetWorksheetPrimeKeys();
        // What is set now holds for the next file.
        EXPECT_EQ(dp::SetReadingRules(&provider, kStandard - rules), 0);
        const dp::ColumnFacts column = dp::factsOf(provider, 1);
        return column.rows() + ", " + std::to_string(column.missing) + " missing";
    };
    EXPECT_EQ(facts(kDefault), "'' 'Gr\xc3', 1 missing");
    EXPECT_EQ(facts(kStandard), "'' 'Gr' '', 2 missing");
    provider.CloseFile();
}

// An error has nothing to convert; what is not a number does.
TEST_F(Standard, ColumnsOfErrors) {
    const auto package =
        PackageBuilder::of({"<row/><row><c t='e'><v>#N/A</v></c></row><row><c><v>1x</v></c></row>"
                            "<row><c><v>5</v></c></row><row><c t='e'><v>#N/A</v></c></row>"});
    const testkit::KeptSettings kept;
    RecordingProvider provider;
    for (const double missing : {1.23456e30, -99.0}) {
        provider.ClearWorksheets();
        provider.SetMissingValue(missing);
        EXPECT_EQ(open(provider, package, kStandard), 0);
        provider.GetWorksheetPrimeKeys();
        const dp::ColumnFacts column = dp::factsOf(provider, 1);
        EXPECT_EQ(column.values, (std::vector{missing, missing, 5.0, missing}));
        EXPECT_EQ(column.converted, 1) << missing;
    }
    provider.CloseFile();
}

// In a column of texts each number is a text as its own section shows it.
TEST_F(Standard, NumbersAmongTexts) {
    const auto package = PackageBuilder::of({"<row/><row><c t='str'><v>a</v></c></row><row><c s='0'><v>-5</v></c></row>"
                                             "<row><c s='0'><v>0</v></c></row><row><c s='1'><v>5</v></c></row>"})
                             .set("xl/styles.xml",
                                  "<styleSheet><numFmts><numFmt numFmtId='164' formatCode='0.0;(0.0);\"none\"'/>"
                                  "<numFmt numFmtId='165' formatCode='[=5]\"five\";0'/></numFmts>"
                                  "<cellXfs><xf numFmtId='164'/><xf numFmtId='165'/></cellXfs></styleSheet>");
    const testkit::KeptSettings kept;
    RecordingProvider provider;
    EXPECT_EQ(open(provider, package, kStandard), 0);
    provider.GetWorksheetPrimeKeys();
    EXPECT_EQ(dp::factsOf(provider, 1).rows(), "'a' '(5.0)' 'none' 'five'");
    provider.CloseFile();
}

// A host's helper shows date-times by their pattern, but for formats that show more than it says.
TEST_F(Standard, DatesAmongTexts) {
    const char* const cases[][2] = {{"yyyy", "by helper yyyy 2.500000"},
                                    {"h:mm;@", "by helper H:mm 2.500000"},
                                    {"[h]:mm", "60:00"},
                                    {"[mm]:ss", "3600:00"},
                                    {"[h]:mm;-[h]:mm", "60:00"},
                                    {"h:mm;[h]:mm", "12:00"},
                                    {"[&lt;1]h:mm;dd.mm.yyyy", "02.01.1900"}};
    std::string rows = "<row/><row><c t='str'><v>a</v></c></row>";
    std::string codes;
    std::string styles = "<xf/>";
    std::string expected = "'a'";
    for (std::size_t i = 0; i < std::size(cases); ++i) {
        const std::string style = std::to_string(i + 1);
        const std::string id = std::to_string(200 + i);
        rows += "<row><c s='" + style + "'><v>2.5</v></c></row>";
        codes += "<numFmt numFmtId='" + id + "' formatCode='" + cases[i][0] + "'/>";
        styles += "<xf numFmtId='" + id + "'/>";
        expected += " '" + std::string(cases[i][1]) + "'";
    }
    // A duration without a format of its own
    rows += "<row><c t='d'><v>PT36H</v></c></row>";
    expected += " '36:00:00'";
    const auto package = PackageBuilder::of({rows}).set(
        "xl/styles.xml", "<styleSheet><numFmts>" + codes + "</numFmts><cellXfs>" + styles + "</cellXfs></styleSheet>");
    const testkit::KeptSettings kept;
    RecordingProvider provider;
    provider.SetDateTimeVariableFormatHelper(new dp::HandHelper);
    EXPECT_EQ(open(provider, package, kStandard), 0);
    provider.GetWorksheetPrimeKeys();
    EXPECT_EQ(dp::factsOf(provider, 1).rows(), expected);
    provider.CloseFile();
}

// Codes beyond the limit do not count; equal codes are one format.
TEST_F(Standard, ManyNumberFormats) {
    constexpr std::size_t kFitting = dp::kFormatCodes / dp::kFormatCodeSize;
    std::string codes = "<numFmt numFmtId='1' formatCode='0;0;0'/>";
    for (std::size_t i = 2; i <= kFitting + 1; ++i) {
        const std::string name = std::to_string(i / 2);
        codes += "<numFmt numFmtId='" + std::to_string(i) + "' formatCode='&quot;" + name +
                 std::string(dp::kFormatCodeSize - name.size() - 3, 'x') + "&quot;y'/>";
    }
    std::string styles;
    std::string rows;
    for (const std::size_t id : {std::size_t{1}, std::size_t{2}, std::size_t{3}, kFitting, kFitting + 1}) {
        rows += "<c s='" + std::to_string(std::count(rows.begin(), rows.end(), 'c') / 2) + "'><v>1</v></c>";
        styles += "<xf numFmtId='" + std::to_string(id) + "'/>";
    }
    const auto package = PackageBuilder::of({"<row>" + rows + "</row>"})
                             .set("xl/styles.xml", "<styleSheet><numFmts>" + codes + "</numFmts><cellXfs>" + styles +
                                                       "</cellXfs></styleSheet>");
    EXPECT_EQ(read(package, kStandard), "0,0=1#0 0,1=d1#1 0,2=d1#1 0,3=d1#2 0,4=1");
}

// Formats beyond the limit do not count, unless they are built in.
TEST_F(Standard, ManyDifferentNumberFormats) {
    std::string codes;
    std::string styles;
    for (std::size_t i = 0; i <= dp::kNumberFormats; ++i) {
        const std::string id = std::to_string(1000 + i);
        codes += "<numFmt numFmtId='" + id + "'";
        codes += " formatCode='y&quot;" + id + "&quot;'/>";
        styles += "<xf numFmtId='" + id + "'/>";
    }
    styles += "<xf numFmtId='1000'/><xf numFmtId='14'/>";
    std::string cells;
    for (std::size_t style = dp::kNumberFormats - 1; style < dp::kNumberFormats + 3; ++style)
        cells.append("<c s='").append(std::to_string(style)).append("'><v>1</v></c>");
    const auto package = PackageBuilder::of({"<row>" + cells + "</row>"})
                             .set("xl/styles.xml", "<styleSheet><numFmts>" + codes + "</numFmts><cellXfs>" + styles +
                                                       "</cellXfs></styleSheet>");
    EXPECT_EQ(read(package, kStandard), "0,0=d1#4095 0,1=1 0,2=d1#0 0,3=d1#4096");
}

TEST(StandardTexts, EndAtWholeCharacters) {
    struct Case {
        const char* name;
        std::string text;
        std::size_t bytes;
        std::size_t whole;
    };
    const Case cases[] = {{"between characters", "aébc", 3, 3},
                          {"within a code point", "aé", 2, 1},
                          {"before a combining mark", "ae\u0301b", 2, 1},
                          {"within a family", "x👩\u200d👧y", 8, 1},
                          {"the first one is longer", "e\u0301\u0302", 4, 3},
                          {"nothing", "é", 0, 0},
                          {"no UTF-8", "\x80\x80\x80", 2, 0}};
    for (const Case& c : cases) EXPECT_EQ(dp::wholeCharacters(c.text, c.bytes), c.whole) << c.name;
}

TEST(StandardValues, NumbersAndBooleans) {
    const std::optional<double> none;
    const std::pair<const char*, std::optional<double>> numbers[] = {
        {"1", 1},        {"-1.5e3", -1500}, {"+.5", 0.5},  {" \n7\t", 7}, {"5.", 5},    {"1E-400", 0},
        {"1e999", none}, {"", none},        {".", none},   {"1e", none},  {"-", none},  {"1 2", none},
        {"INF", none},   {"nan", none},     {"0x1", none}, {"1,5", none}, {"1d", none}, {"0.1", 0.1}};
    for (const auto& [text, value] : numbers) EXPECT_EQ(dp::standard::parseNumber(text), value) << text;
    const std::pair<const char*, std::optional<int>> indexes[] = {
        {"0", 0},           {" 07\n", 7},         {"99999999999", 2147483647},
        {"", std::nullopt}, {"-1", std::nullopt}, {"1.0", std::nullopt}};
    for (const auto& [text, value] : indexes) EXPECT_EQ(dp::standard::parseIndex(text), value) << text;
    for (const char* text : {"1", "true", " TRUE", "on"}) EXPECT_EQ(dp::standard::parseBoolean(text), true) << text;
    for (const char* text : {"0", "false", "Off "}) EXPECT_EQ(dp::standard::parseBoolean(text), false) << text;
    for (const char* text : {"", "2", "yes", "tru"}) EXPECT_EQ(dp::standard::parseBoolean(text), std::nullopt) << text;
}

TEST(StandardValues, IsoDateTimes) {
    struct Case {
        const char* text;
        double dayNumber;  // -1 for none
        dp::EXCEL_FORMAT_TYPE type;
    };
    const auto date = dp::EXCEL_FORMAT_DATE;
    const auto time = dp::EXCEL_FORMAT_TIME;
    const auto both = dp::EXCEL_FORMAT_DATETIME;
    const Case cases[] = {{"2024-01-05", 45296, date},
                          {"1970-01-01Z", 25569, date},
                          {"1970-01-01+01:00", 25569, date},
                          {"1900-03-01", 61, date},
                          {"1900-02-28", 59, date},
                          {"1900-01-01", 1, date},
                          {"1899-12-31", 0, date},
                          {"9999-12-31", 2958465, date},
                          {"2024-01-05T06:00", 45296.25, both},
                          {"2024-01-05 06:00:00.0Z", 45296.25, both},
                          {"2024-01-05T06:00:00+14:00", 45296.25, both},
                          {"06:30-13:59", 6.5 / 24, time},
                          {"2024-01-05T24:00:00", 45297, both},
                          {"1899-12-30T18:00:00", 0.75, both},
                          {"18:00", 0.75, time},
                          {"T00:00:00.864", 0.00001, time},
                          {"PT36H", 1.5, time},
                          {"P1DT12H", 1.5, time},
                          {"PT0.864S", 0.00001, time},
                          {"2024-02-30", -1, date},
                          {"1899-12-29", -1, date},
                          {"2024-13-01", -1, date},
                          {"2024-1-05", -1, date},
                          {"2024-01-05T", -1, date},
                          {"2024-01-05ZT06:30", -1, date},
                          {"2024-01-05+01:00T06:30", -1, date},
                          {"2024-01-05T25:00", -1, date},
                          {"2024-01-05T06:60", -1, date},
                          {"2024-01-05T06:00x", -1, date},
                          {"2024-01-05+14:01", -1, date},
                          {"06:30-15:00", -1, date},
                          {"06:30+01:60", -1, date},
                          {"T", -1, date},
                          {"P", -1, date},
                          {"P1M", -1, date},
                          {"PT1S1H", -1, date},
                          {"20240105", -1, date},
                          {"", -1, date}};
    for (const Case& c : cases) {
        const auto value = dp::standard::parseIsoDateTime(c.text);
        EXPECT_EQ(value.has_value(), c.dayNumber >= 0) << c.text;
        if (!value) continue;
        EXPECT_DOUBLE_EQ(value->dayNumber, c.dayNumber) << c.text;
        EXPECT_EQ(value->type, c.type) << c.text;
    }
}

TEST(StandardValues, References) {
    using dp::standard::CellPosition;
    const std::pair<const char*, std::optional<CellPosition>> cases[] = {
        {"A1", CellPosition{0, 0}},
        {"b7", CellPosition{6, 1}},
        {"XFD1048576", CellPosition{1048575, 16383}},
        {"XFE0", CellPosition{1048576, 16384}},
        {"ZZZZZZZZZZZZZZZZZZ99999999999999999999", CellPosition{1048576, 16384}},
        {"A", std::nullopt},
        {"7", std::nullopt},
        {"", std::nullopt},
        {"A1B", std::nullopt},
        {"A-1", std::nullopt}};
    for (const auto& [text, position] : cases) EXPECT_EQ(dp::standard::parseReference(text), position) << text;
}

TEST(StandardValues, PartNames) {
    struct Case {
        const char* source;
        const char* target;
        const char* name;
    };
    const Case cases[] = {{"xl/workbook.xml", "worksheets/sheet1.xml", "xl/worksheets/sheet1.xml"},
                          {"xl/workbook.xml", "/xl/./a.xml", "xl/a.xml"},
                          {"xl/workbook.xml", "../../../a.xml", "a.xml"},
                          {"xl/workbook.xml", "..\\a%20b%2e.xml", "a b..xml"},
                          {"xl/workbook.xml", "a%2Fb%5c%00%4", "xl/a%2Fb%5c%00%4"},
                          {"", "xl//workbook.xml", "xl/workbook.xml"},
                          {"", "", ""}};
    for (const Case& c : cases) EXPECT_EQ(dp::standard::resolvePartName(c.source, c.target), c.name) << c.target;
    EXPECT_THROW(dp::standard::resolvePartName("", std::string(4097, 'a')), CmXmlException);
    EXPECT_EQ(dp::standard::relationshipPartOf("xl/workbook.xml"), "xl/_rels/workbook.xml.rels");
    EXPECT_EQ(dp::standard::relationshipPartOf(""), "_rels/.rels");
}

}  // namespace
