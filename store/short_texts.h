#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <string_view>
#include <vector>

namespace dp {

// A hash of texts that differs from table to table, so that whoever writes a workbook cannot choose
// texts that fall together.
class TextHash {
  public:
    TextHash();

    std::uint64_t operator()(std::string_view text) const;

  private:
    std::array<std::uint64_t, 3> secret_;
};

// Keeps every distinct text of up to kLongest bytes once, until it goes itself. Searches wait for
// each other: memory is slow to answer, and many questions at a time take little longer than one.
class ShortTexts {
  public:
    static constexpr std::size_t kLongest = 254;  // bytes

    ShortTexts() = default;
    ShortTexts(const ShortTexts&) = delete;
    ShortTexts& operator=(const ShortTexts&) = delete;

    // Begins to look for `text`, which has 1 to kLongest bytes; it is copied. False when there is
    // no room for one more text. Throws std::bad_alloc. In both cases nothing has begun.
    bool begin(std::string_view text);
    // Where the address of the text that was begun last is written: with any call from this one on,
    // at the latest with settle. The place must stay until then.
    void deliverTo(std::uint64_t& place) noexcept;
    // The text that equals `text`, null if there is none; settles all that wait.
    const char* find(std::string_view text) noexcept;
    // Finds or adds all texts that wait. The last one that was found stays known as recent().
    void settle() noexcept;
    bool isWaiting() const { return waitingCount_ != 0; }

    // The text that was settled last, as its length in one byte and then the text; null if none.
    const char* recent() const { return recent_; }
    // Number of distinct texts that are settled.
    std::size_t size() const { return size_; }

  private:
    // A text's place: units of kUnit bytes in pages of kPage bytes, in 32 bits.
    using Id = std::uint32_t;
    static constexpr std::size_t kUnit = 4;
    static constexpr std::size_t kPage = std::size_t{1} << 20;
    static constexpr unsigned kUnitBits = 18;
    static_assert(kUnit << kUnitBits == kPage);
    static constexpr std::size_t kMostPages = std::size_t{1} << (32 - kUnitBits);
    // More than a processor can fetch at a time.
    static constexpr std::size_t kMostWaiting = 32;
    // So many texts later, the slots that a text begins with have come in.
    static constexpr std::size_t kFetched = 8;

    struct Page {
        std::unique_ptr<char[]> bytes;
        std::size_t used;  // bytes
    };
    struct Waiting {
        std::uint64_t hash;
        std::uint64_t* place;
        std::size_t length;
        std::size_t slot;  // the first that can be the text's, as known when it was fetched
    };
    // A hash table with open addressing. The tags are few enough for the processor's caches, and
    // they alone tell that a text is new.
    struct Table {
        explicit Table(std::size_t count = 0) : tags(count), ids(count) {}

        std::size_t mask() const { return tags.size() - 1; }
        // The first slot from `slot` on that is free or has the tag.
        std::size_t candidate(std::size_t slot, std::uint8_t tag) const;
        void set(std::size_t slot, std::uint64_t hash, Id id);

        std::vector<std::uint8_t> tags;  // 0 for a free slot, else bits of the hash
        std::vector<Id> ids;             // as many, none or a power of two
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
    std::vector<Page> pages_;      // texts stand one behind the other in each
    std::size_t pageSize_ = 0;     // bytes of the last page
    std::size_t waitingSize_ = 0;  // bytes behind the used ones of the last page
    std::size_t waitingCount_ = 0;
    std::array<Waiting, kMostWaiting> waiting_{};
    const char* recent_ = nullptr;
};

}  // namespace dp
