#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string_view>
#include <unordered_map>

#include "model/host/export.h"
#include "store/short_texts.h"

namespace dp {

// A text kept by a TextPool, one pointer wide; valid as long as that pool. Within one pool two
// handles are equal exactly when their texts are.
class DPXLSX_API PooledText {
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
    static constexpr unsigned char kLong = ShortTexts::kLongest + 1;

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

    // The pool's copy of `text`, made when it is new. Throws std::bad_alloc and keeps no text then.
    // Costs one pass over `text`, also when it is known: who files one long text many times keeps
    // the handle.
    PooledText intern(std::string_view text);

    // The same in two steps that many texts can be in at a time: after begin, which throws as
    // intern does, deliverTo names where the bits of the handle go. They are written with any call
    // from this one on, at the latest with settle: until then the place must stay.
    void begin(std::string_view text);
    void deliverTo(std::uint64_t& bits) noexcept;
    // Delivers what is still to be delivered.
    void settle() noexcept;

    // Number of distinct texts, the empty one not counted.
    std::size_t size();

  private:
    PooledText internLong(std::string_view text);

    ShortTexts short_;
    // The long ones, and those for which the other table has no room.
    std::unordered_map<std::string_view, std::unique_ptr<char[]>, TextHash> long_;
    PooledText recent_;     // the last text that was known when the next one was begun
    bool isRecent_ = true;  // it is the one to deliver; else the short texts know it
};

}  // namespace dp
