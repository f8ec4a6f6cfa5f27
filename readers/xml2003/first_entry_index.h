#pragma once

#include <cstddef>
#include <limits>
#include <map>
#include <vector>

namespace dp {

// Finds the first entry of a list by one of its members. Normally every lookup walks the list,
// which may have changed in any way since the last one. During a Use the entries are indexed, each
// only once; then entries may only be appended.
template <class Entry, class Key>
class FirstEntryIndex {
  public:
    // Enables the index for the duration of one reading step. A Use within another one does
    // nothing.
    class Use {
      public:
        explicit Use(FirstEntryIndex& index) : index_(index), outermost_(index.known_ == kUnused) {
            if (outermost_) index_.beginAnew();
        }
        Use(const Use&) = delete;
        Use& operator=(const Use&) = delete;
        ~Use() {
            if (!outermost_) return;
            index_.beginAnew();
            index_.known_ = kUnused;
        }

      private:
        FirstEntryIndex& index_;
        const bool outermost_;
    };

    explicit FirstEntryIndex(Key Entry::*key) : key_(key) {}

    Use use() { return Use(*this); }

    // The index of the first entry whose member equals `key`, or -1.
    std::ptrdiff_t find(const std::vector<Entry>& entries, const Key& key) {
        if (known_ == kUnused) return walk(entries, key);
        if (entries.size() < known_) beginAnew();  // the result must lie within the list
        for (; known_ < entries.size(); ++known_) first_.try_emplace(entries[known_].*key_, known_);
        const auto found = first_.find(key);
        if (found == first_.end()) return -1;
        // An entry that is another one by now gives no wrong answer.
        if (entries[found->second].*key_ != key) return walk(entries, key);
        return static_cast<std::ptrdiff_t>(found->second);
    }

  private:
    static constexpr std::size_t kUnused = std::numeric_limits<std::size_t>::max();

    void beginAnew() {
        first_.clear();
        known_ = 0;
    }

    std::ptrdiff_t walk(const std::vector<Entry>& entries, const Key& key) const {
        for (std::size_t i = 0; i < entries.size(); ++i)
            if (entries[i].*key_ == key) return static_cast<std::ptrdiff_t>(i);
        return -1;
    }

    Key Entry::*key_;
    // Ordered: a document chooses the keys, and could choose some that collide in a hash table.
    std::map<Key, std::size_t> first_;
    std::size_t known_ = kUnused;  // entries in `first_`
};

}  // namespace dp
