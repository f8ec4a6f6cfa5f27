#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <string_view>
#include <vector>

namespace dp {

// A hash of texts, seeded at random for each table, so that nobody can write a workbook whose texts
// all collide.
class TextHash {
  public:
    TextHash();

    std::uint64_t operator()(std::string_view text) const;

  private:
    std::uint64_t seed_;
};

// A set of texts of up to kLongest bytes, which keeps every distinct text once, until the set is
// destroyed. Lookups are batched to hide cache misses: begin() only prefetches what a lookup will
// read, and a whole batch is completed later, when the data has arrived.
class ShortTexts {
  public:
    static constexpr std::size_t kLongest = 254;  // bytes

    // A text's address in 32 bits: the number of its page, of kPage bytes, and its offset there in
    // units of kUnit bytes.
    using Id = std::uint32_t;
    static constexpr std::size_t kUnit = 4;
    static constexpr std::size_t kPage = std::size_t{1} << 20;
    static constexpr unsigned kUnitBits = 18;
    static_assert(kUnit << kUnitBits == kPage);
    static constexpr std::size_t kMostPages = std::size_t{1} << (32 - kUnitBits);

    // Keeps texts in at most `mostPages` pages, of up to kPage bytes.
    explicit ShortTexts(std::size_t mostPages = kMostPages) : mostPages_(mostPages) {}
    ShortTexts(const ShortTexts&) = delete;
    ShortTexts& operator=(const ShortTexts&) = delete;

    // Begins the lookup of `text`, which has 1 to kLongest bytes and is copied. Returns false when
    // there is no room for another text, throws std::bad_alloc; either way no lookup has begun.
    bool begin(std::string_view text);
    // Writes the address of the text that was begun last to `place`: at once or in a later call, in
    // settle at the latest. `place` must stay valid until then.
    void deliverTo(std::uint64_t& place) noexcept;
    // The kept text that equals `text`, null if there is none. Completes all waiting lookups.
    const char* find(std::string_view text) noexcept;
    // Completes all waiting lookups: finds their texts or adds them. recent() is then the last of
    // them.
    void settle() noexcept;
    bool isWaiting() const { return waitingCount_ != 0; }

    // The text whose lookup was completed last: its length in one byte, then its bytes. Null if
    // none.
    const char* recent() const { return recent_; }
    // Number of distinct texts, without those whose lookups wait.
    std::size_t size() const { return size_; }

  private:
    // Lookups in a batch: more than a processor can have cache misses in flight.
    static constexpr std::size_t kMostWaiting = 32;
    // After this many further lookups have begun, the first slots of a lookup have arrived in the
    // cache.
    static constexpr std::size_t kFetched = 8;

    struct Page {
        std::unique_ptr<char[]> bytes;
        std::size_t used;  // bytes
    };
    struct Waiting {
        std::uint64_t hash;
        std::uint64_t* place;
        std::size_t length;
        std::size_t slot;  // the first that may hold the text, as of the prefetch
    };
    // A hash table with open addressing. The tags, one byte a slot, are small enough for the
    // processor's caches, and for most new texts they suffice to tell that the text is new.
    struct Table {
        explicit Table(std::size_t count = 0) : tags(count), ids(count) {}

        std::size_t mask() const { return tags.size() - 1; }
        // The first slot from `slot` on that is free or has the tag.
        std::size_t candidate(std::size_t slot, std::uint8_t tag) const;
        void set(std::size_t slot, std::uint64_t hash, Id id);

        std::vector<std::uint8_t> tags;  // 0 for a free slot, else bits of the hash
        std::vector<Id> ids;             // as many as tags: 0 or a power of two
    };

    const char* at(Id id) const {
        return &pages_[id >> kUnitBits].bytes[(id & ((Id{1} << kUnitBits) - 1)) * kUnit];
    }
    std::size_t find(std::string_view text, std::uint64_t hash, std::size_t slot) const;
    void fetchCandidate(Waiting& waiting) const;
    const char* settleOne(const Waiting& waiting, const char* text);
    bool makeRoom(std::size_t size);
    void growTable();
    void rehash(Table& table) const;

    TextHash hash_;
    Table table_;
    std::size_t size_ = 0;
    std::size_t mostPages_;
    std::vector<Page> pages_;      // texts lie back to back in each
    std::size_t pageSize_ = 0;     // bytes of the last page
    std::size_t waitingSize_ = 0;  // bytes of waiting texts, behind the used bytes of the last page
    std::size_t waitingCount_ = 0;
    std::array<Waiting, kMostWaiting> waiting_{};
    const char* recent_ = nullptr;
};

}  // namespace dp
