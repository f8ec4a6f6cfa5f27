#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <string_view>
#include <vector>

namespace dp {

// A text kept by a TextPool, one pointer wide; valid as long as that pool. Within one pool two
// handles are equal exactly when their texts are.
class PooledText {
  public:
    PooledText() = default;  // the empty text, of every pool

    // Not terminated by a zero; never a null pointer.
    std::string_view view() const {
        if (!stored_) return "";
        const auto length = static_cast<unsigned char>(*stored_);
        return length < kLong ? std::string_view(stored_ + 1, length) : longView();
    }

    friend bool operator==(PooledText, PooledText) = default;

  private:
    friend class TextPool;

    // Stands for the length of a text that follows in full behind this byte.
    static constexpr unsigned char kLong = 255;

    explicit PooledText(const char* stored) : stored_(stored) {}
    std::string_view longView() const;

    // The length in one byte, or kLong and the length as a std::size_t, then the text.
    const char* stored_ = nullptr;
};

// Keeps every distinct text once, until it goes itself. Not to be used by two threads at a time.
class TextPool {
  public:
    TextPool() = default;
    TextPool(const TextPool&) = delete;
    TextPool& operator=(const TextPool&) = delete;

    // The pool's copy of `text`, made when it is new. Throws std::bad_alloc and is then unchanged.
    // Costs one pass over `text`, also when it is known: who files one long text many times keeps
    // the handle.
    PooledText intern(std::string_view text);

    // Number of distinct texts, the empty one not counted.
    std::size_t size() const { return size_; }

  private:
    struct Slot {
        std::uint64_t hash = 0;
        PooledText text;
    };
    // A hash table with open addressing. The tags are few enough for the processor's caches, and
    // they alone tell that a text is new.
    struct Table {
        explicit Table(std::size_t count = 0) : tags(count), slots(count) {}

        void add(const Slot& slot);

        std::vector<std::uint8_t> tags;  // 0 for a free slot, else bits of the hash
        std::vector<Slot> slots;         // none or a power of two
    };

    PooledText following() const;
    PooledText find(std::string_view text, std::uint64_t hash) const;
    PooledText add(std::string_view text, std::uint64_t hash);
    void makeRoom();
    void makeSecret();
    char* allocate(std::size_t size);
    std::uint64_t hashOf(std::string_view text) const;

    Table table_;
    std::size_t size_ = 0;
    PooledText recent_;
    std::array<std::uint64_t, 3> secret_{};
    // Texts stand one behind the other, and a 0 behind the last one in each block.
    std::vector<std::unique_ptr<char[]>> blocks_;
    char* free_ = nullptr;  // the unused end of the newest shared block
    std::size_t freeSize_ = 0;
    std::size_t blockSize_ = 0;
};

}  // namespace dp
