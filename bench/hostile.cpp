// Workbooks that could cause disproportionate work: cells in far corners, thousands of worksheets,
// relationships and styles, long format codes. Each is opened and its columns are loaded; the floor
// is the same at half the size, twice: a ratio far above 1 indicates quadratic time. Then a
// workbook is opened many times in a row, which must leave memory, descriptors and the temporary
// directory as they were. The files are made on a file system in memory if there is one: on a disk,
// 10,000 files take longer than everything else.

#include <functional>
#include <iterator>
#include <string>
#include <vector>

#include <boost/filesystem.hpp>

#include "bench/harness.h"
#include "bench/workbooks.h"
#include "dpxlsx/provider/xlsx_data_provider.h"
#include "dpxlsx/readers/limits.h"
#include "dpxlsx/readers/xml/xml_reader.h"
#include "testkit/allocated_bytes.h"
#include "testkit/package_builder.h"
#include "testkit/workspace.h"

namespace {

namespace fs = boost::filesystem;
using bench::columnName;
using bench::kNoGoal;
using dp::ReadingRules;
using testkit::PackageBuilder;
using testkit::Workspace;

// Opens the workbook as a host that skips blank rows and pads columns, and loads all columns, which
// must have that many values.
void openAndLoad(const std::string& path, unsigned long expected,
                 ReadingRules rules = ReadingRules::Default) {
    dp::xlsxDataProvider provider;
    provider.setReadingRules(rules);
    provider.SetReadOptionIgnoreBlankRows(true);
    provider.SetReadOptionPadColumnsWithMissingValues(true);
    try {
        bench::require(provider.OpenFile(path.c_str(), dp::IDataProvider::FileAccess::Read) == 0,
                       "the workbook does not open");
    } catch (const CmXmlException&) {
        bench::require(false, "the workbook cannot be read");
    }
    unsigned long values = 0;
    bench::forEachColumn(provider,
                         [&](const dp::IColumn& column) { values += bench::valuesOf(column); });
    bench::requireCount(values, expected, "values");
}

// --- the workbooks ---

const std::string kRow = "<row><c><v>1</v></c></row>";
const std::string kNamedValue = "<row><c t='str'><v>name</v></c></row>" + kRow;

std::string repeat(unsigned count, const std::function<std::string(const std::string&)>& piece) {
    std::string all;
    for (unsigned i = 0; i < count; ++i) all += piece(std::to_string(i));
    return all;
}

PackageBuilder farCorners(unsigned columns) {
    std::string cells;
    for (unsigned column = 0; column < columns; ++column)
        cells += "<c r='" + columnName(column) + "1048576'><v>1</v></c>";
    return PackageBuilder::of({"<row r='1048576'>" + cells + "</row>"});
}

// Like the one above, but each column's cell is in a row of its own, so that few rows are blank in
// all columns.
PackageBuilder diagonal(unsigned columns) {
    std::string rows;
    for (unsigned column = 0; column < columns; ++column) {
        const std::string row = std::to_string((column + 1) * (1048576 / columns));
        rows += "<row r='" + row + "'><c r='" + columnName(column) + row + "'><v>1</v></c></row>";
    }
    return PackageBuilder::of({rows});
}

PackageBuilder manyWorksheets(unsigned sheets) {
    return PackageBuilder::of(std::vector<std::string>(sheets, kNamedValue));
}

PackageBuilder manyEmptyWorksheets(unsigned sheets) {
    return PackageBuilder::of(std::vector<std::string>(sheets, ""));
}

PackageBuilder manyRelationships(unsigned count) {
    const auto relation = [](const std::string& i) {
        return PackageBuilder::relation("x" + i, "worksheet", "worksheets/none" + i + ".xml");
    };
    const auto sheet = [](const std::string& i) {
        return "<sheet name='" + i + "' r:id='unknown" + i + "'/>";
    };
    return PackageBuilder::of({kNamedValue})
        .set("xl/workbook.xml",
             PackageBuilder::workbook(repeat(count, sheet) + "<sheet name='S' r:id='r1'/>"))
        .set("xl/_rels/workbook.xml.rels",
             PackageBuilder::relationships(
                 repeat(count, relation) +
                 PackageBuilder::relation("r1", "worksheet", "worksheets/sheet1.xml")));
}

// Many styles, each with its own number format and a cell that uses it.
PackageBuilder manyStyles(unsigned count) {
    const auto code = [](const std::string& i) {
        return "<numFmt numFmtId='" + i + "' formatCode='yyyy\\-mm&quot;" + i + "&quot;'/>";
    };
    const auto style = [](const std::string& i) { return "<xf numFmtId='" + i + "'/>"; };
    const auto cell = [](const std::string& i) {
        return "<row><c s='" + i + "'><v>1</v></c></row>";
    };
    return PackageBuilder::of({repeat(count, cell)})
        .set("xl/styles.xml", "<styleSheet><numFmts count='" + std::to_string(count) + "'>" +
                                  repeat(count, code) + "</numFmts><cellXfs>" +
                                  repeat(count, style) + "</cellXfs></styleSheet>");
}

// Number formats of as many sections as a code can have, which no cell uses.
PackageBuilder manySections(unsigned count) {
    const std::string sections(dp::kFormatCodeSize, ';');
    const auto code = [&](const std::string& i) {
        return "<numFmt numFmtId='" + i + "' formatCode='" + sections + "'/>";
    };
    const auto style = [](const std::string& i) { return "<xf numFmtId='" + i + "'/>"; };
    return PackageBuilder::of({kNamedValue})
        .set("xl/styles.xml", "<styleSheet><numFmts>" + repeat(count, code) +
                                  "</numFmts><cellXfs>" + repeat(count, style) +
                                  "</cellXfs></styleSheet>");
}

// A text column of numbers, whose format has as many decimals as a code can have.
PackageBuilder longFormat(unsigned rows) {
    const auto cell = [](const std::string& i) {
        return "<row><c s='0'><v>" + i + ".5</v></c></row>";
    };
    const std::string code = "0." + std::string(dp::kFormatCodeSize - 2, '0');
    return PackageBuilder::of({"<row/><row><c t='str'><v>text</v></c></row>" + repeat(rows, cell)})
        .set("xl/styles.xml",
             "<styleSheet><numFmts count='1'><numFmt numFmtId='164' formatCode='" + code +
                 "'/></numFmts><cellXfs><xf numFmtId='164'/></cellXfs></styleSheet>");
}

// A text of 10,000 bytes in many cells, cut to 80 when they are loaded.
PackageBuilder longText(unsigned rows) {
    const auto cell = [](const std::string&) {
        return std::string("<row><c t='s'><v>0</v></c></row>");
    };
    return PackageBuilder::of({repeat(rows, cell)})
        .set("xl/sharedStrings.xml",
             "<sst uniqueCount='1'><si><t>" + std::string(10000, 'a') + "</t></si></sst>");
}

PackageBuilder manyStrings(unsigned count) {
    const auto text = [](const std::string& i) { return "<si><t>" + i + "</t></si>"; };
    const auto cell = [](const std::string& i) {
        return "<row><c t='s'><v>" + i + "</v></c></row>";
    };
    return PackageBuilder::of({repeat(count, cell)})
        .set("xl/sharedStrings.xml",
             "<sst uniqueCount='2147483647'>" + repeat(count, text) + "</sst>");
}

// Columns from the last to the first, rows from the last to the first.
PackageBuilder backwards(unsigned side) {
    std::string rows;
    for (unsigned row = side; row > 0; --row) {
        rows += "<row r='" + std::to_string(row) + "'>";
        for (unsigned column = side; column > 0; --column)
            rows += "<c r='" + columnName(column - 1) + "1'><v>1</v></c>";
        rows += "</row>";
    }
    return PackageBuilder::of({rows});
}

struct Case {
    const char* name;
    PackageBuilder (*build)(unsigned size);
    unsigned size;
    double scale;  // the factor by which the work grows when the size doubles
    unsigned long (*values)(unsigned long size);
    ReadingRules rules = ReadingRules::Default;
};

unsigned long none(unsigned long) { return 0; }
unsigned long one(unsigned long) { return 1; }
unsigned long each(unsigned long size) { return size; }
// The first row holds the names.
unsigned long butFirst(unsigned long size) { return size - 1; }
unsigned long allButFirstRow(unsigned long side) { return side * (side - 1); }
unsigned long andOne(unsigned long size) { return size + 1; }

constexpr Case kCases[] = {
    {"1 cell far below in 200 columns", farCorners, 200, 2, each},
    {"1 cell in each of 200 columns", diagonal, 200, 4, each},
    {"10,000 worksheets", manyWorksheets, 10000, 2, each},
    {"10,000 empty worksheets", manyEmptyWorksheets, 10000, 2, none},
    {"10,000 relationships and sheets", manyRelationships, 10000, 2, one},
    {"the same by the standard", manyRelationships, 10000, 2, one, ReadingRules::Standard},
    {"65,000 styles", manyStyles, 65000, 2, butFirst},
    {"20,000 formats of 1,024 sections", manySections, 20000, 2, one, ReadingRules::Standard},
    {"100,000 strings", manyStrings, 100000, 2, butFirst},
    {"1,000 decimals in 100,000 cells", longFormat, 100000, 2, andOne},
    {"10,000 bytes in 5,000 cells", longText, 5000, 2, butFirst},
    {"500 x 500 cells backwards", backwards, 500, 4, allButFirstRow},
};

struct Figures {
    double seconds;
    double bytes;  // the peak of the process beyond its initial memory
};

void run(bench::Report& report, const Case& c) {
    constexpr double kMostMilliseconds = 1000;
    constexpr double kShort = 50;  // milliseconds, below which a ratio says little
    if (!report.wants(c.name)) return;
    const Workspace workspace(Workspace::Place::Memory);
    const auto opening = [&](unsigned size, const char* name) {
        const std::string path = workspace.file(name);
        c.build(size).write(path);
        return [&c, path, values = c.values(size)] {
            const double before = bench::peakBytes();
            const double seconds = bench::secondsOf([&] { openAndLoad(path, values, c.rules); });
            return Figures{seconds, bench::peakBytes() - before};
        };
    };
    const auto [whole, half] = bench::compare(report.rounds(), opening(c.size, "whole.xlsx"),
                                              opening(c.size / 2, "half.xlsx"));
    const double milliseconds = whole.seconds * 1e3;
    report.add({c.name + std::string(", ms"), milliseconds, half.seconds * 1e3 * c.scale,
                milliseconds > kShort ? 1.5 : kNoGoal, kMostMilliseconds});
    report.add({c.name + std::string(": peak, MB"), whole.bytes / 1e6, {}});
}

// --- many opens ---

long openDescriptors() {
    const fs::directory_iterator entries("/proc/self/fd");
    return std::distance(begin(entries), end(entries));
}

void openOften(bench::Report& report) {
    constexpr int kTimes = 10'000;
    const std::string name = std::to_string(kTimes) + " opens";
    if (!report.wants(name)) return;
    struct Often {
        double seconds;
        double bytes;
        double peak;
        double descriptors;
        double files;
    };
    const Workspace workspace(Workspace::Place::Memory);
    const std::string path = workspace.file("book.xlsx");
    PackageBuilder::of({kNamedValue, kNamedValue}).write(path);
    const Often often = bench::inChild([&] {
        openAndLoad(path, 2);
        const long descriptors = openDescriptors();
        const auto bytes = static_cast<double>(testkit::allocatedBytes());
        const double peak = bench::peakBytes();
        const double seconds = bench::secondsOf([&] {
            for (int i = 0; i < kTimes; ++i) openAndLoad(path, 2);
        });
        const fs::directory_iterator left(workspace.temporary());
        return Often{seconds, static_cast<double>(testkit::allocatedBytes()) - bytes,
                     bench::peakBytes() - peak,
                     static_cast<double>(openDescriptors() - descriptors),
                     static_cast<double>(std::distance(begin(left), end(left)))};
    });
    report.add({name + ": each, ms", often.seconds * 1e3 / kTimes, {}});
    report.add({name + ": allocated bytes more", often.bytes, {}, kNoGoal, 4096});
    report.add({name + ": peak, MB more", often.peak / 1e6, {}});
    report.add({name + ": descriptors more", often.descriptors, {}, kNoGoal, 0});
    report.add({name + ": temporary files left", often.files, {}, kNoGoal, 0});
}

void measureAll(bench::Report& report) {
    for (const Case& c : kCases) run(report, c);
    openOften(report);
}

}  // namespace

int main(int argc, char** argv) { return bench::run(argc, argv, measureAll); }
