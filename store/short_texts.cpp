#include "dpxlsx/store/short_texts.h"

#include <xxhash.h>

#include <algorithm>
#include <chrono>
#include <cstring>
#include <sys/random.h>
#include <utility>

namespace dp {

namespace {

constexpr std::size_t kFirstSlots = 64;
constexpr std::size_t kFirstPage = 512;  // bytes; few texts take little room

// Never 0, which marks a free slot, and taken from other bits than those that choose the first
// slot.
std::uint8_t tagOf(std::uint64_t hash) { return static_cast<std::uint8_t>(hash >> 56 | 0x80); }

// Bytes that a text occupies, its length byte and padding included.
constexpr std::size_t sizeOf(std::size_t length, std::size_t unit) {
    return (1 + length + unit - 1) / unit * unit;
}

std::string_view textAt(const char* stored) {
    return {stored + 1, static_cast<unsigned char>(*stored)};
}

}  // namespace

TextHash::TextHash() {
    if (::getrandom(&seed_, sizeof seed_, GRND_NONBLOCK) == sizeof seed_) return;
    const auto now = std::chrono::steady_clock::now().time_since_epoch().count();
    seed_ = static_cast<std::uint64_t>(now) ^ reinterpret_cast<std::uintptr_t>(this);
}

std::uint64_t TextHash::operator()(std::string_view text) const {
    return XXH3_64bits_withSeed(text.data(), text.size(), seed_);
}

std::size_t ShortTexts::Table::candidate(std::size_t slot, std::uint8_t tag) const {
    while (tags[slot] != 0 && tags[slot] != tag) slot = (slot + 1) & mask();
    return slot;
}

void ShortTexts::Table::set(std::size_t slot, std::uint64_t hash, Id id) {
    tags[slot] = tagOf(hash);
    ids[slot] = id;
}

bool ShortTexts::begin(std::string_view text) {
    if (waitingCount_ == kMostWaiting) settle();
    growTable();
    const std::size_t size = sizeOf(text.size(), kUnit);
    if (!makeRoom(size)) return false;
    Waiting& waiting = waiting_[waitingCount_];
    waiting = {hash_(text), nullptr, text.size(), 0};
    __builtin_prefetch(&table_.tags[waiting.hash & table_.mask()]);
    __builtin_prefetch(&table_.ids[waiting.hash & table_.mask()]);
    char* place = &pages_.back().bytes[pages_.back().used + waitingSize_];
    *place = static_cast<char>(text.size());
    std::memcpy(place + 1, text.data(), text.size());
    waitingSize_ += size;
    if (waitingCount_++ >= kFetched) fetchCandidate(waiting_[waitingCount_ - 1 - kFetched]);
    return true;
}

void ShortTexts::deliverTo(std::uint64_t& place) noexcept {
    if (isWaiting())
        waiting_[waitingCount_ - 1].place = &place;
    else
        place = reinterpret_cast<std::uintptr_t>(recent_);
}

void ShortTexts::settle() noexcept {
    if (!isWaiting()) return;
    for (std::size_t i = waitingCount_ - std::min(waitingCount_, kFetched); i < waitingCount_; ++i)
        fetchCandidate(waiting_[i]);
    const char* text = &pages_.back().bytes[pages_.back().used];
    for (std::size_t i = 0; i < waitingCount_; ++i) {
        recent_ = settleOne(waiting_[i], text);
        if (waiting_[i].place) *waiting_[i].place = reinterpret_cast<std::uintptr_t>(recent_);
        text += sizeOf(waiting_[i].length, kUnit);
    }
    waitingSize_ = 0;
    waitingCount_ = 0;
}

// Prefetches the first text that may be the wanted one, and records where the lookup continues.
void ShortTexts::fetchCandidate(Waiting& waiting) const {
    waiting.slot = table_.candidate(waiting.hash & table_.mask(), tagOf(waiting.hash));
    if (table_.tags[waiting.slot] == 0) return;
    const Id id = table_.ids[waiting.slot];
    const Page& page = pages_[id >> kUnitBits];
    const std::size_t begin = (id & ((Id{1} << kUnitBits) - 1)) * kUnit;
    __builtin_prefetch(&page.bytes[begin]);
    // A text may extend into the next cache line.
    __builtin_prefetch(&page.bytes[std::min(begin + waiting.length, page.used - 1)]);
}

// The kept text that equals the waiting one at `text`. Waiting texts lie behind the used bytes of
// the last page; a new one is moved to the end of the used bytes and kept.
const char* ShortTexts::settleOne(const Waiting& waiting, const char* text) {
    const std::size_t slot = find(textAt(text), waiting.hash, waiting.slot);
    if (table_.tags[slot] != 0) return at(table_.ids[slot]);
    Page& page = pages_.back();
    char* place = &page.bytes[page.used];
    const std::size_t size = sizeOf(waiting.length, kUnit);
    if (place != text) std::memmove(place, text, size);
    const Id number = static_cast<Id>(pages_.size() - 1) << kUnitBits;
    table_.set(slot, waiting.hash, number | static_cast<Id>(page.used / kUnit));
    page.used += size;
    ++size_;
    return place;
}

const char* ShortTexts::find(std::string_view text) noexcept {
    settle();
    if (table_.tags.empty()) return nullptr;
    const std::uint64_t hash = hash_(text);
    const std::size_t slot = find(text, hash, hash & table_.mask());
    return table_.tags[slot] == 0 ? nullptr : at(table_.ids[slot]);
}

// The slot of the text, or the free one where it belongs, from `slot` on.
std::size_t ShortTexts::find(std::string_view text, std::uint64_t hash, std::size_t slot) const {
    while (true) {
        slot = table_.candidate(slot, tagOf(hash));
        if (table_.tags[slot] == 0 || textAt(at(table_.ids[slot])) == text) return slot;
        slot = (slot + 1) & table_.mask();
    }
}

// Makes room for `size` bytes behind the waiting texts. False when all pages are full.
bool ShortTexts::makeRoom(std::size_t size) {
    const auto fits = [&] {
        return !pages_.empty() && pages_.back().used + waitingSize_ + size <= pageSize_;
    };
    if (fits()) return true;
    settle();
    if (fits()) return true;
    if (pages_.size() == mostPages_) return false;
    const std::size_t pageSize = std::clamp(pageSize_ * 2, kFirstPage, kPage);
    pages_.push_back({std::make_unique_for_overwrite<char[]>(pageSize), 0});
    pageSize_ = pageSize;
    return true;
}

// Grows the table before the texts, waiting ones included, fill more than three quarters of it.
void ShortTexts::growTable() {
    const std::size_t count = table_.tags.size();
    const std::size_t most = count / 4 * 3;
    if (size_ + waitingCount_ < most) return;
    settle();
    // Without this margin, batches would be cut to a few lookups just below the limit.
    if (size_ + kMostWaiting < most) return;
    Table larger(std::max(kFirstSlots, count * 2));
    rehash(larger);
    table_ = std::move(larger);
}

// In the order of the texts in memory: reading them in sequence is faster than in the order of the
// slots.
void ShortTexts::rehash(Table& table) const {
    for (std::size_t number = 0; number < pages_.size(); ++number) {
        const Page& page = pages_[number];
        for (std::size_t place = 0; place < page.used;) {
            const std::string_view text = textAt(&page.bytes[place]);
            const std::uint64_t hash = hash_(text);
            table.set(table.candidate(hash & table.mask(), 0), hash,
                      static_cast<Id>(number << kUnitBits | place / kUnit));
            place += sizeOf(text.size(), kUnit);
        }
    }
}

}  // namespace dp
