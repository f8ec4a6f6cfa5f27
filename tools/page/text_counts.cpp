#include "tools/page/text_counts.h"

#include <algorithm>

namespace dp::tool {

namespace {

bool startsCharacter(char byte) { return (static_cast<unsigned char>(byte) & 0xC0) != 0x80; }

bool comesFirst(const TextCounts::Entry& a, const TextCounts::Entry& b) {
    return a.count != b.count ? a.count > b.count : a.row < b.row;
}

}  // namespace

void TextCounts::add(const std::string& text, size_t row) {
    ++counts_.try_emplace(text, Count{0, row}).first->second.count;
}

std::vector<TextCounts::Entry> TextCounts::mostFrequent(size_t most) const {
    std::vector<Entry> entries;
    entries.reserve(counts_.size());
    for (const auto& [text, count] : counts_) entries.push_back({text, count.count, count.row});
    const size_t wanted = std::min(most, entries.size());
    const auto end = entries.begin() + static_cast<std::ptrdiff_t>(wanted);
    std::partial_sort(entries.begin(), end, entries.end(), comesFirst);
    entries.erase(end, entries.end());
    return entries;
}

std::string_view beginning(std::string_view text, size_t bytes) {
    if (text.size() <= bytes) return text;
    while (bytes > 0 && !startsCharacter(text[bytes])) --bytes;
    return text.substr(0, bytes);
}

size_t characterCount(std::string_view text) {
    return static_cast<size_t>(std::count_if(text.begin(), text.end(), startsCharacter));
}

}  // namespace dp::tool
