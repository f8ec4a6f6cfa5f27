#include "store/text_pool.h"

#include <algorithm>
#include <chrono>
#include <cstring>
#include <sys/random.h>
#include <utility>

namespace dp {

namespace {

constexpr std::size_t kFirstSlots = 16;
constexpr std::size_t kFirstBlock = 512;
constexpr std::size_t kLargestBlock = std::size_t{64} * 1024;
// Longer texts get a block of their own, so that a new shared block leaves little unused.
constexpr std::size_t kLongestShared = kLargestBlock / 8;
__extension__ using Product = unsigned __int128;

// All 128 bits of the product, folded: every bit of both factors reaches every bit of the result.
std::uint64_t mix(std::uint64_t left, std::uint64_t right) {
    const Product product = static_cast<Product>(left) * right;
    return static_cast<std::uint64_t>(product) ^ static_cast<std::uint64_t>(product >> 64);
}

std::uint64_t load(const char* bytes) {
    std::uint64_t word;
    std::memcpy(&word, bytes, sizeof word);
    return word;
}

// Never that of a free slot, and of other bits than those that choose the first slot.
std::uint8_t tagOf(std::uint64_t hash) { return static_cast<std::uint8_t>(hash >> 56 | 0x80); }

}  // namespace

std::string_view PooledText::longView() const {
    std::size_t length;
    std::memcpy(&length, stored_ + 1, sizeof length);
    return {stored_ + 1 + sizeof length, length};
}

// A text often is the one of the last call, or comes behind the same text as the first time; then
// it need not be searched for.
PooledText TextPool::intern(std::string_view text) {
    if (text.empty()) return {};
    if (text == recent_.view()) return recent_;
    if (const PooledText next = following(); text == next.view()) return recent_ = next;
    makeRoom();
    const std::uint64_t hash = hashOf(text);
    const PooledText found = find(text, hash);
    return recent_ = found == PooledText() ? add(text, hash) : found;
}

// The text that stands behind the most recent one, empty if there is none.
PooledText TextPool::following() const {
    const std::string_view text = recent_.view();
    const char* next = text.data() + text.size();
    return *next == 0 ? PooledText() : PooledText(next);
}

PooledText TextPool::find(std::string_view text, std::uint64_t hash) const {
    const std::size_t mask = table_.tags.size() - 1;
    __builtin_prefetch(&table_.slots[hash & mask]);  // comes in while the tag is waited for
    for (std::size_t index = hash & mask; table_.tags[index] != 0; index = (index + 1) & mask) {
        if (table_.tags[index] != tagOf(hash)) continue;
        const Slot& slot = table_.slots[index];
        if (slot.hash == hash && slot.text.view() == text) return slot.text;
    }
    return {};
}

PooledText TextPool::add(std::string_view text, std::uint64_t hash) {
    const std::size_t length = text.size();
    const bool isLong = length >= PooledText::kLong;
    const std::size_t head = isLong ? 1 + sizeof length : 1;
    char* place = allocate(head + length);
    place[0] = static_cast<char>(isLong ? PooledText::kLong : length);
    if (isLong) std::memcpy(place + 1, &length, sizeof length);
    std::memcpy(place + head, text.data(), length);
    place[head + length] = 0;
    table_.add({hash, PooledText(place)});
    ++size_;
    return PooledText(place);
}

void TextPool::Table::add(const Slot& slot) {
    const std::size_t mask = tags.size() - 1;
    std::size_t index = slot.hash & mask;
    while (tags[index] != 0) index = (index + 1) & mask;
    tags[index] = tagOf(slot.hash);
    slots[index] = slot;
}

// Keeps a quarter of the slots free.
void TextPool::makeRoom() {
    const std::size_t count = table_.tags.size();
    if (size_ < count / 4 * 3) return;
    Table larger(std::max(kFirstSlots, count * 2));
    if (count == 0) makeSecret();
    for (const Slot& slot : table_.slots)
        if (slot.text != PooledText()) larger.add(slot);
    table_ = std::move(larger);
}

void TextPool::makeSecret() {
    if (::getrandom(secret_.data(), sizeof secret_, GRND_NONBLOCK) == sizeof secret_) return;
    const auto now = std::chrono::steady_clock::now().time_since_epoch().count();
    secret_ = {static_cast<std::uint64_t>(now), reinterpret_cast<std::uintptr_t>(this),
               reinterpret_cast<std::uintptr_t>(&now)};
}

// Room for `size` bytes and the 0 behind them.
char* TextPool::allocate(std::size_t size) {
    if (size >= freeSize_) {
        const bool shared = size < kLongestShared;
        const std::size_t grown = std::clamp(blockSize_ * 2, kFirstBlock, kLargestBlock);
        const std::size_t blockSize = shared ? std::max(grown, size + 1) : size + 1;
        blocks_.push_back(std::make_unique_for_overwrite<char[]>(blockSize));
        if (!shared) return blocks_.back().get();
        blockSize_ = blockSize;
        free_ = blocks_.back().get();
        freeSize_ = blockSize;
    }
    freeSize_ -= size;
    return std::exchange(free_, free_ + size);
}

// The secret keeps whoever writes a workbook from choosing texts that fall on the same slots.
std::uint64_t TextPool::hashOf(std::string_view text) const {
    std::uint64_t hash = secret_[0] ^ text.size();
    const char* bytes = text.data();
    std::size_t left = text.size();
    for (; left > 16; left -= 16, bytes += 16)
        hash = mix(load(bytes) ^ secret_[1], load(bytes + 8) ^ hash);
    char rest[16] = {};
    std::memcpy(rest, bytes, left);
    hash = mix(load(rest) ^ secret_[1], load(rest + 8) ^ hash);
    return mix(hash ^ secret_[2], secret_[1] ^ text.size());
}

}  // namespace dp
