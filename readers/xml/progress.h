#pragma once

#include <chrono>
#include <cstdint>
#include <string>
#include <utility>

namespace dp {

// Whom an open or a listing tells how far it is, and by which clock.
struct ProgressReport {
    using Time = std::chrono::steady_clock::time_point;

    int (*report)(double done, void* user) = nullptr;  // null: nobody is told
    void* user = nullptr;
    Time (*now)() = [] { return std::chrono::steady_clock::now(); };
};

// How far an open or a listing is, in bytes unpacked and read. What unpacks and reads finds it by
// the thread and not by an argument: readers have the fields and operations of the contract. The
// static operations mean the thread's latest Progress; they do nothing where there is none, or one
// whose host wants no reports.
//
// Counting calls nobody and may be done inside libxml2. Telling calls the host, at most ten times a
// second, and lets its exceptions through.
class Progress {
  public:
    enum class Reading { Worksheets, Names };  // what is done with the parts once they are unpacked

    // Thrown when the host answers other than 0.
    struct Cancelled {};

    // Makes another Progress the thread's latest one as long as it lives; null for none.
    class Current {
      public:
        explicit Current(Progress* progress) : before_(std::exchange(latest_, progress)) {}
        ~Current() { latest_ = before_; }
        Current(const Current&) = delete;
        Current& operator=(const Current&) = delete;

      private:
        Progress* before_;
    };

    Progress(const ProgressReport& report, Reading reading)
        : report_(report), reading_(reading), current_(report.report ? this : nullptr) {}

    // Tells that all is done. Throws what telling throws.
    void finish();
    // Whether the host ended the work, by another answer than 0 or by an exception.
    bool isStopped() const { return stopped_; }

    // The bytes that unpacking makes, and those of them that reading all worksheets takes.
    static void expect(std::uint64_t unpacked, std::uint64_t read);
    static void countUnpacked(std::uint64_t bytes);
    // The next bytes are those of another part, or once more those of the part that was begun last:
    // then the bytes counted since do not count.
    static void beginPart(const std::string& path);
    static void countRead(std::uint64_t bytes);
    // Tells the host if anything was counted since, and the last time was long enough ago. Throws
    // Cancelled, and the host's exceptions.
    static void tell() {
        if (latest_ && latest_->hasNews_) latest_->tellIfDue();
    }

  private:
    void tellIfDue();
    void call(double done);
    double fraction() const;

    static inline constinit thread_local Progress* latest_ = nullptr;

    const ProgressReport report_;
    const Reading reading_;
    const Current current_;
    bool hasNews_ = true;  // the first time tells that the work begins
    bool stopped_ = false;
    bool hasTold_ = false;
    ProgressReport::Time lastTold_;
    double done_ = 0;  // as told last
    std::uint64_t toUnpack_ = 0;
    std::uint64_t toRead_ = 0;
    std::uint64_t unpacked_ = 0;
    std::uint64_t read_ = 0;
    std::uint64_t readBefore_ = 0;  // of the parts before the current one
    std::string part_;
};

}  // namespace dp
