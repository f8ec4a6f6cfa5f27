#include <regex>
#include <stdexcept>

#include <boost/lexical_cast.hpp>

#include "dpxlsx/formats/date_time_variable_format.h"
#include "dpxlsx/readers/xml2003/excel_xml_reader.h"
#include "testkit/recording_provider.h"
#include "tests/case_table.h"
#include "tests/temporary_files.h"

// XML Spreadsheet 2003 documents of literal parts, read into a provider that records the calls it receives.
namespace {

// A host's date-time helper that returns the fields as one number.
class FieldsHelper : public dp::DateTimeVariableFormat {
  public:
    double GenerateTime(int year, int month, int day, int hour, int minute, int second,
                        int millisecond) const override {
        return year * 10000 + month * 100 + day + hour / 100.0 + minute / 1e4 + second / 1e6 + millisecond / 1e9;
    }
};

class Spreadsheet2003 : public TemporaryFiles {
  protected:
    static std::string table(const std::string& content, const std::string& size) {
        return "<Table " + size + ">" + content + "</Table>";
    }
    // A worksheet of `rows` in a table that is large enough.
    static std::string sheet(const std::string& rows) {
        return "<Worksheet ss:Name='S'>" + table(rows, "ss:ExpandedColumnCount='9' ss:ExpandedRowCount='20'") +
               "<WorksheetOptions/></Worksheet>";
    }
    static std::string document(const std::string& content, const std::string& styles = "") {
        return "<Workbook xmlns:ss='urn:s'><Styles>" + styles + "</Styles>" + content + "</Workbook>";
    }
    static std::string number(const std::string& value, const std::string& attributes = "") {
        return "<Cell " + attributes + "><Data ss:Type='Number'>" + value + "</Data></Cell>";
    }

    // The calls that the provider receives, followed by "!13" when the reader fails.
    std::string read(const std::string& content) {
        std::string outcome;
        try {
            dp::ExcelXmlReader reader(write("book.xml", content), "m/d/yy", 1.23456e30, &provider, &helper);
            reader.mReadExcelWorkbook();
        } catch (const CmXmlException& e) {
            outcome = " !" + std::to_string(e.code());
        }
        return provider.taken() + outcome;
    }
    // The records of one worksheet of rows.
    std::string readRows(const std::string& rows, const std::string& styles = "") {
        provider.taken();
        std::string calls = read(document(sheet(rows), styles));
        provider.ClearWorksheets();
        for (const std::string frame : {"+S @0 ", "+S @0", " @0", " -0", "-0"})
            if (const auto at = calls.find(frame); at != calls.npos) calls.erase(at, frame.size());
        return calls;
    }

    testkit::RecordingProvider provider;
    FieldsHelper helper;
};

TEST_F(Spreadsheet2003, CellsByPlaceKindAndStyle) {
    const std::string styles =
        "<Style ss:ID='none'/><Style/><Style ss:ID='date'><NumberFormat ss:Format='Short Date'/>"
        "</Style><Style ss:ID='time'><NumberFormat ss:Format='h:mm'/></Style>"
        "<Style ss:ID='fix'><NumberFormat ss:Format='Fixed'/></Style>"
        "<Style ss:ID='bare'><NumberFormat/></Style>"
        "<Style ss:ID='both'><NumberFormat ss:Format='d/m/yy h:mm'/><NumberFormat ss:Format='0.000'/></Style>"
        "<Style ss:ID='long'><NumberFormat ss:Format='" +
        std::string(1025, 'y') + "'/></Style>";
    for (const auto& c : caseTable("spreadsheet_2003_cells.txt")) {
        const std::string rows = std::regex_replace(c[1], std::regex("@([^ @]+) ?([^@]*)@"), number("$1", "$2"));
        EXPECT_EQ(readRows(rows, styles), c[2]) << c[0];
    }
}

TEST_F(Spreadsheet2003, WorksheetsAndFailures) {
    const std::string worksheet = "<Worksheet ss:Name='$1'>" +
                                  table("$2", "ss:ExpandedColumnCount='1' ss:ExpandedRowCount='1'") +
                                  "<WorksheetOptions/></Worksheet>";
    for (const auto& c : caseTable("spreadsheet_2003_worksheets.txt")) {
        std::string content = std::regex_replace(c[1], std::regex("\\[(\\w) ([^\\]]*)\\]"), worksheet);
        content = std::regex_replace(content, std::regex("ROW"), "<Row>" + number("1") + "</Row>");
        EXPECT_EQ(read(document(content)), c[2]) << c[0];
        provider.ClearWorksheets();
    }
    EXPECT_THROW(dp::ExcelXmlReader(file("nowhere.xml"), "", 0, &provider, nullptr), CmXmlException);
    std::string markup;
    while (markup.size() < 16'000'000) markup += "<!--x-->";
    EXPECT_EQ(readRows("<Row><Cell><Comment>" + markup + "</Comment></Cell></Row>"), "!13")
        << "limits hold in comments";
}

TEST_F(Spreadsheet2003, PreviewsDeliverPlainValuesOutside) {
    const std::string styles = "<Style ss:ID='f'><NumberFormat ss:Format='0.00'/></Style>";
    const std::string time = "<Cell ss:StyleID='f'><Data ss:Type='DateTime'>no date</Data></Cell>";
    const std::string rows = "<Row ss:Index='100'>" + number("1", "ss:StyleID='f'") +
                             number("2", "ss:StyleID='f' ss:Index='101'") + "</Row><Row>" +
                             number("3", "ss:StyleID='f'") + time + "</Row>";
    const std::string content = document(
        "<Worksheet>" + table(rows, "ss:ExpandedColumnCount='200' ss:ExpandedRowCount='200'") + "</Worksheet>", styles);
    provider.SetPreviewing(true);
    EXPECT_EQ(read(content), "+ @0 99,0=1#0 99,100=2 100,0=3 100,1=d1.23456e+30 @0");
    provider.ClearWorksheets();
    EXPECT_THROW(read(content), boost::bad_lexical_cast) << "converted when not previewing";
    provider.ClearWorksheets();
    EXPECT_EQ(readRows("<Row>" + number("1") + "</Row>"), "0,0=1") << "and usable afterwards";
}

// --- the style table of the reader base ---

class StyleTable : public dp::ExcelXmlReader {
  public:
    StyleTable(const std::string& path, dp::IDateTimeVariableFormat* helper, dp::IExcelDataProvider* receiver = nullptr)
        : ExcelXmlReader(path, "yy/m/d", -99.0, receiver, helper) {}

    using ExcelXmlReader::columnStyles;
    using ExcelXmlReader::currentStyle;
    using ExcelXmlReader::currentStyleId;
    using ExcelXmlReader::elementNames;
    using ExcelXmlReader::rowStyles;
    using ExcelXmlReader::styles;
};

class OtherMasks : public StyleTable {
  public:
    using StyleTable::StyleTable;
    const std::string& GetTimeMask() override { return mask_; }
    const std::string& GetAMPMMask() override { return ampm_; }

  private:
    std::string mask_ = "h.mm";
    std::string ampm_ = "a/p";
};

TEST_F(Spreadsheet2003, TheStyleTableClassifiesAndHandsOutFormats) {
    const std::string path = write("book.xml", "<Workbook/>");
    StyleTable reader(path, &helper);
    const struct {
        const char* code;
        int type;
        const char* cleaned;
        const char* pattern;  // null: not a date-time format
    } cases[] = {{"Short Date", 7, "yy/m/d", ""},
                 {"Long Time", 8, "h:mm:ss AM/PM", "h:mm:ss a"},
                 {"Percent", 4, "0.00%", nullptr},
                 {"[$-409]mmm\\-yy;@", 7, "mmm-yy", "MMM-yy"},
                 {"#,##0 \"days\"", 0, "#,##0 \"days\"", nullptr},
                 {"yyyy", 7, "yyyy", ""},
                 {"short date", 9, "short date", ""},
                 {"0.00%", 0, "0.00%", nullptr}};
    for (const auto& c : cases) {
        dp::xStyle style{"s", c.code, 99};
        reader.mSetFmtType(style);
        reader.styles.push_back(style);
    }
    reader.mReplaceDescWithFormat();
    for (std::size_t i = 0; i < std::size(cases); ++i) {
        SCOPED_TRACE(cases[i].code);
        EXPECT_EQ(reader.styles[i].formatCode, cases[i].cleaned);
        EXPECT_EQ(reader.GetExcelFormatType(static_cast<int>(i)), cases[i].type);
        const std::unique_ptr<dp::IVariableFormat> format(reader.createVextralNumericFormat(static_cast<int>(i)));
        const auto* time = dynamic_cast<dp::IDateTimeVariableFormat*>(format.get());
        ASSERT_EQ(time != nullptr, cases[i].pattern != nullptr);
        if (time) {
            EXPECT_STREQ(time->GetFormatString()->database_str(), cases[i].pattern);
        }
    }
    for (const int outside : {-1, static_cast<int>(std::size(cases))}) {
        EXPECT_EQ(reader.GetExcelFormatType(outside), 0);
        const std::unique_ptr<dp::IVariableFormat> format(reader.createVextralNumericFormat(outside));
        EXPECT_TRUE(format->GetAuto());
    }
    EXPECT_EQ(reader.elementNames,
              (std::vector<std::string>{"Cell", "Data", "WorksheetOptions", "Row", "ss:Data", "Comment"}));
}

TEST_F(Spreadsheet2003, DefaultMasksCanBeOverridden) {
    const std::string path = write("book.xml", "<Workbook/>");
    StyleTable usual(path, nullptr);
    OtherMasks other(path, nullptr);
    const std::vector<std::string> cases[] = {{"14", "m/d/yy", "m/d/yy"},    {"18", "hh:mm AM/PM", "h.mm a/p"},
                                              {"21", "hh:mm:ss", "h.mm:ss"}, {"19", "hh:mm:ss AM/PM", "h.mm:ss a/p"},
                                              {"20", "hh:mm", "h.mm"},       {"22", "m/d/yy hh:mm", "m/d/yy h.mm"},
                                              {"15", "code", "code"},        {"20", "code", "code"}};
    for (const auto& c : cases)
        for (StyleTable* reader : {&usual, static_cast<StyleTable*>(&other)})
            reader->styles.push_back({c[0], "code", 3});
    usual.UpdateFormatsForLocale();
    other.UpdateFormatsForLocale();
    for (std::size_t i = 0; i < std::size(cases); ++i) {
        EXPECT_EQ(usual.styles[i].formatCode, cases[i][1]) << cases[i][0];
        EXPECT_EQ(other.styles[i].formatCode, cases[i][2]) << cases[i][0];
        EXPECT_EQ(usual.styles[i].formatType, 3);
    }
    std::string code = "kept";
    usual.GetLocaleDefaultDateTimeFormat(code, 4 | 8);
    EXPECT_EQ(code, "kept") << "neither date nor time";
}

TEST_F(Spreadsheet2003, DefaultStylesAreInherited) {
    StyleTable reader(write("book.xml", "<Workbook/>"), nullptr);
    reader.styles = {{"a", "0", 0}, {"b", "0", 0}, {"a", "0.0", 0}};
    int index = 7;
    EXPECT_FALSE(reader.mGetFormat(0, 0, index));
    EXPECT_EQ(index, -1);
    reader.columnStyles = {{2, 0, "b"}, {2, 0, "a"}, {4, 0, "unknown"}};
    reader.rowStyles = {{0, 5, "a"}};
    const struct {
        const char* name;
        unsigned column, row;
        bool found;
        int index;
    } cases[] = {{"column, the first entry", 2, 5, true, 1},    {"inherits", 0, 0, true, 1},
                 {"row, the first style", 0, 5, true, 0},       {"inherits again", 9, 9, true, 0},
                 {"an unknown style is found", 4, 0, true, -1}, {"and leaves nothing to inherit", 0, 0, false, -1}};
    for (const auto& c : cases) {
        EXPECT_EQ(reader.mGetFormat(c.column, c.row, index), c.found) << c.name;
        EXPECT_EQ(index, c.index) << c.name;
    }
    dp::xStyle* style = nullptr;
    EXPECT_TRUE(reader.mSearchStyleIndexForFormat("a", style, index));
    EXPECT_EQ(style, &reader.styles[0]);
    EXPECT_FALSE(reader.mSearchStyleIndexForFormat("c", style, index));
    EXPECT_EQ(style, nullptr);
}

// A derived reader may change the tables in any way: lookups find the first entry, and an inherited style is looked up
// again.
TEST_F(Spreadsheet2003, TablesMayChangeBetweenCalls) {
    const std::string style = "<Style ss:ID='b'><NumberFormat ss:Format='0'/></Style>";
    const std::string row = "<Row>" + number("1", "ss:StyleID='b'") + "</Row>";
    StyleTable reader(write("book.xml", document(sheet(row), style)), nullptr, &provider);
    reader.mReadExcelWorkbook();
    EXPECT_EQ(provider.taken(), "+S @0 0,0=1#0 @0");
    const auto found = [&reader](unsigned column, unsigned line) {
        int index = 7;
        const bool any = reader.mGetFormat(column, line, index);
        EXPECT_EQ(reader.currentStyle, index < 0 ? nullptr : &reader.styles[static_cast<std::size_t>(index)]);
        return any ? std::to_string(index) : "none";
    };
    const auto all = [&found] {
        std::string indices = found(0, 9);
        indices += " " + found(9, 0);
        return indices + " " + found(9, 9);
    };
    reader.styles = {{"a", "0", 0}, {"b", "0", 0}};
    reader.columnStyles = {{0, 0, "b"}};
    reader.rowStyles = {{0, 0, "a"}};
    EXPECT_EQ(all(), "1 0 0");
    reader.styles = {{"b", "0", 0}, {"a", "0", 0}};
    EXPECT_EQ(all(), "0 1 1") << "as many others";
    reader.styles.insert(reader.styles.begin(), 1000, {"c", "0", 0});
    EXPECT_EQ(found(9, 9), "1001") << "grown: the inherited style";
    EXPECT_EQ(all(), "1000 1001 1001") << "grown";
    reader.styles[5].styleId = "a";
    EXPECT_EQ(all(), "1000 5 5") << "edited in place";
    reader.styles.resize(6);
    EXPECT_EQ(all(), "-1 5 5") << "shrunk";
    reader.columnStyles = {{9, 0, "c"}};
    reader.rowStyles[0].row = 9;
    EXPECT_EQ(all(), "5 0 0") << "other columns and rows";
    reader.styles.clear();
    EXPECT_EQ(all(), "-1 -1 -1");
}

TEST_F(Spreadsheet2003, DateTimeTexts) {
    StyleTable reader(write("book.xml", "<Workbook/>"), &helper);
    const auto fields = [&](int y, int mo, int d, int h, int mi, int s, int ms) {
        return helper.GenerateTime(y, mo, d, h, mi, s, ms);
    };
    EXPECT_EQ(reader.mFormatExcelDateTime("2010-01-05T10:30:59.125"), fields(2010, 1, 5, 10, 30, 59, 125));
    EXPECT_EQ(reader.mFormatExcelDateTime("1899-12-31T10:30:00.000"), fields(1899, 12, 30, 10, 30, 0, 0));
    EXPECT_EQ(reader.mFormatExcelDateTime("1900-12-31T00:00:00.000"), fields(1900, 12, 31, 0, 0, 0, 0));
    EXPECT_EQ(reader.mFormatExcelDateTime("1899-12-30T00:00:00.000"), fields(1899, 12, 30, 0, 0, 0, 0));
    EXPECT_EQ(reader.mFormatExcelDateTime("+201x-1x+5x+0x+0x+0x+00"), fields(201, -1, 5, 0, 0, 0, 0));
    for (const char* text :
         {"2010", "2010-01", "2010-01-05", "2010-01-05T10", "2010-01-05T10:30", "2010-01-05T10:30:59"}) {
        try {
            reader.mFormatExcelDateTime(text);
            ADD_FAILURE() << text;
        } catch (const std::out_of_range& e) {
            EXPECT_STREQ(e.what(), "basic_string::substr") << text;
        }
    }
    for (const char* text : {"", "abcd-01-05", "2010-", "2010-xx-05", "2010-01-05T10:30:59."})
        EXPECT_THROW(reader.mFormatExcelDateTime(text), boost::bad_lexical_cast) << text;
}

}  // namespace
