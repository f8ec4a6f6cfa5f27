#include "dpxlsx/store/text_pool.h"

#include <bit>
#include <cstring>
#include <utility>

namespace dp {

PooledText TextPool::intern(std::string_view text) {
    std::uint64_t bits = 0;
    begin(text);
    deliverTo(bits);
    settle();
    return std::bit_cast<PooledText>(bits);
}

void TextPool::settle() noexcept {
    if (short_.isWaiting()) short_.settle();
}

// Texts often repeat the one before, which is recognised without a lookup.
void TextPool::begin(std::string_view text) {
    if (!isRecent_ && !short_.isWaiting()) recent_ = PooledText(short_.recent());
    isRecent_ = true;
    if (text == recent_.view()) return;
    if (text.empty()) {
        recent_ = {};
        return;
    }
    const bool isShort = text.size() <= ShortTexts::kLongest;
    isRecent_ = !isShort || !short_.begin(text);
    if (!isRecent_) return;
    // When the pages of short_ are full (16 GB), further short texts are kept with the long
    // ones; those that short_ already has are still found there.
    const char* kept = isShort ? short_.find(text) : nullptr;
    recent_ = kept ? PooledText(kept) : internLong(text);
}

void TextPool::deliverTo(std::uint64_t& bits) noexcept {
    if (isRecent_)
        bits = std::bit_cast<std::uint64_t>(recent_);
    else
        short_.deliverTo(bits);
}

std::size_t TextPool::size() {
    settle();
    return short_.size() + long_.size();
}

PooledText TextPool::internLong(std::string_view text) {
    if (const auto found = long_.find(text); found != long_.end())
        return PooledText(found->second.get());
    const std::size_t length = text.size();
    constexpr std::size_t kHead = 1 + sizeof length;
    auto stored = std::make_unique_for_overwrite<char[]>(kHead + length);
    stored[0] = static_cast<char>(PooledText::kLong);
    std::memcpy(&stored[1], &length, sizeof length);
    std::memcpy(&stored[kHead], text.data(), length);
    const PooledText kept(stored.get());
    long_.emplace(kept.view(), std::move(stored));
    return kept;
}

}  // namespace dp
