// Opening, closing and clearing of workbooks beside a floor: copy and unpack the package, pull
// every node of its parts with libxml2's reader, and append the values to one vector per column.
// Each run is a process of its own; ours and the floor's alternate, and the medians are compared.
//
// open [RUNS] [WORKLOAD]: RUNS of each (5 by default), of all workloads but the largest, or of one.

#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <deque>
#include <functional>
#include <string>
#include <sys/resource.h>
#include <sys/wait.h>
#include <vector>

#include <boost/filesystem.hpp>
#include <libxml/xmlreader.h>
#include <minizip/unzip.h>

#include "bench/workbooks.h"
#include "provider/xlsx_data_provider.h"
#include "readers/excel_xml_reader.h"

namespace {

namespace fs = boost::filesystem;
using bench::Content;
using bench::Workload;

struct Goal {
    Workload workload;
    double ratio;         // to the floor; 0 for none
    double bytesPerCell;  // 0 for none
};

const Goal kGoals[] = {
    {{"numbers 100,000 x 20", Content::Numbers, 1, 100000, 20}, 0.92, 30},
    {{"texts 100,000 x 10", Content::Texts, 1, 100000, 10}, 0.82, 70},
    {{"mixed 100,000 x 10", Content::Mixed, 1, 100000, 10}, 1.00, 40},
    {{"wide 1,000 x 2,000", Content::Numbers, 1, 1000, 2000}, 0.92, 30},
    {{"100 sheets of 1,000 x 10", Content::Mixed, 100, 1000, 10}, 0.95, 40},
    {{"small 20 x 5", Content::Mixed, 1, 20, 5}, 2.0, 0},
    {{"large 1,000,000 x 10", Content::Numbers, 1, 1000000, 10}, 0.95, 40},  // by hand
};

struct Measurement {
    double seconds;
    double bytes;  // the process's peak
};

// Runs `work` in a process of its own, so that no run finds the memory of another.
Measurement inProcess(const std::function<void()>& work) {
    int ends[2];
    if (pipe(ends) != 0) std::abort();
    const pid_t child = fork();
    if (child == 0) {
        const auto start = std::chrono::steady_clock::now();
        work();
        const std::chrono::duration<double> taken = std::chrono::steady_clock::now() - start;
        rusage usage{};
        getrusage(RUSAGE_SELF, &usage);
        const Measurement result{taken.count(), static_cast<double>(usage.ru_maxrss) * 1024};
        _exit(write(ends[1], &result, sizeof result) == sizeof result ? 0 : 1);
    }
    Measurement result{};
    int status = 0;
    const bool complete = read(ends[0], &result, sizeof result) == sizeof result;
    waitpid(child, &status, 0);
    close(ends[0]);
    close(ends[1]);
    if (!complete || status != 0) {
        std::fprintf(stderr, "open: a run failed\n");
        std::exit(1);
    }
    return result;
}

void openOurs(const std::string& path) {
    dp::xlsxDataProvider provider;
    if (provider.OpenFile(path.c_str(), dp::IDataProvider::FileAccess::Read) != 0) _exit(1);
    provider.CloseFile();
    provider.ClearWorksheets();
}

void listOurs(const std::string& path) {
    dp::xlsxDataProvider provider;
    std::vector<std::string> names;
    if (provider.GetWorksheets(path.c_str(), names) != 0) _exit(1);
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

void openFloor(const std::string& path) {
    const fs::path directory = unpackFloor(path);
    const std::vector<std::string> strings = readStringsFloor(directory / "xl/sharedStrings.xml");
    std::vector<std::deque<FloorColumn>> sheets;
    for (const auto& entry : fs::directory_iterator(directory / "xl/worksheets"))
        readSheetFloor(entry.path(), strings, sheets.emplace_back());
    sheets.clear();
    fs::remove_all(directory);
}

void listFloor(const std::string& path) { fs::remove_all(unpackFloor(path)); }

// --- XML Spreadsheet 2003 ---

void readOurs2003(const std::string& path) {
    dp::xlsxDataProvider provider;
    dp::ExcelXmlReader reader(path, "m/d/yy", 1.23456e30, &provider, nullptr);
    reader.mReadExcelWorkbook();
}

void passFloor2003(const std::string& path) {
    xmlTextReaderPtr reader = xmlReaderForFile(path.c_str(), nullptr, 0x60);
    while (xmlTextReaderRead(reader) == 1) {
    }
    xmlFreeTextReader(reader);
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

Medians measure(int runs, const std::function<void()>& ours, const std::function<void()>& floor) {
    std::vector<Measurement> oursRuns;
    std::vector<Measurement> floorRuns;
    for (int run = 0; run < runs; ++run) {
        oursRuns.push_back(inProcess(ours));
        floorRuns.push_back(inProcess(floor));
    }
    return {medianOf(oursRuns), medianOf(floorRuns)};
}

bool missed = false;  // any goal

void printRow(const char* name, const Medians& medians, double ratioGoal, double bytesPerCell,
              double bytesGoal) {
    const double ratio = medians.ours.seconds / medians.floor.seconds;
    missed = missed || (ratioGoal > 0 && ratio > ratioGoal) ||
             (bytesGoal > 0 && bytesPerCell > bytesGoal);
    std::printf("%-28s %9.1f %9.1f %7.2f", name, medians.ours.seconds * 1e3,
                medians.floor.seconds * 1e3, ratio);
    ratioGoal > 0 ? std::printf(" %6.2f", ratioGoal) : std::printf(" %6s", "-");
    bytesPerCell > 0 ? std::printf(" %9.1f", bytesPerCell) : std::printf(" %9s", "-");
    bytesGoal > 0 ? std::printf(" %6.0f\n", bytesGoal) : std::printf(" %6s\n", "-");
    std::fflush(stdout);
}

}  // namespace

int main(int argc, char** argv) {
    const int runs = argc > 1 ? std::max(1, std::atoi(argv[1])) : 5;
    const std::string only = argc > 2 ? argv[2] : "";
    const fs::path directory = fs::temp_directory_path() / fs::unique_path("bench-%%%%-%%%%");
    fs::create_directory(directory);
    const std::string book = (directory / "book.xlsx").string();

    const Workload& small = kGoals[5].workload;
    bench::writeWorkbook(book, small);
    const double idle = inProcess([&] { openOurs(book); }).bytes;

    std::printf("%-28s %9s %9s %7s %6s %9s %6s\n", "open, close and clear", "ours ms", "floor ms",
                "ratio", "goal", "B/cell", "goal");
    for (const Goal& goal : kGoals) {
        const std::string name = goal.workload.name;
        const bool large = goal.workload.rows > 100000;
        if (only.empty() ? large : name.find(only) == name.npos) continue;
        bench::writeWorkbook(book, goal.workload);
        const Medians medians = measure(
            runs, [&] { openOurs(book); }, [&] { openFloor(book); });
        const double bytes =
            (medians.ours.bytes - idle) / static_cast<double>(goal.workload.cells());
        printRow(name.c_str(), medians, goal.ratio, goal.bytesPerCell > 0 ? bytes : 0,
                 goal.bytesPerCell);
    }
    const std::string listing = "worksheet names, mixed";
    if (listing.find(only) != listing.npos) {
        bench::writeWorkbook(book, kGoals[2].workload);
        printRow(listing.c_str(),
                 measure(
                     runs, [&] { listOurs(book); }, [&] { listFloor(book); }),
                 1.1, 0, 0);
    }
    const std::string older = "XML 2003, 100,000 x 10";
    if (older.find(only) != older.npos) {
        const std::string document = (directory / "book.xml").string();
        bench::writeSpreadsheet2003(document, 100000, 10);
        printRow(older.c_str(),
                 measure(
                     runs, [&] { readOurs2003(document); }, [&] { passFloor2003(document); }),
                 1.5, 0, 0);
    }
    fs::remove_all(directory);
    return missed ? 1 : 0;
}
