#include "readers/xml_reader.h"
#include "tests/case_table.h"
#include "tests/package_builder.h"
#include "tests/recording_provider.h"
#include "tests/temporary_files.h"

// Packages of literal parts, read into a provider that notes what reaches it.
namespace {

using Access = dp::IDataProvider::FileAccess;

class Packages : public TemporaryFiles {
  protected:
    // The calls that reach the provider, and behind them "!13" when the reader fails or the result
    // code when it is not 0.
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
    // The records of one worksheet, without the frame around them.
    std::string readCells(const PackageBuilder& package) {
        std::string calls = read(package);
        for (const std::string frame : {"+S1 @0 ", "+S1 @0", " @0", "-0"})
            if (const auto at = calls.find(frame); at != calls.npos) calls.erase(at, frame.size());
        return calls.substr(std::min(calls.size(), calls.find_first_not_of(' ')));
    }
    std::string readRows(const std::string& rows) {
        return readCells(PackageBuilder::of({rows}).set("xl/sharedStrings.xml", kStrings));
    }

    const std::string kStrings =
        "<sst uniqueCount='6'>\n <si><t>zero</t></si>\n <si/><si><t>   </t></si>\n"
        "<si>\n <r><t>Ab</t></r>\n <r><rPr><b/></rPr><t xml:space='preserve'> cd</t></r>\n</si>"
        "<si><t>x_x005F_y</t></si><si><t>jp</t><rPh><t>ph</t></rPh></si></sst>";
};

TEST_F(Packages, CellsByPlaceAndKind) {
    for (const auto& c : caseTable("worksheet_cells.txt")) EXPECT_EQ(readRows(c[1]), c[2]) << c[0];
}

TEST_F(Packages, StylesDecideNumbersAndDates) {
    const std::string formats =
        "<numFmts count='2'><numFmt numFmtId='164' formatCode='yyyy-mm-dd'/>"
        "<numFmt numFmtId='14' formatCode='0.00'/><numFmt numFmtId='165' formatCode='h:mm'/>"
        "</numFmts>";
    const std::string cells =
        "<cellStyleXfs count='1'><xf numFmtId='9'/></cellStyleXfs><cellXfs%><xf numFmtId='14'/>"
        "<xf numFmtId='2'/><xf numFmtId='164'/><xf/><xf numFmtId='165'/><xf numFmtId='0'/>"
        "</cellXfs>";
    const std::string rows =
        "<row><c s='0'><v>1</v></c><c s='1'><v>1</v></c><c s='2'><v>1</v></c><c s='3'><v>1</v></c>"
        "<c s='4'><v>1</v></c><c s='5'><v>1</v></c><c s='6'><v>1</v></c><c "
        "s='-1'><v>1</v></c></row>";
    const auto withCount = [&](const std::string& count) {
        std::string text = cells;
        return text.replace(text.find('%'), 1, count);
    };
    // A custom format takes a place behind the 32 built-in ones; one that repeats a built-in id is
    // never found, and one beyond the declared count is not kept.
    const std::string expected = "0,0=d1#12 0,1=1#1 0,2=d1#32 0,3=1 0,4=1 0,5=1 0,6=1 0,7=1";
    const std::string builtInsOnly = "0,0=d1#12 0,1=1#1 0,2=1 0,3=1 0,4=1 0,5=1 0,6=1 0,7=1";
    const struct {
        const char* name;
        std::string styles;
        std::string expected;
    } cases[] = {
        {"as it should be", formats + withCount(" count='6'"), expected},
        {"cell formats without count", formats + withCount(""), expected},
        {"a hostile count", formats + withCount(" count='2147483647'"), expected},
        {"a negative count", formats + withCount(" count='-5'"), expected},
        {"no number formats", withCount(" count='6'"), builtInsOnly},
        {"number formats without count",
         "<numFmts><numFmt numFmtId='164' formatCode='yyyy'/></numFmts>" + withCount(" count='6'"),
         builtInsOnly},
    };
    for (const auto& c : cases)
        EXPECT_EQ(readCells(PackageBuilder::of({rows}).set(
                      "xl/styles.xml", "<styleSheet>" + c.styles + "</styleSheet>")),
                  c.expected)
            << c.name;
}

TEST_F(Packages, WorksheetsOfTheWorkbook) {
    const std::string one = "<row><c><v>1</v></c></row>";
    const auto sheets = [&](const std::string& list, const std::string& relations) {
        return PackageBuilder::of({one})
            .set("xl/workbook.xml", PackageBuilder::workbook(list))
            .set("xl/_rels/workbook.xml.rels", PackageBuilder::relationships(relations));
    };
    const auto relation = PackageBuilder::relation;
    std::string manySheets;
    std::string manyRelations;
    std::string manyCalls;
    for (int i = 0; i < 21; ++i) {
        const std::string n = std::to_string(i);
        manySheets += "<sheet name='N" + n + "' r:id='i" + n + "'/>";
        manyRelations += relation("i" + n, "worksheet", "worksheets/sheet1.xml");
        manyCalls += "+N" + n + " @" + n + " 0,0=1 ";
    }
    const std::string target = "worksheets/sheet1.xml";
    const auto withTarget = [&](const std::string& path) {
        return sheets("<sheet name='A' r:id='1'/>", relation("1", "worksheet", path));
    };
    const struct {
        const char* name;
        PackageBuilder package;
        std::string expected;
    } cases[] = {
        {"empty ones go, from the back", PackageBuilder::of({"", one, "<row><c t='e'/></row>"}),
         "+S1 @0 +S2 @1 0,0=1 +S3 @2 -2 -0 @0"},
        {"all empty", PackageBuilder::of({"", ""}), "+S1 @0 +S2 @1 -1 -0"},
        {"a chart sheet and an unknown relationship take no index",
         sheets("<sheet name='A' r:id='1'/><sheet name='C' r:id='2'/><sheet name='U' r:id='3'/>"
                "<sheet name='B' r:id='1'/>",
                relation("1", "worksheet", target) + relation("2", "chartsheet", target)),
         "+A @0 0,0=1 +B @1 0,0=1 @0"},
        {"more relationships than the lists begin with", sheets(manySheets, manyRelations),
         manyCalls + "@0"},
        {"the first of two relationships",
         sheets("<sheet name='A' r:id='1'/>",
                relation("1", "worksheet", target) + relation("1", "worksheet", "nowhere.xml")),
         "+A @0 0,0=1 @0"},
        {"target from the package's root", withTarget("/xl/worksheets/sheet1.xml"),
         "+A @0 0,0=1 @0"},
        {"target with dots", withTarget("../xl/./worksheets/x/../sheet1.xml"), "+A @0 0,0=1 @0"},
        {"target outside", withTarget("../../xl/worksheets/sheet1.xml"), "+A @0 !13"},
        {"part missing", withTarget("worksheets/none.xml"), "+A @0 !13"},
        {"no name", sheets("<sheet r:id='1'/>", relation("1", "worksheet", target)), "!13"},
        {"empty id", sheets("<sheet name='A' r:id=''/>", relation("1", "worksheet", target)),
         "!13"},
        {"no sheets element", PackageBuilder::of({one}).set("xl/workbook.xml", "<workbook/>"),
         "!13"},
        {"no relationships", PackageBuilder::of({one}).set("xl/_rels/workbook.xml.rels", ""),
         "!13"},
        {"another root", PackageBuilder::of({one}).set("xl/_rels/workbook.xml.rels", "<x/>"),
         "!13"},
        {"worksheet cut", PackageBuilder::of({one + "<row><c><v>2"}), "+S1 @0 !13"},
        {"styles broken", PackageBuilder::of({one}).set("xl/styles.xml", "<styleSheet>"), "!13"},
        {"no styles", PackageBuilder::of({one}).set("xl/styles.xml", ""), "!-25"},
        {"no workbook", PackageBuilder::of({one}).set("xl/workbook.xml", ""), "!-25"},
        {"workbook is no XML", PackageBuilder::of({one}).set("xl/workbook.xml", "PK"), "!-25"},
    };
    for (const auto& c : cases) EXPECT_EQ(read(c.package), c.expected) << c.name;
}

TEST_F(Packages, SharedStringTables) {
    const auto package =
        PackageBuilder::of({"<row><c t='s'><v>0</v></c><c t='s'><v>1</v></c></row>"});
    EXPECT_EQ(readCells(package), "") << "no such part";
    for (const auto& c : caseTable("shared_strings.txt"))
        EXPECT_EQ(readCells(PackageBuilder(package).set("xl/sharedStrings.xml", c[1])), c[2])
            << c[0];
}

TEST(Escapes, AreDecoded) {
    const struct {
        const char* text;
        std::string expected;
    } cases[] = {{"a_x005F_b", "a_b"},
                 {"a_x000D__x000A_b", "a\r\nb"},
                 {"_x0009_", "\t"},
                 {"_x0000_", "_x0000_"},
                 {"_x0041_", "_x0041_"},
                 {"_x0020_", "_x0020_"},
                 {"_x001f_", "_x001f_"},
                 {"_x000a_", std::string(1, '\0')},  // a small letter counts as 0
                 {"_x001E_", "\x1e"},
                 {"ab_x00zz", "ab_x00zz"},
                 {"_x00", "_x00"},
                 {"_x00_x000A_", "_x00\n"},
                 {"_x005F_x000A_", "_x000A_"},
                 {"", ""}};
    for (const auto& c : cases) {
        std::string text = c.text;
        dp::ExcelXLSXReader::mParseCharString(text);
        EXPECT_EQ(text, c.expected) << c.text;
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
