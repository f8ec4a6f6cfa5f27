#include "dpxlsx/readers/xml/progress.h"

#include <algorithm>

namespace dp {

namespace {

constexpr std::chrono::milliseconds kPause{100};  // between two reports

}  // namespace

void Progress::expect(std::uint64_t unpacked, std::uint64_t read) {
    if (!latest_) return;
    latest_->toUnpack_ = unpacked;
    // A listing reads next to nothing.
    latest_->toRead_ = latest_->reading_ == Reading::Worksheets ? read : 0;
}

void Progress::countUnpacked(std::uint64_t bytes) {
    if (!latest_) return;
    latest_->unpacked_ += bytes;
    latest_->hasNews_ = true;
}

void Progress::beginPart(const std::string& path) {
    if (!latest_) return;
    if (latest_->part_ == path) {
        latest_->read_ = latest_->readBefore_;
    } else {
        latest_->part_ = path;
        latest_->readBefore_ = latest_->read_;
    }
}

void Progress::countRead(std::uint64_t bytes) {
    if (!latest_) return;
    latest_->read_ += bytes;
    latest_->hasNews_ = true;
}

void Progress::finish() {
    if (report_.report) call(1);
}

void Progress::tellIfDue() {
    hasNews_ = false;
    const ProgressReport::Time time = report_.now();
    if (hasTold_ && time - lastTold_ < kPause) return;
    hasTold_ = true;
    lastTold_ = time;
    done_ = std::max(done_, fraction());
    call(done_);
}

// While the host is called, nothing that it does belongs to this work.
void Progress::call(double done) {
    const Current nobody(nullptr);
    stopped_ = true;
    if (report_.report(done, report_.user) != 0) throw Cancelled();
    stopped_ = false;
}

// Below 1 before the end. A part that several worksheets name is read several times but expected
// once.
double Progress::fraction() const {
    const std::uint64_t done = std::min(unpacked_, toUnpack_) + std::min(read_, toRead_);
    return static_cast<double>(done) / (static_cast<double>(toUnpack_ + toRead_) + 1);
}

}  // namespace dp
