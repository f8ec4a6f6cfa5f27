#include "tools/explain/tally.h"

#include <algorithm>
#include <utility>

#include "tools/views/text.h"

namespace dp::tool {

void Tally::add(Entry entry) {
    total_ += entry.count;
    if (!entries_.empty() && entries_.back().place == entry.place) {
        entries_.back().count += entry.count;
    } else {
        entries_.push_back(std::move(entry));
    }
}

std::string Tally::text(size_t most) const {
    std::string text;
    size_t unnamed = total_;
    const size_t named = std::min(most, entries_.size());
    for (size_t i = 0; i < named; ++i) {
        const Entry& entry = entries_[i];
        unnamed -= entry.count;
        text += (i == 0 ? "" : ", ") + std::to_string(entry.count) + " in " + entry.place;
        if (!entry.name.empty()) text += " (" + entry.name + ")";
    }
    const size_t more = entries_.size() - named;
    if (more == 0) return text;
    return text + " and " + std::to_string(unnamed) + " in " + std::to_string(more) +
           (more == 1 ? " more column" : " more columns");
}

std::string Tally::textTypes(size_t most) const {
    std::string text;
    for (size_t i = 0; i < std::min(most, entries_.size()); ++i) {
        text += (i == 0 ? "" : " ") + ("--type " + shellWord(entries_[i].place + "=text"));
    }
    return text;
}

}  // namespace dp::tool
