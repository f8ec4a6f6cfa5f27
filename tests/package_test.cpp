#include <algorithm>
#include <new>
#include <regex>
#include <string>
#include <vector>

#include "dpxlsx/readers/xlsx/excel_xlsx_reader.h"
#include "dpxlsx/readers/xlsx/shared_string_table.h"
#include "dpxlsx/readers/xml/xml_reader.h"
#include "testkit/package_builder.h"
#include "testkit/recording_provider.h"
#include "tests/case_table.h"
#include "tests/temporary_files.h"

// Packages of literal parts, read into a provider that records the calls it receives.
namespace {

using Access = dp::IDataProvider::FileAccess;
using testkit::PackageBuilder;
using testkit::RecordingProvider;

class Packages : public TemporaryFiles {
  protected:
    // The calls that the provider receives, followed by "!13" when the reader fails or by the result code when it is
    // not 0.
    std::string read(const PackageBuilder& package) {
        package.write(file("book.xlsx"));
        RecordingProvider provider;
        std::string outcome;
        try {
            const long result = provider.OpenFile(file("book.xlsx").c_str(), Access::Read);
            if (result != 0) outcome = "!" + std::to_string(result);
        } catch (const CmXmlException& e) {
            outcome = "!" + std::to_string(e.code());
        }
        provider.CloseFile();
        const std::string calls = provider.taken();
        return calls + (calls.empty() || outcome.empty() ? "" : " ") + outcome;
    }
    // The records of one worksheet, without the calls that add and select it.
    std::string readCells(const PackageBuilder& package) {
        std::string calls = read(package);
        for (const std::string frame : {"+S1 @0 ", "+S1 @0", " @0", "-0"})
            if (const auto at = calls.find(frame); at != calls.npos) calls.erase(at, frame.size());
        return calls.substr(std::min(calls.size(), calls.find_first_not_of(' ')));
    }
    // What is read in another way because of a comment is read so in both parts.
    std::string readRows(const std::string& rows) {
        const std::string comment = rows.starts_with("<!---->") ? "<!---->" : "";
        return readCells(PackageBuilder::of({rows}).set("xl/sharedStrings.xml", comment + kStrings));
    }

    const std::string kStrings =
        "<sst uniqueCount='6'>\n <si><t>zero</t></si>\n <si/><si><t>   </t></si>\n"
        "<si>\n <r><t>Ab</t></r>\n <r><rPr><b/></rPr><t xml:space='preserve'> cd</t></r>\n</si>"
        "<si><t>x_x005F_y</t></si><si><t>jp</t><rPh><t>ph</t></rPh></si></sst>";
};

// A part with a comment is read in another way than one without, from the comment on.
TEST_F(Packages, CellsByPlaceAndKind) {
    for (const auto& c : caseTable("worksheet_cells.txt"))
        for (const std::string& rows : {c[1], "<!---->" + c[1], c[1] + "<!---->"})
            EXPECT_EQ(readRows(rows), c[2]) << c[0] << ": " << rows;
}

TEST_F(Packages, StylesDecideNumbersAndDates) {
    const std::string formats =
        "<numFmt numFmtId='164' formatCode='yyyy-mm-dd'/><numFmt numFmtId='14' formatCode='0.00'/>"
        "<numFmt numFmtId='165' formatCode='h:mm'/>";
    const std::string cellFormats =
        "<xf numFmtId='14'/><xf numFmtId='2'/><xf numFmtId='164'/><xf/><xf numFmtId='165'/><xf numFmtId='0'/>";
    std::string row;
    for (const char* style : {"0", "1", "2", "3", "4", "5", "6", "-1"})
        row += std::string("<c s='") + style + "'><v>1</v></c>";
    for (const auto& c : caseTable("styles.txt")) {
        std::string styles = std::regex_replace(c[1], std::regex(">F<"), ">" + formats + "<");
        styles = std::regex_replace(styles, std::regex(">X<"), ">" + cellFormats + "<");
        styles = std::regex_replace(styles, std::regex("LONG"), std::string(1024, 'y'));
        const auto package = PackageBuilder::of({"<row>" + row + "</row>"});
        EXPECT_EQ(readCells(PackageBuilder(package).set("xl/styles.xml", "<styleSheet>" + styles + "</styleSheet>")),
                  c[2])
            << c[0];
    }
}

// A host that links the library may call the steps of a reading itself, and change the style table between them.
TEST_F(Packages, StepsOfAReading) {
    class Reader : public dp::ExcelXLSXReader {
      public:
        using ExcelXLSXReader::ExcelXLSXReader;
        using ExcelXLSXReader::styles;
    };
    const std::string cells = "<row><c s='0'><v>1</v></c><c s='1'><v>2</v></c><c t='s'><v>0</v></c></row>";
    PackageBuilder::of({cells}).unpackTo(files().string());
    write("xl/styles.xml", "<styleSheet><cellXfs><xf numFmtId='14'/><xf numFmtId='164'/></cellXfs></styleSheet>");
    RecordingProvider provider;
    Reader reader(files().string(), true, "m/d/yy", 0, &provider, nullptr);
    reader.mReadExcel2007Styles();
    const auto readCells = [&] {
        provider.AddWorksheet("S");
        provider.SetWorksheetIndex(0);
        provider.taken();
        reader.mReadExcel2007Worksheet("worksheets/sheet1.xml");
        return provider.taken();
    };
    EXPECT_EQ(readCells(), "0,0=d1#12 0,1=2");
    reader.styles.push_back({"164", "yyyy", dp::EXCEL_FORMAT_DATE});
    EXPECT_EQ(readCells(), "0,0=d1#12 0,1=d2#32") << "a style more";
    reader.styles[3] = {"164", "0", dp::EXCEL_FORMAT_NUMBER};
    EXPECT_EQ(readCells(), "0,0=d1#12 0,1=2#3") << "an entry before it";
    reader.styles.clear();
    EXPECT_EQ(readCells(), "0,0=1 0,1=2");
    for (const std::string& text : {std::string("one"), std::string("two")}) {
        write("xl/sharedStrings.xml", "<sst uniqueCount='1'><si><t>" + text + "</t></si></sst>");
        reader.mReadSharedStrings();
        EXPECT_EQ(readCells(), "0,0=1 0,1=2 0,2='" + text + "'") << "texts in place of those before";
    }
    write("xl/styles.xml",
          "<styleSheet><cellXfs count='2'><xf numFmtId='2'/><xf numFmtId='14'/></cellXfs></styleSheet>");
    reader.mReadExcel2007Styles();
    EXPECT_EQ(readCells(), "0,0=1#1 0,1=d2#12 0,2='two'") << "cell formats in place of those before";
    write("xl/worksheets/sheet1.xml", PackageBuilder::worksheet("<row><c s='1'/><c><v>1</v></c></row>"));
    EXPECT_EQ(readCells(), "0,1=1") << "a cell format is for its cell alone";
}

TEST_F(Packages, WorksheetsOfTheWorkbook) {
    const std::string one = "<row><c><v>1</v></c></row>";
    EXPECT_EQ(read(PackageBuilder::of({"", one, "<row><c t='e'/></row>"})), "+S1 @0 +S2 @1 0,0=1 +S3 @2 -2 -0 @0");
    EXPECT_EQ(read(PackageBuilder::of({"", ""})), "+S1 @0 +S2 @1 -1 -0");
    const std::string behind = PackageBuilder::worksheet("") + R"(<c r="A1"><v>1</v></c>)";
    EXPECT_EQ(read(PackageBuilder::of({""}).set("xl/worksheets/sheet1.xml", behind)), "+S1 @0 !13");
    for (const auto& c : caseTable("workbooks.txt")) {
        const std::string list = c[1].substr(0, c[1].find(" @"));
        const std::string sheets =
            std::regex_replace(list, std::regex("(\\w*):(\\w*) ?"), "<sheet name='$1' r:id='$2'/>");
        const std::string relations =
            std::regex_replace(c[2], std::regex("(\\d+):(\\w+):(\\S+) ?"), PackageBuilder::relation("$1", "$2", "$3"));
        PackageBuilder package = PackageBuilder::of({one});
        package.set("xl/workbook.xml", PackageBuilder::workbook(sheets));
        package.set("xl/_rels/workbook.xml.rels", PackageBuilder::relationships(relations));
        if (list.size() < c[1].size()) {
            const std::string part = c[1].substr(list.size() + 2);
            package.set(part.substr(0, part.find(':')), part.substr(part.find(':') + 1));
        }
        EXPECT_EQ(read(package), c[3]) << c[0];
    }
}

TEST_F(Packages, SharedStringTables) {
    const auto package = PackageBuilder::of({"<row><c t='s'><v>0</v></c><c t='s'><v>1</v></c></row>"});
    EXPECT_EQ(readCells(package), "") << "no such part";
    for (const auto& c : caseTable("shared_strings.txt"))
        for (const std::string& part : {c[1], "<!---->" + c[1], c[1] + "<!---->"})
            EXPECT_EQ(readCells(PackageBuilder(package).set("xl/sharedStrings.xml", part)), c[2])
                << c[0] << ": " << part;
}

TEST(SharedStringTable, KeepsTextsBehindWhatAnEndCanHold) {
    dp::SharedStringTable table(4);
    for (const std::size_t step : {1U, 7U}) {
        table.clear();
        std::vector<std::string> texts;
        for (std::size_t i = 0; i < 60; ++i)
            table.add(texts.emplace_back(i * step % 41, static_cast<char>('a' + i % 26)));
        for (std::size_t i = 0; i < texts.size(); ++i) EXPECT_EQ(table[i], texts[i]) << i;
    }
}

// A provider that runs out of memory does not receive the cells that were still waiting.
TEST_F(Packages, NothingFollowsAnErrorOfTheReceiver) {
    struct Full : dp::xlsxDataProvider {
        void AddExternalDataRecord(const dp::ExternalDataRecord&) override {
            ++calls;
            throw std::bad_alloc();
        }
        int calls = 0;
    } provider;
    PackageBuilder::of({"<row><c t='s'><v>0</v></c><c><v>1</v></c><c><v>2</v></c></row>"})
        .set("xl/sharedStrings.xml", kStrings)
        .write(file("book.xlsx"));
    EXPECT_THROW(provider.OpenFile(file("book.xlsx").c_str(), Access::Read), std::bad_alloc);
    EXPECT_EQ(provider.calls, 1);
}

TEST_F(Packages, CdataSectionsHoldAnyText) {
    std::string text = "==--";
    while (text.size() < 240'000) text += text.size() % 7 == 0 ? "<b c='--'" : "=-";
    const auto package =
        PackageBuilder::of({"<row><c t='str'><v><![CDATA[" + text + "]]></v></c><c t='s'><v>0</v></c></row>"})
            .set("xl/sharedStrings.xml", "<sst uniqueCount='1'><si><t>kept<![CDATA[" + text + "]]></t></si></sst>");
    EXPECT_TRUE(readCells(package) == "0,0='" + text + "' 0,1='kept'");
}

// One long string in many cells: accepted in proportion to the size of the package, refused beyond.
TEST_F(Packages, RepeatedTextsHaveALimit) {
    const auto outcomeOf = [this](unsigned cells) {
        std::string row = "<row>";
        for (unsigned cell = 0; cell < cells; ++cell) row += "<c t='s'><v>0</v></c>";
        auto package = PackageBuilder::of({row + "</row>"});
        package.set("xl/sharedStrings.xml",
                    "<sst uniqueCount='1'><si><t>" + std::string(2'000'000, 'x') + "</t></si></sst>");
        package.write(file("book.xlsx"));
        dp::xlsxDataProvider provider;
        return provider.OpenFile(file("book.xlsx").c_str(), Access::Read);
    };
    EXPECT_EQ(outcomeOf(64), 0);
    EXPECT_THROW(outcomeOf(200), CmXmlException);
}

// Many sheets that name one part, and a target that is longer than any path.
TEST_F(Packages, SheetsOfOnePartHaveALimit) {
    const auto outcomeOf = [this](unsigned sheets, const std::string& target) {
        std::string list;
        for (unsigned sheet = 0; sheet < sheets; ++sheet) list += "<sheet name='S' r:id='r1'/>";
        auto package = PackageBuilder::of({"<row><c><v>1</v></c></row>"});
        package.set("xl/workbook.xml", PackageBuilder::workbook(list));
        package.set("xl/_rels/workbook.xml.rels",
                    PackageBuilder::relationships(PackageBuilder::relation("r1", "worksheet", target)));
        package.write(file("book.xlsx"));
        dp::xlsxDataProvider provider;
        return provider.OpenFile(file("book.xlsx").c_str(), Access::Read);
    };
    EXPECT_EQ(outcomeOf(100, "worksheets/sheet1.xml"), 0);
    EXPECT_THROW(outcomeOf(17'000, "worksheets/sheet1.xml"), CmXmlException);
    std::string dots;
    for (unsigned i = 0; i < 2100; ++i) dots += "./";
    EXPECT_THROW(outcomeOf(1, dots + "worksheets/sheet1.xml"), CmXmlException);
}

TEST(Escapes, AreDecoded) {
    for (const auto& c : caseTable("escapes.txt")) {
        std::string text = c[1];
        dp::ExcelXLSXReader::mParseCharString(text);
        EXPECT_EQ(text, c[2]) << c[0];
    }
}

TEST_F(Packages, NamesAreListedWithoutReading) {
    PackageBuilder::of({"", "<row><c><v>1</v></c></row>", "broken"})
        .set("xl/worksheets/sheet3.xml", "no XML")
        .write(file("book.xlsx"));
    dp::xlsxDataProvider provider;
    std::vector<std::string> names = {"old"};
    EXPECT_EQ(provider.GetWorksheets(file("book.xlsx").c_str(), names), 0);
    EXPECT_EQ(names, (std::vector<std::string>{"S1", "S2", "S3"}));
    EXPECT_EQ(provider.GetTempDirectoryPath(), "");

    PackageBuilder::of({""}).set("xl/_rels/workbook.xml.rels", "").write(file("bad.xlsx"));
    EXPECT_EQ(provider.GetWorksheets(file("bad.xlsx").c_str(), names), -25);
}

}  // namespace
