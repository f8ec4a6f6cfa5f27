// Opening, closing and clearing of workbooks beside a floor: copy and unpack the package, pull
// every node of its parts with libxml2's reader, and append the values to one vector per column.

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <deque>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include <boost/filesystem.hpp>
#include <libxml/xmlreader.h>
#include <minizip/unzip.h>

#include "bench/harness.h"
#include "bench/workbooks.h"
#include "dpxlsx/model/host/entry_points.h"
#include "dpxlsx/provider/xlsx_data_provider.h"
#include "dpxlsx/readers/xml2003/excel_xml_reader.h"
#include "testkit/workspace.h"

namespace {

namespace fs = boost::filesystem;
using bench::Comment;
using bench::Content;
using bench::kNoGoal;
using bench::Order;
using bench::Report;
using bench::Workload;

struct Opening {
    Workload workload;
    double goal;  // ratio to the floor
    double mostBytesPerCell;
};

constexpr Opening kOpenings[] = {
    {{"numbers 100,000 x 20", Content::Numbers, 1, 100000, 20}, 0.29, 30},
    {{"texts 100,000 x 10", Content::Texts, 1, 100000, 10}, 0.30, 70},
    {{"mixed 100,000 x 10", Content::Mixed, 1, 100000, 10}, 0.32, 40},
    {{"wide 1,000 x 2,000", Content::Numbers, 1, 1000, 2000}, 0.31, 30},
    {{"100 sheets of 1,000 x 10", Content::Mixed, 100, 1000, 10}, 0.36, 40},
    {{"numbers 1,000,000 x 10", Content::Numbers, 1, 1000000, 10}, 0.32, 40}};
constexpr Workload kNumbers = kOpenings[0].workload;
constexpr Workload kTexts = kOpenings[1].workload;
constexpr Workload kMixed = kOpenings[2].workload;
constexpr Workload kSmall = {"small 20 x 5", Content::Mixed, 1, 20, 5};

struct Figures {
    double seconds;
    double closing;  // the part of closing the file, clearing and releasing
    double bytes;    // the process's peak
};

// Measures `work`, which returns how long closing took.
template <class Work>
auto measured(const Work& work) {
    return [&work] {
        Figures figures{};
        figures.seconds = bench::secondsOf([&] { figures.closing = work(); });
        figures.bytes = bench::peakBytes();
        return figures;
    };
}

template <class Ours, class Floor>
auto compare(const Report& report, const Ours& ours, const Floor& floor) {
    return bench::compare(report.rounds(), measured(ours), measured(floor));
}

// Writes a workbook in a process of its own, so that this one, with whose memory all runs begin,
// stays small.
std::string written(const testkit::Workspace& workspace, const Workload& workload,
                    const char* name = "book.xlsx") {
    std::string path = workspace.file(name);
    bench::inChild([&] {
        bench::writeWorkbook(path, workload);
        return Figures{};
    });
    return path;
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

void openWith(dp::IDataProvider& provider, const std::string& path) {
    bench::require(provider.OpenFile(path.c_str(), dp::IDataProvider::FileAccess::Read) == 0,
                   "the workbook does not open");
}

// Opens, closes and clears; `look` is called while the workbook is open.
template <class Look>
double openOurs(const std::string& path, unsigned long cells, const Look& look) {
    std::optional<Provider> provider(std::in_place);
    provider->SetReadOptionDefaultUseVariableNameRow(dp::VNR_NONE);
    openWith(*provider, path);
    bench::requireCount(provider->cells(), cells, "cells");
    look(*provider);
    return bench::secondsOf([&] {
        provider->CloseFile();
        provider->ClearWorksheets();
        provider.reset();
    });
}

double openOurs(const std::string& path, unsigned long cells) {
    return openOurs(path, cells, [](const auto&) {});
}

void pullColumns(Provider& provider, unsigned long cells) {
    unsigned long values = 0;
    bench::forEachColumn(provider,
                         [&](const dp::IColumn& column) { values += bench::valuesOf(column); });
    bench::requireCount(values, cells, "values");
}

// Loads columns too, because cells filed out of order are merged when columns are first loaded.
double openAndLoadOurs(const std::string& path, unsigned long cells) {
    return openOurs(path, cells, [cells](Provider& provider) { pullColumns(provider, cells); });
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

// --- the rows ---

void openings(Report& report) {
    const testkit::Workspace workspace;
    const std::string small = written(workspace, kSmall);
    const auto openSmall = [&] { return openOurs(small, kSmall.cells()); };
    const double idle = bench::inChild(measured(openSmall)).bytes;
    for (const auto& [workload, goal, mostBytes] : kOpenings) {
        const std::string name = workload.name;
        if (!report.wants(name)) continue;
        const std::string book = written(workspace, workload);
        const unsigned long cells = workload.cells();
        const auto [ours, floor] = compare(
            report, [&] { return openOurs(book, cells); }, [&] { return openFloor(book, cells); });
        report.add({name + ", ms", ours.seconds * 1e3, floor.seconds * 1e3, goal});
        report.add({name + ": closing / the whole floor, ms", ours.closing * 1e3,
                    floor.seconds * 1e3, 0.05});
        report.add({name + ": bytes a cell",
                    (ours.bytes - idle) / static_cast<double>(cells),
                    {},
                    kNoGoal,
                    mostBytes});
    }
}

// In a process that has opened a workbook before, as a host has that imports more than one.
void openSmall(Report& report) {
    const std::string name = std::string(kSmall.name) + ", ms";
    if (!report.wants(name)) return;
    constexpr int kTimes = 50;
    const testkit::Workspace workspace;
    const std::string book = written(workspace, kSmall);
    const auto often = [](const auto& open) {
        return [&open] {
            open();
            return Figures{bench::secondsOf([&] {
                               for (int i = 0; i < kTimes; ++i) open();
                           }) / kTimes,
                           0, 0};
        };
    };
    const auto [ours, floor] =
        bench::compare(report.rounds(), often([&] { return openOurs(book, kSmall.cells()); }),
                       often([&] { return openFloor(book, kSmall.cells()); }));
    report.add({name, ours.seconds * 1e3, floor.seconds * 1e3, kNoGoal, 1.2});
}

// Parts that the reader of plain parts reads to their very end, before it leaves them to libxml2,
// beside the sum of both ways: the same workbook once with plain parts, and once with parts that
// are left to libxml2 from the beginning.
void plainToTheEnd(Report& report) {
    for (Workload workload : {kNumbers, kTexts}) {
        const std::string name = std::string(workload.name) + ", not plain at the end / both, ms";
        if (!report.wants(name)) continue;
        const testkit::Workspace workspace;
        const std::string plain = written(workspace, workload, "plain.xlsx");
        workload.comment = Comment::First;
        const std::string any = written(workspace, workload, "any.xlsx");
        workload.comment = Comment::Last;
        const std::string late = written(workspace, workload, "late.xlsx");
        const unsigned long cells = workload.cells();
        const auto [ours, floor] = compare(
            report, [&] { return openOurs(late, cells); },
            [&] { return openOurs(plain, cells) + openOurs(any, cells); });
        report.add({name, ours.seconds * 1e3, floor.seconds * 1e3, 1.0});
    }
}

// All columns of a workbook that has just been opened.
void pulling(Report& report) {
    for (const auto& [workload, limit] : {std::pair{kNumbers, 10.0}, {kTexts, 130.0}}) {
        const std::string name = std::string(workload.name) + ", columns pulled, ns a value";
        if (!report.wants(name)) continue;
        const testkit::Workspace workspace;
        const std::string book = written(workspace, workload);
        const unsigned long cells = workload.cells();
        const auto pull = [&] {
            Figures figures{};
            openOurs(book, cells, [&](Provider& provider) {
                figures.seconds = bench::secondsOf([&] { pullColumns(provider, cells); });
            });
            return figures;
        };
        const double seconds = bench::measure(report.rounds(), pull).seconds;
        report.add({name, seconds * 1e9 / static_cast<double>(cells), {}, kNoGoal, limit});
    }
}

void listing(Report& report) {
    const std::string name = "worksheet names of the mixed workbook, ms";
    if (!report.wants(name)) return;
    const testkit::Workspace workspace;
    const std::string book = written(workspace, kMixed);
    const auto [ours, floor] = compare(
        report, [&] { return listOurs(book, kMixed.sheets); }, [&] { return listFloor(book); });
    report.add({name, ours.seconds * 1e3, floor.seconds * 1e3, 1.1});
}

void older(Report& report) {
    const std::string name = "XML 2003, 100,000 x 10 / bare pass, ms";
    if (!report.wants(name)) return;
    constexpr unsigned kRows = 100'000;
    constexpr unsigned kColumns = 10;
    constexpr unsigned kCells = kRows * kColumns;
    const testkit::Workspace workspace;
    const std::string document = workspace.file("book.xml");
    bench::writeSpreadsheet2003(document, kRows, kColumns);
    const auto [ours, floor] = compare(
        report, [&] { return readOurs2003(document, kCells); },
        [&] { return passFloor2003(document, kCells); });
    report.add({name, ours.seconds * 1e3, floor.seconds * 1e3, 1.5});
}

// Opens of which the host is told beside opens of which it is not. They take turns in one process,
// and the shortest of each counts: the difference is smaller than what the machine adds to most of
// them.
void told(Report& report) {
    constexpr int kTurns = 10;
    constexpr Workload kAny = {"mixed 100,000 x 10 by libxml2",
                               Content::Mixed,
                               1,
                               100000,
                               10,
                               Order::Ascending,
                               Comment::First};
    const auto goOn = [](double, void*) { return 0; };
    for (const Workload& workload : {kMixed, kAny, kSmall}) {
        const std::string name = std::string(workload.name) + ", told / untold, ms";
        if (!report.wants(name)) continue;
        const testkit::Workspace workspace;
        const std::string book = written(workspace, workload);
        const int opens = workload.rows < 100 ? 100 : 1;
        const auto seconds = [&](bool isTold) {
            return bench::secondsOf([&] {
                for (int i = 0; i < opens; ++i) {
                    dp::xlsxDataProvider provider;
                    if (isTold) dp::SetProgress(&provider, goOn, nullptr);
                    openWith(provider, book);
                }
            });
        };
        struct Turns {
            double told = bench::kNoGoal;
            double untold = bench::kNoGoal;
        };
        const auto turns = bench::measure(report.rounds(), [&] {
            Turns shortest;
            for (int turn = 0; turn < kTurns; ++turn) {
                shortest.told = std::min(shortest.told, seconds(true));
                shortest.untold = std::min(shortest.untold, seconds(false));
            }
            return shortest;
        });
        report.add({name, turns.told * 1e3 / opens, turns.untold * 1e3 / opens, 1.005});
    }
}

// Compares rows out of order with the same rows in order.
void order(Report& report, Workload workload, Order other, const std::string& what, double goal) {
    const std::string name = what + workload.name + ", ms";
    if (!report.wants(name)) return;
    const testkit::Workspace workspace;
    const unsigned long cells = workload.cells();
    const std::string ordered = written(workspace, workload, "ordered.xlsx");
    workload.order = other;
    const std::string book = written(workspace, workload);
    const auto [ours, floor] = compare(
        report, [&] { return openAndLoadOurs(book, cells); },
        [&] { return openAndLoadOurs(ordered, cells); });
    report.add({name, ours.seconds * 1e3, floor.seconds * 1e3, goal});
}

void orders(Report& report) {
    constexpr Workload kInOrder[] = {{"100,000 x 10", Content::Numbers, 1, 100000, 10},
                                     {"1,000,000 x 2", Content::Numbers, 1, 1000000, 2}};
    for (const Workload& workload : kInOrder) {
        order(report, workload, Order::Descending, "rows descending, ", 1.2);
        order(report, workload, Order::Random, "rows in random order, ", 1.5);
    }
}

void measureAll(Report& report) {
    for (const auto topic :
         {openings, openSmall, plainToTheEnd, pulling, listing, told, older, orders})
        topic(report);
}

}  // namespace

int main(int argc, char** argv) { return bench::run(argc, argv, measureAll); }
