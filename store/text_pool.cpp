#include "store/text_pool.h"

#include <bit>
#include <cstring>
#include <utility>

namespace dp {

std::string_view PooledText::longView() const {
    std::size_t length;
    std::memcpy(&length, stored_ + 1, sizeof length);
    return {stored_ + 1 + sizeof length, length};
}

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

// A text that often repeats the one before need not be searched for.
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
    // Short texts join the long ones behind 16 GB of others, those that are not among these.
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
