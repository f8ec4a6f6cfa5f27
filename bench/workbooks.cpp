#include "bench/workbooks.h"

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <fstream>
#include <numeric>
#include <string_view>
#include <utility>
#include <vector>

#include "testkit/workspace.h"
#include "testkit/zip_writer.h"

namespace bench {

namespace {

using testkit::ZipWriter;

constexpr std::string_view kHead =
    "<?xml version=\"1.0\" encoding=\"UTF-8\" standalone=\"yes\"?>\n";
constexpr std::string_view kMain =
    "xmlns=\"http://schemas.openxmlformats.org/spreadsheetml/2006/main\"";

// A small generator with a fixed seed: the same workbook on every machine.
class Random {
  public:
    std::uint32_t next() {
        state_ = state_ * 6364136223846793005ULL + 1442695040888963407ULL;
        return static_cast<std::uint32_t>(state_ >> 33);
    }

  private:
    std::uint64_t state_ = 42;
};

std::string number(std::uint32_t random) {
    char text[32];
    std::snprintf(text, sizeof text, "%u.%03u", random % 100000, random / 7 % 1000);
    return text;
}

// 26 bytes.
std::string textOf(unsigned index) {
    char text[32];
    std::snprintf(text, sizeof text, "value number %07u of all", index);
    return text;
}

constexpr std::string_view kRelations =
    "<Relationships xmlns=\"http://schemas.openxmlformats.org/package/2006/relationships\">";

void addStyles(ZipWriter& package) {
    std::string styles(kHead);
    styles.append("<styleSheet ").append(kMain).append(">");
    styles += "<numFmts count=\"1\"><numFmt numFmtId=\"164\" formatCode=\"#,##0.000\"/></numFmts>";
    styles += "<fonts count=\"1\"><font><sz val=\"11\"/><name val=\"Calibri\"/></font></fonts>";
    styles += "<fills count=\"1\"><fill><patternFill patternType=\"none\"/></fill></fills>";
    styles += "<borders count=\"1\"><border><left/><right/><top/><bottom/></border></borders>";
    styles += "<cellStyleXfs count=\"1\"><xf numFmtId=\"0\"/></cellStyleXfs><cellXfs count=\"4\">";
    for (const char* format : {"0", "2", "14", "164"})
        styles.append("<xf numFmtId=\"").append(format) +=
            "\" fontId=\"0\" fillId=\"0\" borderId=\"0\" xfId=\"0\" applyNumberFormat=\"1\"/>";
    package.add({"xl/styles.xml", styles + "</cellXfs></styleSheet>"});
}

std::string relation(const std::string& id, const char* type, const std::string& target) {
    return "<Relationship Id=\"" + id +
           "\" Type=\"http://schemas.openxmlformats.org/officeDocument/2006/relationships/" + type +
           "\" Target=\"" + target + "\"/>";
}

std::string contentType(const std::string& part, const char* type) {
    return "<Override PartName=\"/xl/" + part +
           "\" ContentType=\"application/vnd.openxmlformats-officedocument.spreadsheetml." + type +
           "+xml\"/>";
}

// Adds the parts that link the others: content types, relationships, the workbook part.
void addWorkbook(ZipWriter& package, unsigned sheets, bool sharedStrings) {
    std::string workbook(kHead);
    std::string relations = std::string(kHead).append(kRelations);
    std::string types(kHead);
    types +=
        "<Types xmlns=\"http://schemas.openxmlformats.org/package/2006/content-types\">"
        "<Default Extension=\"rels\" "
        "ContentType=\"application/vnd.openxmlformats-package.relationships+xml\"/>";
    types += contentType("workbook.xml", "sheet.main") + contentType("styles.xml", "styles");
    relations += relation("styles", "styles", "styles.xml");
    if (sharedStrings) {
        types += contentType("sharedStrings.xml", "sharedStrings");
        relations += relation("strings", "sharedStrings", "sharedStrings.xml");
    }
    workbook.append("<workbook ").append(kMain);
    workbook += " xmlns:r=\"http://schemas.openxmlformats.org/officeDocument/2006/relationships\">";
    workbook += "<bookViews><workbookView/></bookViews><sheets>";
    for (unsigned i = 1; i <= sheets; ++i) {
        const std::string n = std::to_string(i);
        const std::string part = "worksheets/sheet" + n + ".xml";
        workbook += "<sheet name=\"Sheet" + n + "\" sheetId=\"" + n + "\" r:id=\"rId" + n + "\"/>";
        relations += relation("rId" + n, "worksheet", part);
        types += contentType(part, "worksheet");
    }
    package.add({"[Content_Types].xml", types + "</Types>"});
    package.add({"_rels/.rels", std::string(kHead).append(kRelations) +
                                    relation("rId1", "officeDocument", "xl/workbook.xml") +
                                    "</Relationships>"});
    package.add({"xl/workbook.xml", workbook + "</sheets></workbook>"});
    package.add({"xl/_rels/workbook.xml.rels", relations + "</Relationships>"});
}

// The comment, if it is there.
const char* commentAt(Comment place, const Workload& workload) {
    return workload.comment == place ? "<!-- -->" : "";
}

void addSharedStrings(ZipWriter& package, const Workload& workload, unsigned count) {
    const std::string n = std::to_string(count);
    package.begin("xl/sharedStrings.xml");
    package.write(std::string(kHead)
                      .append(commentAt(Comment::First, workload))
                      .append("<sst ")
                      .append(kMain)
                      .append(" count=\"" + n + "\" uniqueCount=\"" + n + "\">"));
    for (unsigned i = 0; i < count; ++i) package.write("<si><t>" + textOf(i) + "</t></si>");
    package.write(std::string(commentAt(Comment::Last, workload)) + "</sst>");
    package.end();
}

// The rest of a cell after `<c r="..."`.
std::string cellRest(Content content, unsigned column, std::uint32_t random, unsigned strings) {
    const auto shared = [&] {
        return " t=\"s\"><v>" + std::to_string(random % strings) + "</v></c>";
    };
    if (content == Content::Texts) return shared();
    if (content == Content::Numbers) return "><v>" + number(random) + "</v></c>";
    switch (column % 5) {
        case 0:
            return " s=\"1\"><v>" + number(random) + "</v></c>";
        case 1:
            return shared();
        case 2:
            return " s=\"2\"><v>" + std::to_string(40000 + random % 5000) + "</v></c>";
        case 3:
            return " t=\"b\"><v>" + std::to_string(random % 2) + "</v></c>";
        default:
            return " s=\"3\"><f>A1*2</f><v>" + number(random) + "</v></c>";
    }
}

// The row numbers (1-based) in the order in which the part has them.
std::vector<unsigned> rowsOf(const Workload& workload) {
    std::vector<unsigned> rows(workload.rows);
    std::iota(rows.begin(), rows.end(), 1U);
    if (workload.order == Order::Descending) std::reverse(rows.begin(), rows.end());
    if (workload.order == Order::Random) {
        Random random;
        for (unsigned i = workload.rows; i > 1; --i)
            std::swap(rows[i - 1], rows[random.next() % i]);
    }
    return rows;
}

void addWorksheet(ZipWriter& package, unsigned sheet, const Workload& workload, unsigned strings,
                  Random& random) {
    package.begin("xl/worksheets/sheet" + std::to_string(sheet) + ".xml");
    package.write(std::string(kHead)
                      .append(commentAt(Comment::First, workload))
                      .append("<worksheet ")
                      .append(kMain)
                      .append("><sheetData>"));
    for (const unsigned row : rowsOf(workload)) {
        const std::string r = std::to_string(row);
        std::string cells = "<row r=\"" + r + "\">";
        for (unsigned column = 0; column < workload.columns; ++column)
            cells += "<c r=\"" + columnName(column) + r + "\"" +
                     cellRest(workload.content, column, random.next(), strings);
        package.write(cells + "</row>");
    }
    package.write(std::string(commentAt(Comment::Last, workload)) + "</sheetData></worksheet>");
    package.end();
}

}  // namespace

std::string columnName(unsigned column) {
    std::string name;
    for (unsigned n = column + 1; n > 0; n = (n - 1) / 26)
        name.insert(name.begin(), static_cast<char>('A' + (n - 1) % 26));
    return name;
}

void writeWorkbook(const std::string& path, const Workload& workload) {
    ZipWriter package;
    Random random;
    const auto strings = static_cast<unsigned>(workload.cells() / 2 + 1);
    const bool sharedStrings = workload.content != Content::Numbers;
    addWorkbook(package, workload.sheets, sharedStrings);
    addStyles(package);
    if (sharedStrings) addSharedStrings(package, workload, strings);
    for (unsigned sheet = 1; sheet <= workload.sheets; ++sheet)
        addWorksheet(package, sheet, workload, strings, random);
    testkit::writeFile(path, package.finished());
}

void writeSpreadsheet2003(const std::string& path, unsigned rows, unsigned columns) {
    std::ofstream file(path);
    file << kHead << "<Workbook xmlns=\"urn:schemas-microsoft-com:office:spreadsheet\" "
         << "xmlns:ss=\"urn:schemas-microsoft-com:office:spreadsheet\"><Styles>"
         << "<Style ss:ID=\"s1\"><NumberFormat ss:Format=\"0.00\"/></Style></Styles>"
         << "<Worksheet ss:Name=\"Sheet1\"><Table ss:ExpandedColumnCount=\"" << columns
         << "\" ss:ExpandedRowCount=\"" << rows << "\">\n";
    Random random;
    for (unsigned row = 0; row < rows; ++row) {
        file << "<Row>";
        for (unsigned column = 0; column < columns; ++column) {
            const std::uint32_t value = random.next();
            if (column % 2 == 0)
                file << "<Cell ss:StyleID=\"s1\"><Data ss:Type=\"Number\">" << number(value)
                     << "</Data></Cell>";
            else
                file << "<Cell><Data ss:Type=\"String\">" << textOf(value % (rows * columns))
                     << "</Data></Cell>";
        }
        file << "</Row>\n";
    }
    file << "</Table><WorksheetOptions/></Worksheet></Workbook>\n";
}

}  // namespace bench
