// Opening, closing and clearing of workbooks beside a floor: copy and unpack the package, pull
// every node of its parts with libxml2's reader, and append the values to one vector per column.
// Each run is a process of its own; runs of the library and of the floor alternate, and their
// medians are compared.
//
// open [RUNS] [WORKLOAD]: RUNS runs (5 by default) of all workloads but the largest, or of those
// whose names contain WORKLOAD; "large" selects the largest. Ends with 1 when a goal is missed, and
// with 2 when a run did not do all of its work.

#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <deque>
#include <functional>
#include <optional>
#include <string>
#include <sys/resource.h>
#include <sys/wait.h>
#include <utility>
#include <vector>

#include <boost/filesystem.hpp>
#include <libxml/xmlreader.h>
#include <minizip/unzip.h>

#include "bench/verify.h"
#include "bench/workbooks.h"
#include "dpxlsx/provider/xlsx_data_provider.h"
#include "dpxlsx/readers/xml2003/excel_xml_reader.h"

namespace {

namespace fs = boost::filesystem;
using bench::Content;
using bench::Workload;

struct Goal {
    Workload workload;
    double ratio;             // to the floor; 0 for none
    double bytesPerCell;      // 0 for none
    double milliseconds = 0;  // 0 for none
};

const Goal kGoals[] = {
    {{"numbers 100,000 x 20", Content::Numbers, 1, 100000, 20}, 0.92, 30},
    {{"texts 100,000 x 10", Content::Texts, 1, 100000, 10}, 0.82, 70},
    {{"mixed 100,000 x 10", Content::Mixed, 1, 100000, 10}, 1.00, 40},
    {{"wide 1,000 x 2,000", Content::Numbers, 1, 1000, 2000}, 0.92, 30},
    {{"100 sheets of 1,000 x 10", Content::Mixed, 100, 1000, 10}, 0.95, 40},
    {{"small 20 x 5", Content::Mixed, 1, 20, 5}, 0, 0, 2.0},
    {{"large 1,000,000 x 10", Content::Numbers, 1, 1000000, 10},
     0.95,
     40},  // only when named on the command line
};

struct Measurement {
    double seconds;
    double closing;  // seconds from closing the file to the end
    double bytes;    // the process's peak
};

double secondsSince(std::chrono::steady_clock::time_point start) {
    return std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
}

// Runs `work`, which returns how long closing took, in a process of its own, so that runs do not
// affect each other's memory.
Measurement inProcess(const std::function<double()>& work) {
    int ends[2];
    if (pipe(ends) != 0) std::abort();
    const pid_t child = fork();
    if (child == 0) {
        const auto start = std::chrono::steady_clock::now();
        double closing = 0;
        if (bench::resultOf([&] { return closing = work(), 0; }) != 0) _exit(2);
        const double seconds = secondsSince(start);
        rusage usage{};
        getrusage(RUSAGE_SELF, &usage);
        const Measurement result{seconds, closing, static_cast<double>(usage.ru_maxrss) * 1024};
        _exit(write(ends[1], &result, sizeof result) == sizeof result ? 0 : 1);
    }
    Measurement result{};
    int status = 0;
    const bool complete = read(ends[0], &result, sizeof result) == sizeof result;
    waitpid(child, &status, 0);
    close(ends[0]);
    close(ends[1]);
    bench::require(complete && status == 0, "a run failed");
    return result;
}

class Provider : public dp::xlsxDataProvider {
  public:
    unsigned long cells() const {
        unsigned long count = 0;
        for (const dp::WorksheetCells& worksheet : _cells)
            for (const auto& column : worksheet) count += column.second.size();
        return count;
    }
};

// Opens, closes and clears; `look` is called while the workbook is open.
template <class Look>
double openOurs(const std::string& path, unsigned long cells, const Look& look) {
    std::optional<Provider> provider(std::in_place);
    provider->SetReadOptionDefaultUseVariableNameRow(dp::VNR_NONE);
    bench::require(provider->OpenFile(path.c_str(), dp::IDataProvider::FileAccess::Read) == 0,
                   "the workbook does not open");
    bench::requireCount(provider->cells(), cells, "cells");
    look(*provider);
    const auto start = std::chrono::steady_clock::now();
    provider->CloseFile();
    provider->ClearWorksheets();
    provider.reset();
    return secondsSince(start);
}

double openOurs(const std::string& path, unsigned long cells) {
    return openOurs(path, cells, [](const auto&) {});
}

// Loads columns too, because cells filed out of order are merged when columns are first loaded.
double openAndLoadOurs(const std::string& path, unsigned long cells) {
    return openOurs(path, cells, [cells](Provider& provider) {
        unsigned long values = 0;
        bench::forEachColumn(provider,
                             [&](const dp::IColumn& column) { values += bench::valuesOf(column); });
        bench::requireCount(values, cells, "values");
    });
}

double listOurs(const std::string& path, unsigned sheets) {
    dp::xlsxDataProvider provider;
    std::vector<std::string> names;
    bench::require(provider.GetWorksheets(path.c_str(), names) == 0, "no names of worksheets");
    bench::requireCount(names.size(), sheets, "names of worksheets");
    return 0;
}

// --- the floor ---

fs::path unpackFloor(const std::string& path) {
    const fs::path directory = fs::temp_directory_path() / fs::unique_path("%%%%-%%%%");
    fs::create_directory(directory);
    const fs::path copy = directory / "copy.xlsx";
    fs::copy_file(path, copy);
    unzFile archive = unzOpen64(copy.c_str());
    std::vector<char> buffer(8192);
    for (int result = unzGoToFirstFile(archive); result == UNZ_OK;
         result = unzGoToNextFile(archive)) {
        char name[256] = {};
        unzGetCurrentFileInfo64(archive, nullptr, name, 255, nullptr, 0, nullptr, 0);
        const fs::path target = directory / name;
        fs::create_directories(target.parent_path());
        unzOpenCurrentFile(archive);
        std::FILE* file = std::fopen(target.c_str(), "wb");
        for (int size = 0; (size = unzReadCurrentFile(archive, buffer.data(), 8192)) > 0;)
            std::fwrite(buffer.data(), 1, static_cast<std::size_t>(size), file);
        std::fclose(file);
        unzCloseCurrentFile(archive);
    }
    unzClose(archive);
    return directory;
}

bool named(xmlTextReaderPtr reader, const char* name) {
    return xmlStrEqual(xmlTextReaderConstName(reader), reinterpret_cast<const xmlChar*>(name));
}

const char* attribute(xmlTextReaderPtr reader, const char* name) {
    if (xmlTextReaderMoveToAttribute(reader, reinterpret_cast<const xmlChar*>(name)) != 1)
        return nullptr;
    return reinterpret_cast<const char*>(xmlTextReaderConstValue(reader));
}

const char* textOf(xmlTextReaderPtr reader) {
    xmlTextReaderRead(reader);
    const auto* value = reinterpret_cast<const char*>(xmlTextReaderConstValue(reader));
    return value ? value : "";
}

std::vector<std::string> readStringsFloor(const fs::path& part) {
    std::vector<std::string> strings;
    xmlTextReaderPtr reader = xmlReaderForFile(part.c_str(), nullptr, 0x60);
    while (reader && xmlTextReaderRead(reader) == 1)
        if (xmlTextReaderNodeType(reader) == XML_READER_TYPE_ELEMENT && named(reader, "t"))
            strings.emplace_back(textOf(reader));
    if (reader) xmlFreeTextReader(reader);
    return strings;
}

struct FloorColumn {
    std::vector<double> numbers;
    std::vector<std::string> texts;
};

void readSheetFloor(const fs::path& part, const std::vector<std::string>& strings,
                    std::deque<FloorColumn>& columns) {
    xmlTextReaderPtr reader = xmlReaderForFile(part.c_str(), nullptr, 0x60);
    std::size_t column = 0;
    bool shared = false;
    int style = -1;
    while (xmlTextReaderRead(reader) == 1) {
        if (xmlTextReaderNodeType(reader) != XML_READER_TYPE_ELEMENT) continue;
        if (named(reader, "c")) {
            column = 0;
            if (const char* r = attribute(reader, "r"))
                for (; *r >= 'A'; ++r) column = column * 26 + static_cast<std::size_t>(*r - 64);
            const char* type = attribute(reader, "t");
            shared = type && std::strcmp(type, "s") == 0;
            const char* s = attribute(reader, "s");
            style = s ? std::atoi(s) : -1;
            if (columns.size() <= column) columns.resize(column + 1);
        } else if (named(reader, "v")) {
            const char* text = textOf(reader);
            if (shared)
                columns[column].texts.push_back(strings[static_cast<std::size_t>(std::atoi(text))]);
            else
                columns[column].numbers.push_back(std::atof(text) + 0 * style);
        }
    }
    xmlFreeTextReader(reader);
}

double openFloor(const std::string& path, unsigned long cells) {
    const fs::path directory = unpackFloor(path);
    const std::vector<std::string> strings = readStringsFloor(directory / "xl/sharedStrings.xml");
    std::vector<std::deque<FloorColumn>> sheets;
    for (const auto& entry : fs::directory_iterator(directory / "xl/worksheets"))
        readSheetFloor(entry.path(), strings, sheets.emplace_back());
    unsigned long values = 0;
    for (const auto& sheet : sheets)
        for (const FloorColumn& column : sheet)
            values += column.numbers.size() + column.texts.size();
    bench::requireCount(values, cells, "values of the floor");
    sheets.clear();
    fs::remove_all(directory);
    return 0;
}

double listFloor(const std::string& path) {
    const fs::path directory = unpackFloor(path);
    bench::require(fs::exists(directory / "xl/workbook.xml"), "the floor unpacks nothing");
    fs::remove_all(directory);
    return 0;
}

// --- XML Spreadsheet 2003 ---

double readOurs2003(const std::string& path, unsigned long cells) {
    Provider provider;
    dp::ExcelXmlReader reader(path, "m/d/yy", 1.23456e30, &provider, nullptr);
    reader.mReadExcelWorkbook();
    bench::requireCount(provider.cells(), cells, "cells");
    return 0;
}

double passFloor2003(const std::string& path, unsigned long cells) {
    xmlTextReaderPtr reader = xmlReaderForFile(path.c_str(), nullptr, 0x60);
    unsigned long texts = 0;
    while (xmlTextReaderRead(reader) == 1)
        if (xmlTextReaderNodeType(reader) == XML_READER_TYPE_TEXT) ++texts;
    xmlFreeTextReader(reader);
    bench::requireCount(texts, cells, "texts of the bare pass");
    return 0;
}

// --- the table ---

struct Medians {
    Measurement ours;
    Measurement floor;
};

Measurement medianOf(std::vector<Measurement> runs) {
    const auto middle = runs.begin() + static_cast<std::ptrdiff_t>(runs.size() / 2);
    std::nth_element(runs.begin(), middle, runs.end(),
                     [](const auto& a, const auto& b) { return a.seconds < b.seconds; });
    return *middle;
}

using Work = std::function<double()>;

Medians measure(int runs, const Work& ours, const Work& floor) {
    std::vector<Measurement> oursRuns;
    std::vector<Measurement> floorRuns;
    for (int run = 0; run < runs; ++run) {
        oursRuns.push_back(inProcess(ours));
        floorRuns.push_back(inProcess(floor));
    }
    return {medianOf(oursRuns), medianOf(floorRuns)};
}

bool missed = false;  // any goal

// Prints a value beside its goal; 0 means that there is none.
void printFigure(int width, int digits, double value, double goal) {
    missed = missed || (goal > 0 && value > goal);
    std::printf(" %*.*f", width, digits, value);
    goal > 0 ? std::printf(" %5.2f", goal) : std::printf(" %5s", "-");
}

void printTimes(const std::string& name, const Medians& medians, double goal) {
    std::printf("%-36s %9.1f %9.1f", name.c_str(), medians.ours.seconds * 1e3,
                medians.floor.seconds * 1e3);
    printFigure(6, 2, medians.ours.seconds / medians.floor.seconds, goal);
}

void endRow() {
    std::printf("\n");
    std::fflush(stdout);
}

// The runs, workloads and files of one invocation of the program.
class Program {
  public:
    Program(int runs, std::string only, const fs::path& directory)
        : runs_(runs),
          only_(std::move(only)),
          book_((directory / "book.xlsx").string()),
          document_((directory / "book.xml").string()) {}

    void openings() {
        bench::writeWorkbook(book_, kGoals[5].workload);
        const unsigned long few = kGoals[5].workload.cells();
        const double idle = inProcess([&] { return openOurs(book_, few); }).bytes;
        std::printf("%-36s %9s %9s %6s %5s %6s %5s %6s %5s\n", "open, close and clear", "ours ms",
                    "floor ms", "ratio", "goal", "close", "goal", "B/cell", "goal");
        for (const Goal& goal : kGoals) {
            const bool large = goal.workload.rows > 100000;
            if (large ? only_ != "large" : !isWanted(goal.workload.name)) continue;
            bench::writeWorkbook(book_, goal.workload);
            const unsigned long cells = goal.workload.cells();
            const Medians medians = measure(
                runs_, [&] { return openOurs(book_, cells); },
                [&] { return openFloor(book_, cells); });
            printTimes(goal.workload.name, medians, goal.ratio);
            if (goal.bytesPerCell > 0) {
                const double bytes = medians.ours.bytes - idle;
                printFigure(6, 3, medians.ours.closing / medians.floor.seconds, 0.05);
                printFigure(6, 1, bytes / static_cast<double>(cells), goal.bytesPerCell);
            }
            if (goal.milliseconds > 0) {
                std::printf("  ms:");
                printFigure(4, 1, medians.ours.seconds * 1e3, goal.milliseconds);
            }
            endRow();
        }
    }

    void listing() {
        const std::string name = "worksheet names of the mixed workbook";
        if (!isWanted(name)) return;
        bench::writeWorkbook(book_, kGoals[2].workload);
        const Medians medians = measure(
            runs_, [this] { return listOurs(book_, kGoals[2].workload.sheets); },
            [this] { return listFloor(book_); });
        printTimes(name, medians, 1.1);
        endRow();
    }

    void older() {
        const std::string name = "XML 2003, 100,000 x 10 / bare pass";
        if (!isWanted(name)) return;
        constexpr unsigned kRows = 100'000;
        constexpr unsigned kColumns = 10;
        bench::writeSpreadsheet2003(document_, kRows, kColumns);
        const Medians medians = measure(
            runs_, [this] { return readOurs2003(document_, kRows * kColumns); },
            [this] { return passFloor2003(document_, kRows * kColumns); });
        printTimes(name, medians, 1.5);
        endRow();
    }

    // Compares rows out of order with the same rows in order.
    void orders() {
        const Workload inOrder[] = {{"100,000 x 10", Content::Numbers, 1, 100000, 10},
                                    {"1,000,000 x 2", Content::Numbers, 1, 1000000, 2}};
        for (const Workload& workload : inOrder) {
            order(workload, bench::Order::Descending, "rows descending, ", 1.2);
            order(workload, bench::Order::Random, "rows in random order, ", 1.5);
        }
    }

  private:
    bool isWanted(const std::string& name) const { return name.find(only_) != name.npos; }

    void order(Workload workload, bench::Order other, const std::string& what, double goal) const {
        const std::string name = what + workload.name;
        if (!isWanted(name)) return;
        const std::string ordered = book_ + ".ordered.xlsx";
        bench::writeWorkbook(ordered, workload);
        workload.order = other;
        bench::writeWorkbook(book_, workload);
        const Medians medians = measure(
            runs_, [&] { return openAndLoadOurs(book_, workload.cells()); },
            [&] { return openAndLoadOurs(ordered, workload.cells()); });
        printTimes(name, medians, goal);
        endRow();
    }

    int runs_;
    std::string only_;
    std::string book_;
    std::string document_;
};

}  // namespace

int main(int argc, char** argv) {
    const fs::path directory = fs::temp_directory_path() / fs::unique_path("bench-%%%%-%%%%");
    fs::create_directory(directory);
    const int result = bench::resultOf([&] {
        Program program(argc > 1 ? std::max(1, std::atoi(argv[1])) : 5, argc > 2 ? argv[2] : "",
                        directory);
        program.openings();
        program.listing();
        program.older();
        program.orders();
        return missed ? 1 : 0;
    });
    fs::remove_all(directory);
    return result;
}
