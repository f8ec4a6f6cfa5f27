#include "fuzz/parts.h"

namespace fuzz {

const std::map<std::string, std::string>& soundParts() {
    static const std::map<std::string, std::string> parts = {
        {"xl/workbook.xml",
         "<workbook xmlns:r='r'><bookViews/><sheets><sheet name='A' r:id='r1'/>"
         "<sheet name='B' r:id='r2'/></sheets></workbook>"},
        {"xl/_rels/workbook.xml.rels",
         "<Relationships><Relationship Id='r1' Type='x/worksheet' Target='worksheets/sheet1.xml'/>"
         "<Relationship Id='r2' Type='x/worksheet' Target='/xl/worksheets/sheet2.xml'/>"
         "</Relationships>"},
        {"xl/sharedStrings.xml",
         "<sst uniqueCount='3'><si><t>name</t></si><si><r><t>a</t></r><r><t> b</t></r></si>"
         "<si><t>x_x000A_y</t></si></sst>"},
        {"xl/styles.xml",
         "<styleSheet><numFmts count='2'><numFmt numFmtId='164' formatCode='yyyy\\-mm\\-dd'/>"
         "<numFmt numFmtId='165' formatCode='0.000'/></numFmts><cellXfs count='4'>"
         "<xf numFmtId='0'/><xf numFmtId='164'/><xf numFmtId='165'/><xf numFmtId='10'/>"
         "</cellXfs></styleSheet>"},
        {"xl/worksheets/sheet1.xml",
         "<worksheet><sheetData><row r='1'><c r='A1' t='s'><v>0</v></c>"
         "<c r='B1' t='inlineStr'><is><t>when</t></is></c><c r='C1' t='s'><v>2</v></c></row>"
         "<row r='2'><c r='A2' s='2'><v>1.5</v></c><c r='B2' s='1'><v>45000</v></c>"
         "<c r='C2' t='s'><v>1</v></c></row><row r='4'><c r='A4' s='3'><v>-2</v></c>"
         "<c r='C4' t='str'><f>A1</f><v>t</v></c></row></sheetData></worksheet>"},
        {"xl/worksheets/sheet2.xml",
         "<worksheet><sheetData><row><c><v>1</v></c><c t='b'><v>1</v></c></row></sheetData>"
         "</worksheet>"}};
    return parts;
}

}  // namespace fuzz
