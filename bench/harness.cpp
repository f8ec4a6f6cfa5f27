#include "bench/harness.h"

#include <sched.h>
#include <time.h>
#include <unistd.h>

#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <string_view>
#include <sys/resource.h>
#include <sys/wait.h>

#include <nlohmann/json.hpp>

namespace bench {

namespace {

double ratioOf(const Row& row) { return row.floor ? row.ours / *row.floor : 0; }

bool isMissed(const Row& row) { return row.ours > row.limit || ratioOf(row) > row.goal; }

void printOptional(int width, int digits, double value, bool given) {
    given ? std::printf(" %*.*f", width, digits, value) : std::printf(" %*s", width, "-");
}

void printHead() {
    std::printf("%-56s %12s %12s %7s %7s %9s\n", "", "ours", "floor", "ratio", "goal", "limit");
}

void print(const Row& row) {
    std::printf("%-56s %12.2f", row.name.c_str(), row.ours);
    printOptional(12, 2, row.floor.value_or(0), row.floor.has_value());
    printOptional(7, 3, ratioOf(row), row.floor.has_value());
    printOptional(7, 3, row.goal, std::isfinite(row.goal));
    printOptional(9, 2, row.limit, std::isfinite(row.limit));
    std::printf("%s\n", isMissed(row) ? "  MISSED" : "");
    std::fflush(stdout);
}

// To the last of the cores that it may run on: the first ones tend to handle interrupts.
void pinToOneCore() {
    cpu_set_t cores;
    require(sched_getaffinity(0, sizeof cores, &cores) == 0, "the cores are unknown");
    std::size_t core = CPU_SETSIZE - 1;
    while (!CPU_ISSET(core, &cores)) --core;
    CPU_ZERO(&cores);
    CPU_SET(core, &cores);
    require(sched_setaffinity(0, sizeof cores, &cores) == 0, "not pinned to a core");
}

double nanosecondsOf(const Loop& loop) {
    for (int i = 0; i < 2; ++i) loop();  // from the third time on malloc hands out the same pages
    double count = 0;
    const double seconds = secondsOf([&] { count = loop(); });
    return seconds * 1e9 / count;
}

}  // namespace

Report::Report(int argc, char** argv) {
    for (int i = 1; i < argc; ++i) {
        const std::string_view argument = argv[i];
        const bool hasValue = argument == "--rounds" || argument == "--json";
        require(argument.substr(0, 2) != "--" || (hasValue && i + 1 < argc),
                "usage: " + std::string(argv[0]) + " [--rounds N] [--json FILE] [WORD]");
        if (argument == "--rounds")
            rounds_ = std::max(1, std::atoi(argv[++i]));
        else if (argument == "--json")
            file_ = argv[++i];
        else
            word_ = argument;
    }
}

void Report::add(const Row& row) {
    if (rows_.empty()) printHead();
    print(row);
    rows_.push_back(row);
}

int Report::finish() const {
    require(!rows_.empty(), "no such row");
    if (!file_.empty()) {
        auto all = nlohmann::ordered_json::array();
        for (const Row& row : rows_) {
            auto& entry = all.emplace_back();
            entry["name"] = row.name;
            entry["ours"] = row.ours;
            if (row.floor) entry["floor"] = *row.floor;
            if (std::isfinite(row.goal)) entry["goal"] = row.goal;
            if (std::isfinite(row.limit)) entry["limit"] = row.limit;
            entry["missed"] = isMissed(row);
        }
        std::ofstream file(file_);
        file << all.dump(1) << '\n';
        require(!file.flush().fail(), "cannot write " + file_);
    }
    return std::any_of(rows_.begin(), rows_.end(), isMissed) ? 1 : 0;
}

int run(int argc, char** argv, void (*measureAll)(Report&)) {
    return resultOf([&] {
        pinToOneCore();
        Report report(argc, argv);
        measureAll(report);
        return report.finish();
    });
}

double processorSeconds() {
    timespec time{};
    clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &time);
    return static_cast<double>(time.tv_sec) + static_cast<double>(time.tv_nsec) * 1e-9;
}

double peakBytes() {
    rusage usage{};
    getrusage(RUSAGE_SELF, &usage);
    return static_cast<double>(usage.ru_maxrss) * 1024;
}

void runInChild(const std::function<void()>& work, void* result, std::size_t size) {
    std::array<int, 2> ends{};
    require(pipe(ends.data()) == 0, "no pipe");
    const pid_t child = fork();
    require(child >= 0, "no process");
    if (child == 0) {
        const bool done = resultOf([&] { return work(), 0; }) == 0;
        const bool written = done && write(ends[1], result, size) == static_cast<ssize_t>(size);
        _exit(written ? 0 : 2);
    }
    close(ends[1]);
    const bool complete = read(ends[0], result, size) == static_cast<ssize_t>(size);
    close(ends[0]);
    int status = 0;
    waitpid(child, &status, 0);
    require(complete && status == 0, "a run failed");
}

void addLoops(Report& report, const std::string& name, const Goals& goals, const Loop& ours,
              const Loop& floor) {
    if (!report.wants(name)) return;
    struct Time {
        double nanoseconds;
    };
    const auto timed = [](const Loop& loop) {
        return [&loop] { return Time{nanosecondsOf(loop)}; };
    };
    Row row{name, 0, {}, goals.ratio, goals.limit};
    if (floor) {
        const Compared<Time> medians = compare(report.rounds(), timed(ours), timed(floor));
        row.ours = medians.ours.nanoseconds;
        row.floor = medians.floor.nanoseconds;
    } else {
        row.ours = measure(report.rounds(), timed(ours)).nanoseconds;
    }
    report.add(row);
}

}  // namespace bench
