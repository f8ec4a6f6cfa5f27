#pragma once

#include <algorithm>
#include <array>
#include <bit>
#include <functional>
#include <limits>
#include <optional>
#include <string>
#include <vector>

#include "bench/verify.h"

// Each topic of the benchmarks is a program:
//
// TOPIC [--rounds N] [--json FILE] [WORD]
//
// measures N times (5 by default) and shows the medians of all rows, or of those whose names
// contain WORD, each beside its floor; with --json also writes them there. Ends with 1 when a goal
// is missed, and with 2 when a run did not do all of its work.
namespace bench {

constexpr double kNoGoal = std::numeric_limits<double>::infinity();

// One line of the report. The unit is part of the name.
struct Row {
    std::string name;
    double ours = 0;
    std::optional<double> floor;
    double goal = kNoGoal;   // the greatest ratio to the floor
    double limit = kNoGoal;  // the greatest value
};

// The greatest ratio to the floor and the greatest value of a row.
struct Goals {
    double ratio = kNoGoal;
    double limit = kNoGoal;
};

// What a program was asked for, and its report, which is printed row by row.
class Report {
  public:
    Report(int argc, char** argv);

    int rounds() const { return rounds_; }
    bool wants(const std::string& name) const { return name.find(word_) != name.npos; }
    void add(const Row& row);
    // Writes the file, if one is wanted; the program's exit code.
    int finish() const;

  private:
    int rounds_ = 5;
    std::string file_;
    std::string word_;
    std::vector<Row> rows_;
};

// The main function of a topic: pins the process to one core, so that the two sides of a row share
// its caches, and measures.
int run(int argc, char** argv, void (*measureAll)(Report&));

// The processor time of this process, of the user and of the system, in seconds.
double processorSeconds();

template <class Work>
double secondsOf(const Work& work) {
    const double start = processorSeconds();
    work();
    return processorSeconds() - start;
}

// The peak of this process's resident memory.
double peakBytes();

// Calls `work` in a process of its own and copies what it left in `result`, which has `size` bytes.
// Throws when it did not do all of its work.
void runInChild(const std::function<void()>& work, void* result, std::size_t size);

// The figures that `work` returns, a structure of doubles, measured in a process of its own.
template <class Work>
auto inChild(const Work& work) {
    decltype(work()) figures{};
    runInChild([&] { figures = work(); }, &figures, sizeof figures);
    return figures;
}

// The median of each of the figures.
template <class Figures>
Figures medianOf(const std::vector<Figures>& runs) {
    using Doubles = std::array<double, sizeof(Figures) / sizeof(double)>;
    Doubles medians;
    for (std::size_t i = 0; i < medians.size(); ++i) {
        std::vector<double> values;
        for (const Figures& figures : runs) values.push_back(std::bit_cast<Doubles>(figures)[i]);
        const auto middle = values.begin() + static_cast<std::ptrdiff_t>(values.size() / 2);
        std::nth_element(values.begin(), middle, values.end());
        medians[i] = *middle;
    }
    return std::bit_cast<Figures>(medians);
}

// The medians of a work that has no floor.
template <class Work>
auto measure(int rounds, const Work& work) {
    std::vector<decltype(work())> runs(static_cast<std::size_t>(rounds));
    for (auto& run : runs) run = inChild(work);
    return medianOf(runs);
}

template <class Figures>
struct Compared {
    Figures ours;
    Figures floor;
};

// The medians of both, which take turns.
template <class Ours, class Floor>
auto compare(int rounds, const Ours& ours, const Floor& floor) {
    using Figures = decltype(ours());
    std::vector<Figures> oursRuns(static_cast<std::size_t>(rounds));
    std::vector<Figures> floorRuns(oursRuns.size());
    for (std::size_t round = 0; round < oursRuns.size(); ++round) {
        oursRuns[round] = inChild(ours);
        floorRuns[round] = inChild(floor);
    }
    return Compared<Figures>{medianOf(oursRuns), medianOf(floorRuns)};
}

// Does some work and returns how many values or calls it was.
using Loop = std::function<double()>;

// Adds a row of nanoseconds for each of them, measured when the work has been done before. The
// floor may be missing.
void addLoops(Report& report, const std::string& name, const Goals& goals, const Loop& ours,
              const Loop& floor = {});

// Calls `call` with the numbers from 0 on; each call returns whether it did its work, and using the
// result keeps the compiler from removing it.
template <class Call>
double times(int count, const Call& call) {
    int done = 0;
    for (int i = 0; i < count; ++i) done += call(i) ? 1 : 0;
    require(done == count, "a call did nothing");
    return count;
}

}  // namespace bench
