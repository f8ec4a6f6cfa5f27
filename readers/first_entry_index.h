#pragma once

#include <cstddef>
#include <unordered_map>
#include <vector>

namespace dp {

// Finds the first entry of a growing list by one of its members, without walking the list for every
// lookup. Entries may be added at any time; after any other change call forget() before the next
// lookup.
template <class Entry, class Key>
class FirstEntryIndex {
  public:
    explicit FirstEntryIndex(Key Entry::*key) : key_(key) {}

    // The index of the first entry whose member equals `key`, or -1.
    std::ptrdiff_t find(const std::vector<Entry>& entries, const Key& key) {
        if (entries.size() < known_) forget();
        for (; known_ < entries.size(); ++known_) first_.try_emplace(entries[known_].*key_, known_);
        const auto found = first_.find(key);
        return found == first_.end() ? -1 : static_cast<std::ptrdiff_t>(found->second);
    }

    // Makes the next lookup index all entries again.
    void forget() {
        first_.clear();
        known_ = 0;
    }

  private:
    Key Entry::*key_;
    std::unordered_map<Key, std::size_t> first_;
    std::size_t known_ = 0;
};

}  // namespace dp
