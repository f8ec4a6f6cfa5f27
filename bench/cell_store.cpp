// Compares the cell store with plain maps of maps: time and resident memory, each measured in a
// process of its own, the best of several runs. Cells are filed as a reader files them, through one
// record that is reused. The exit code is 1 when a goal is missed, and 2 when a measurement fails
// or does not see every cell.

#include <unistd.h>

#include <algorithm>
#include <array>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <map>
#include <memory>
#include <string>
#include <sys/wait.h>
#include <vector>

#include "bench/verify.h"
#include "dpxlsx/store/worksheet_cells.h"

namespace {

using bench::require;
using dp::ExternalDataRecord;
using dp::WorksheetCells;

constexpr int kRuns = 3;

class PlainCells : public std::map<unsigned, std::map<unsigned, dp::ExternalDataRecordCell>> {
  public:
    void add(const ExternalDataRecord& record) { (*this)[record.column][record.row] = record.cell; }
};

double valueOf(const dp::CellView& cell) { return cell.numValue(); }
double valueOf(const dp::ExternalDataRecordCell& cell) { return cell.numValue; }

// Seconds, and bytes per cell.
struct Figures {
    double file = 1e9;
    double bytes = 1e9;
    double walk = 1e9;
    double destroy = 1e9;
    double sum = 0.0;
    unsigned long cells = 0;  // counted by the walk

    void keepBest(const Figures& other) {
        file = std::min(file, other.file);
        bytes = std::min(bytes, other.bytes);
        walk = std::min(walk, other.walk);
        destroy = std::min(destroy, other.destroy);
        sum = other.sum;
        cells = other.cells;
    }
};

double residentBytes() {
    std::ifstream statm("/proc/self/statm");
    double total = 0;
    double resident = 0;
    statm >> total >> resident;
    return resident * static_cast<double>(sysconf(_SC_PAGESIZE));
}

template <typename Work>
double secondsOf(const Work& work) {
    const auto start = std::chrono::steady_clock::now();
    work();
    return std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
}

template <typename Measure>
Figures inOwnProcess(const Measure& measure) {
    std::array<int, 2> ends{};
    require(pipe(ends.data()) == 0, "pipe");
    const pid_t child = fork();
    require(child >= 0, "fork");
    if (child == 0) {
        const Figures figures = measure();
        const bool written = write(ends[1], &figures, sizeof figures) == sizeof figures;
        _exit(written ? 0 : 2);
    }
    Figures figures;
    close(ends[1]);
    require(read(ends[0], &figures, sizeof figures) == sizeof figures, "measurement");
    close(ends[0]);
    waitpid(child, nullptr, 0);
    return figures;
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
    Figures figures;
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

struct Pair {
    Figures ours;
    Figures plain;
};

template <typename MakeFill>
Pair compare(unsigned count, const MakeFill& makeFill) {
    Pair best;
    for (int run = 0; run < kRuns; ++run) {
        best.ours.keepBest(
            inOwnProcess([&] { return measure<WorksheetCells>(count, makeFill()); }));
        best.plain.keepBest(inOwnProcess([&] { return measure<PlainCells>(count, makeFill()); }));
    }
    require(best.ours.sum == best.plain.sum, "the two stores differ");
    require(best.ours.cells == count && best.plain.cells == count, "cells are missing");
    return best;
}

bool allReached = true;

void printHead() {
    std::printf("%-44s %10s %10s %7s %7s\n", "", "ours", "std::map", "ratio", "goal");
}

// A goal of 0 means that there is none.
void printRow(const std::string& what, double ours, double plain, double goal) {
    const double ratio = ours / plain;
    const bool reached = goal == 0.0 || ratio <= goal;
    allReached = allReached && reached;
    std::printf("%-44s %10.2f %10.2f %7.3f ", what.c_str(), ours, plain, ratio);
    if (goal != 0.0) std::printf("%7.2f%s", goal, reached ? "" : "  MISSED");
    std::printf("\n");
}

void printLimit(const std::string& what, double ours, double limit) {
    const bool reached = ours <= limit;
    allReached = allReached && reached;
    std::printf("%-44s %10.2f %10s %7s %7.2f%s\n", what.c_str(), ours, "", "", limit,
                reached ? "" : "  MISSED");
}

struct Goals {
    double file;
    double bytes;
    double walk;
    double destroy;
};

void printPair(const std::string& what, const Pair& pair, unsigned count, const Goals& goals) {
    const double nanoseconds = 1e9 / count;
    printRow(what + ": file, ns", pair.ours.file * nanoseconds, pair.plain.file * nanoseconds,
             goals.file);
    printRow(what + ": resident bytes", pair.ours.bytes, pair.plain.bytes, goals.bytes);
    printRow(what + ": walk, ns", pair.ours.walk * nanoseconds, pair.plain.walk * nanoseconds,
             goals.walk);
    printRow(what + ": destroy, ns", pair.ours.destroy * nanoseconds,
             pair.plain.destroy * nanoseconds, goals.destroy);
}

void setNumber(ExternalDataRecord& record, unsigned row, unsigned column) {
    record.row = row;
    record.column = column;
    record.cell.type = dp::CELL_NUMBER;
    record.cell.numValue = row * 0.5 + column;
    record.cell.formatIndex = static_cast<int>(column % 7);
}

void numbers() {
    constexpr unsigned kCells = 2'000'000;
    for (const unsigned columns : {20U, 1U, 16384U}) {
        const Pair pair = compare(kCells, [=] {
            return [=](ExternalDataRecord& record, unsigned i) {
                setNumber(record, i / columns, i % columns);
            };
        });
        const bool main = columns == 20;
        printPair(std::to_string(columns) + " columns, row by row", pair, kCells,
                  main ? Goals{0.3, 0.25, 0.1, 0.1} : Goals{});
        if (main) printLimit("20 columns, row by row: bytes a cell", pair.ours.bytes, 28.0);
    }
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

void outOfOrder() {
    constexpr unsigned kRows = 300'000;
    const Pair descending = compare(kRows, [] {
        return [](ExternalDataRecord& record, unsigned i) { setNumber(record, kRows - i, 0); };
    });
    printPair("descending rows", descending, kRows, {1.0, 0, 0, 0});
    const Pair random = compare(kRows, [] {
        return [rows = shuffledRows(kRows)](ExternalDataRecord& record, unsigned i) {
            setNumber(record, rows[i], 0);
        };
    });
    printPair("random rows", random, kRows, {1.0, 0, 0, 0});
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
void texts() {
    constexpr unsigned kCells = 1'000'000;
    constexpr unsigned kDistinct = kCells / 2;
    const auto filled = [](std::uint64_t secondStep) {
        return compare(kCells, [=] {
            return [=](ExternalDataRecord& record, unsigned i) {
                setText(record, i, i < kDistinct ? 7919 : secondStep, kDistinct);
            };
        });
    };
    printPair("texts of 26 bytes, half distinct", filled(7919), kCells, {0.6, 0.5, 0, 0});
    printPair("same texts, scattered repeats", filled(104'729), kCells, {0.6, 0.5, 0, 0});
}

// A shared string of 1 MB in 100,000 cells.
void bigText() {
    constexpr unsigned kCells = 100'000;
    const Figures figures = inOwnProcess([] {
        ExternalDataRecord record(0, 0, 0, 0);
        record.cell.type = dp::CELL_TEXT;
        record.cell.textValue.assign(1'000'000, 'x');
        Figures measured;
        const double before = residentBytes();
        WorksheetCells cells;
        measured.file = secondsOf([&] {
            for (; record.row < kCells; ++record.row) cells.add(record);
        });
        measured.bytes = residentBytes() - before;
        measured.cells = cells.begin()->second.size();
        return measured;
    });
    require(figures.cells == kCells, "cells are missing");
    printLimit("1 MB text in 100,000 cells: MB", figures.bytes / 1e6, 8.0);
    std::printf("%-44s %10.2f\n", "  ns a cell", figures.file / kCells * 1e9);
}

}  // namespace

int main() {
    return bench::resultOf([] {
        printHead();
        numbers();
        texts();
        bigText();
        outOfOrder();
        return allReached ? 0 : 1;
    });
}
