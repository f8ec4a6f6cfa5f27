// Compares the cell store with plain maps of maps: time and resident memory. Cells are filed as a
// reader files them, through one record that is reused.

#include <unistd.h>

#include <cstdint>
#include <fstream>
#include <map>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "bench/harness.h"
#include "dpxlsx/store/worksheet_cells.h"

namespace {

using bench::kNoGoal;
using bench::secondsOf;
using dp::ExternalDataRecord;
using dp::WorksheetCells;

class PlainCells : public std::map<unsigned, std::map<unsigned, dp::ExternalDataRecordCell>> {
  public:
    void add(const ExternalDataRecord& record) { (*this)[record.column][record.row] = record.cell; }
};

double valueOf(const dp::CellView& cell) { return cell.numValue(); }
double valueOf(const dp::ExternalDataRecordCell& cell) { return cell.numValue; }

// Seconds, and bytes per cell.
struct Figures {
    double file;
    double bytes;
    double walk;
    double destroy;
    double sum;
    double cells;  // counted by the walk
};

double residentBytes() {
    std::ifstream statm("/proc/self/statm");
    double total = 0;
    double resident = 0;
    statm >> total >> resident;
    return resident * static_cast<double>(sysconf(_SC_PAGESIZE));
}

template <typename Cells>
void walk(const Cells& cells, Figures& figures) {
    for (const auto& column : cells)
        for (auto cell = column.second.begin(); cell != column.second.end(); ++cell) {
            figures.sum += valueOf(cell->second) + cell->first;
            ++figures.cells;
        }
}

// Files `count` records made by `fill`. The time of filing includes the first read, which merges
// cells filed out of order.
template <typename Cells, typename Fill>
Figures measure(unsigned count, const Fill& fill) {
    Figures figures{};
    const double before = residentBytes();
    auto cells = std::make_unique<Cells>();
    figures.file = secondsOf([&] {
        ExternalDataRecord record(0, 0, 0, 0);
        for (unsigned i = 0; i < count; ++i) {
            fill(record, i);
            cells->add(record);
        }
        figures.sum = cells->begin()->second.begin()->first;
    });
    figures.bytes = (residentBytes() - before) / count;
    figures.walk = secondsOf([&] { walk(*cells, figures); });
    figures.destroy = secondsOf([&] { cells.reset(); });
    return figures;
}

struct CellGoals {
    double file = kNoGoal;
    double bytes = kNoGoal;
    double walk = kNoGoal;
    double destroy = kNoGoal;
    double mostBytes = kNoGoal;
};

// Files `count` records made by a new `makeFill()` into each of the two stores.
template <typename MakeFill>
void compare(bench::Report& report, const std::string& name, unsigned count, const CellGoals& goals,
             const MakeFill& makeFill) {
    if (!report.wants(name)) return;
    const auto [ours, plain] = bench::compare(
        report.rounds(), [&] { return measure<WorksheetCells>(count, makeFill()); },
        [&] { return measure<PlainCells>(count, makeFill()); });
    bench::require(ours.sum == plain.sum, "the two stores differ");
    bench::require(ours.cells == count && plain.cells == count, "cells are missing");
    const double nanoseconds = 1e9 / count;
    report.add(
        {name + ": file, ns", ours.file * nanoseconds, plain.file * nanoseconds, goals.file});
    report.add({name + ": resident bytes", ours.bytes, plain.bytes, goals.bytes, goals.mostBytes});
    report.add(
        {name + ": walk, ns", ours.walk * nanoseconds, plain.walk * nanoseconds, goals.walk});
    report.add({name + ": destroy, ns", ours.destroy * nanoseconds, plain.destroy * nanoseconds,
                goals.destroy});
}

void setNumber(ExternalDataRecord& record, unsigned row, unsigned column) {
    record.row = row;
    record.column = column;
    record.cell.type = dp::CELL_NUMBER;
    record.cell.numValue = row * 0.5 + column;
    record.cell.formatIndex = static_cast<int>(column % 7);
}

void numbers(bench::Report& report) {
    constexpr CellGoals kUsual{0.3, 0.25, 0.1, 0.1, 28.0};
    for (const unsigned columns : {20U, 1U, 16384U})
        compare(report, std::to_string(columns) + " columns, row by row", 2'000'000,
                columns == 20 ? kUsual : CellGoals{}, [=] {
                    return [=](ExternalDataRecord& record, unsigned i) {
                        setNumber(record, i / columns, i % columns);
                    };
                });
}

// The rows in pseudo-random order: a full-period generator modulo a power of two, without the
// numbers out of range.
std::vector<unsigned> shuffledRows(unsigned count) {
    std::vector<unsigned> rows;
    for (unsigned i = 0, state = 1; i < 1U << 19; ++i) {
        state = (state * 1664525U + 1013904223U) % (1U << 19);
        if (state < count) rows.push_back(state);
    }
    for (unsigned i = 0; i < count; ++i) std::swap(rows[i], rows[(i * 40503ULL + 77) % count]);
    return rows;
}

void outOfOrder(bench::Report& report) {
    constexpr unsigned kRows = 300'000;
    compare(report, "descending rows", kRows, {1.0}, [] {
        return [](ExternalDataRecord& record, unsigned i) { setNumber(record, kRows - i, 0); };
    });
    compare(report, "random rows", kRows, {1.0}, [] {
        return [rows = shuffledRows(kRows)](ExternalDataRecord& record, unsigned i) {
            setNumber(record, rows[i], 0);
        };
    });
}

// Sets one of `distinct` texts, composed in a local buffer, as a parser would deliver it.
void setText(ExternalDataRecord& record, unsigned i, std::uint64_t step, unsigned distinct) {
    char text[] = "customer number 0000000000";
    auto number = static_cast<unsigned>(i * step % distinct);
    for (char* digit = text + sizeof text - 2; number > 0; --digit, number /= 10)
        *digit = static_cast<char>('0' + number % 10);
    record.row = i / 10;
    record.column = i % 10;
    record.cell.type = dp::CELL_TEXT;
    record.cell.textValue.assign(text, sizeof text - 1);
}

// Every text twice: the second time in the order of the first time, or scattered, which is the
// worst case for all caches.
void texts(bench::Report& report) {
    constexpr unsigned kCells = 1'000'000;
    constexpr unsigned kDistinct = kCells / 2;
    const auto filled = [&report](const std::string& name, std::uint64_t secondStep) {
        compare(report, name, kCells, {0.6, 0.5}, [=] {
            return [=](ExternalDataRecord& record, unsigned i) {
                setText(record, i, i < kDistinct ? 7919 : secondStep, kDistinct);
            };
        });
    };
    filled("texts of 26 bytes, half distinct", 7919);
    filled("same texts, scattered repeats", 104'729);
}

// A shared string of 1 MB in 100,000 cells.
void bigText(bench::Report& report) {
    constexpr unsigned kCells = 100'000;
    const std::string name = "1 MB text in 100,000 cells";
    if (!report.wants(name)) return;
    const Figures figures = bench::inChild([] {
        ExternalDataRecord record(0, 0, 0, 0);
        record.cell.type = dp::CELL_TEXT;
        record.cell.textValue.assign(1'000'000, 'x');
        Figures measured{};
        const double before = residentBytes();
        WorksheetCells cells;
        measured.file = secondsOf([&] {
            for (; record.row < kCells; ++record.row) cells.add(record);
        });
        measured.bytes = residentBytes() - before;
        measured.cells = static_cast<double>(cells.begin()->second.size());
        return measured;
    });
    bench::require(figures.cells == kCells, "cells are missing");
    report.add({name + ": MB", figures.bytes / 1e6, {}, kNoGoal, 8.0});
    report.add({name + ": file, ns a cell", figures.file / kCells * 1e9, {}});
}

void measureAll(bench::Report& report) {
    for (const auto topic : {numbers, texts, bigText, outOfOrder}) topic(report);
}

}  // namespace

int main(int argc, char** argv) { return bench::run(argc, argv, measureAll); }
