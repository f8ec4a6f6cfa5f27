#include "testkit/package_builder.h"

#include "testkit/workspace.h"
#include "testkit/zip_writer.h"

namespace testkit {

PackageBuilder PackageBuilder::of(const std::vector<std::string>& sheets) {
    PackageBuilder package;
    std::string list;
    std::string relations;
    for (std::size_t i = 1; i <= sheets.size(); ++i) {
        const std::string n = std::to_string(i);
        list.append("<sheet name='S").append(n).append("' sheetId='").append(n);
        list.append("' r:id='r").append(n).append("'/>");
        relations += relation("r" + n, "worksheet", "worksheets/sheet" + n + ".xml");
        package.set("xl/worksheets/sheet" + n + ".xml", worksheet(sheets[i - 1]));
    }
    package.set("xl/workbook.xml", workbook(list));
    package.set("xl/_rels/workbook.xml.rels", relationships(relations));
    package.set("xl/styles.xml",
                "<styleSheet><cellXfs count='1'><xf numFmtId='0'/></cellXfs></styleSheet>");
    return package;
}

const PackageBuilder& PackageBuilder::small() {
    static const PackageBuilder package{{
        {"xl/workbook.xml", workbook("<sheet name='A' r:id='r1'/><sheet name='B' r:id='r2'/>")},
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
         "</worksheet>"},
    }};
    return package;
}

std::string PackageBuilder::worksheet(const std::string& data) {
    return "<worksheet><sheetData>" + data + "</sheetData></worksheet>";
}
std::string PackageBuilder::workbook(const std::string& sheets) {
    return "<workbook "
           "xmlns:r='http://schemas.openxmlformats.org/officeDocument/2006/relationships'>"
           "<bookViews/><sheets>" +
           sheets + "</sheets></workbook>";
}
std::string PackageBuilder::relationships(const std::string& list) {
    return "<Relationships>" + list + "</Relationships>";
}
std::string PackageBuilder::relation(const std::string& id, const std::string& type,
                                     const std::string& target) {
    return "<Relationship Id='" + id + "' Type='http://x/relationships/" + type + "' Target='" +
           target + "'/>";
}

PackageBuilder& PackageBuilder::set(const std::string& name, const std::string& content) {
    std::erase_if(parts, [&](const Part& part) { return part.first == name; });
    return content.empty() ? *this : add(name, content);
}

PackageBuilder& PackageBuilder::add(const std::string& name, const std::string& content) {
    parts.emplace_back(name, content);
    return *this;
}

std::string PackageBuilder::bytes() const {
    ZipWriter archive;
    for (const auto& [name, content] : parts) archive.add({name, content});
    return archive.finished();
}

void PackageBuilder::write(const std::string& path) const { writeFile(path, bytes()); }

void PackageBuilder::unpackTo(const std::string& directory) const {
    const boost::filesystem::path root(directory);
    for (const auto& [name, content] : parts) writeFile((root / name).string(), content);
}

}  // namespace testkit
