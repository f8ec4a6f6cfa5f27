// Workbooks that could cause disproportionate work: cells in far corners, thousands of worksheets,
// relationships and styles, long format codes. Each is opened and its columns are loaded at full
// and at half size: a ratio far above 2 indicates quadratic time. Each must take less than a
// second. Then a workbook is opened many times in a row, which must leave memory, descriptors and
// the temporary directory as they were. Ends with 1 when a goal is missed, and with 2 when not all
// values were loaded.
//
// hostile [OPENS]: the number of opens in a row, 10,000 by default. The files are made on a file
// system in memory if there is one: on a disk, 10,000 files take longer than everything else.

#include <malloc.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <functional>
#include <string>
#include <sys/resource.h>
#include <sys/wait.h>
#include <vector>

#include <boost/filesystem.hpp>

#include "bench/verify.h"
#include "dpxlsx/model/host/i_column.h"
#include "dpxlsx/provider/xlsx_data_provider.h"
#include "dpxlsx/readers/limits.h"
#include "dpxlsx/readers/xml/xml_reader.h"
#include "testkit/package_builder.h"

namespace {

namespace fs = boost::filesystem;
using testkit::PackageBuilder;

constexpr double kMostSeconds = 1.0;
constexpr double kMostRatio = 3.0;

struct Measurement {
    double seconds = 0;
    double megabytes = 0;  // the peak of the process beyond its initial memory
    unsigned long values = 0;
};

double peakMegabytes() {
    rusage usage{};
    getrusage(RUSAGE_SELF, &usage);
    return static_cast<double>(usage.ru_maxrss) / 1024;
}

// Opens the workbook as a host that skips blank rows and pads columns, and loads all columns;
// returns the number of values.
unsigned long openAndLoad(const std::string& path) {
    dp::xlsxDataProvider provider;
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
    return values;
}

// Measures in a process of its own, so that runs do not affect each other's memory.
Measurement measure(const std::string& path) {
    int ends[2];
    if (pipe(ends) != 0) std::abort();
    const pid_t child = fork();
    if (child == 0) {
        Measurement result;
        const double before = peakMegabytes();
        const auto start = std::chrono::steady_clock::now();
        if (bench::resultOf([&] { return result.values = openAndLoad(path), 0; }) != 0) _exit(2);
        result.seconds =
            std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
        result.megabytes = peakMegabytes() - before;
        _exit(write(ends[1], &result, sizeof result) == sizeof result ? 0 : 1);
    }
    Measurement result;
    const bool complete = read(ends[0], &result, sizeof result) == sizeof result;
    waitpid(child, nullptr, 0);
    close(ends[0]);
    close(ends[1]);
    bench::require(complete, "a run failed");
    return result;
}

Measurement bestOf(int runs, const std::string& path) {
    Measurement best = measure(path);
    for (; runs > 1; --runs) {
        const Measurement other = measure(path);
        if (other.seconds < best.seconds) best = other;
    }
    return best;
}

// --- the workbooks ---

const std::string kRow = "<row><c><v>1</v></c></row>";
const std::string kNamedValue = "<row><c t='str'><v>name</v></c></row>" + kRow;

std::string repeat(unsigned count, const std::function<std::string(const std::string&)>& piece) {
    std::string all;
    for (unsigned i = 0; i < count; ++i) all += piece(std::to_string(i));
    return all;
}

std::string columnName(unsigned column) {
    std::string name(1, static_cast<char>('A' + column % 26));
    return column < 26 ? name : columnName(column / 26 - 1) + name;
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
    {"65,000 styles", manyStyles, 65000, 2, butFirst},
    {"100,000 strings", manyStrings, 100000, 2, butFirst},
    {"1,000 decimals in 100,000 cells", longFormat, 100000, 2, andOne},
    {"10,000 bytes in 5,000 cells", longText, 5000, 2, butFirst},
    {"500 x 500 cells backwards", backwards, 500, 4, allButFirstRow},
};

bool missed = false;

void run(const Case& c, const std::string& path) {
    c.build(c.size / 2).write(path);
    const Measurement half = bestOf(3, path);
    bench::requireCount(half.values, c.values(c.size / 2), std::string(c.name) + ", half of it");
    c.build(c.size).write(path);
    const Measurement whole = bestOf(3, path);
    bench::requireCount(whole.values, c.values(c.size), c.name);
    const double ratio = whole.seconds / half.seconds / (c.scale / 2);
    const bool slow = whole.seconds > kMostSeconds || (whole.seconds > 0.05 && ratio > kMostRatio);
    missed = missed || slow;
    std::printf("%-34s %9.1f %9.1f %7.2f %9.1f %10lu%s\n", c.name, half.seconds * 1e3,
                whole.seconds * 1e3, ratio, whole.megabytes, whole.values, slow ? "  missed" : "");
    std::fflush(stdout);
}

// --- many opens ---

long openDescriptors() {
    const fs::directory_iterator entries("/proc/self/fd");
    return std::distance(begin(entries), end(entries));
}

void openOften(unsigned times, const std::string& path, const fs::path& temporary) {
    PackageBuilder::of({kNamedValue, kNamedValue}).write(path);
    openAndLoad(path);
    const long descriptors = openDescriptors();
    const std::size_t memory = ::mallinfo2().uordblks;
    const double peak = peakMegabytes();
    const auto start = std::chrono::steady_clock::now();
    for (unsigned i = 0; i < times; ++i) bench::requireCount(openAndLoad(path), 2, "values");
    const std::chrono::duration<double> taken = std::chrono::steady_clock::now() - start;
    const auto bytes = static_cast<long>(::mallinfo2().uordblks - memory);
    const long more = openDescriptors() - descriptors;
    const bool clean = fs::is_empty(temporary);
    std::printf(
        "%u opens: %.2f ms each, %ld bytes and %ld descriptors more, peak %.1f MB more, "
        "temporary directory %s\n",
        times, taken.count() * 1e3 / times, bytes, more, peakMegabytes() - peak,
        clean ? "empty" : "not empty");
    missed = missed || bytes > 4096 || more != 0 || !clean;
}

}  // namespace

int main(int argc, char** argv) {
    const unsigned opens = argc > 1 ? static_cast<unsigned>(std::atoi(argv[1])) : 10000;
    const fs::path memory = "/dev/shm";
    const fs::path base = ::access(memory.c_str(), W_OK) == 0 ? memory : fs::temp_directory_path();
    const fs::path root = base / fs::unique_path("bench-%%%%-%%%%");
    const fs::path temporary = root / "tmp";
    fs::create_directories(temporary);
    ::setenv("TMPDIR", temporary.c_str(), 1);
    const std::string path = (root / "book.xlsx").string();
    std::printf("%-34s %9s %9s %7s %9s %10s\n", "open and load", "half ms", "whole ms", "ratio",
                "MB more", "values");
    const int result = bench::resultOf([&] {
        for (const Case& c : kCases) run(c, path);
        openOften(opens, path, temporary);
        return missed ? 1 : 0;
    });
    fs::remove_all(root);
    return result;
}
