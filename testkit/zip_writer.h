#pragma once

#include <zlib.h>

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace testkit {

// Builds a ZIP archive in memory, valid unless told otherwise.
class ZipWriter {
  public:
    struct Entry {
        std::string name;
        std::string content;
        bool deflated = true;
        bool wrongSum = false;
        // What the headers say; 0 for the truth.
        std::uint32_t claimedSize = 0;  // bytes unpacked
        std::uint32_t claimedSum = 0;
        unsigned claimedMethod = 0;
    };

    void add(const Entry& entry);

    // Between these two, an entry's content is written piece by piece.
    void begin(const std::string& name, bool deflated = true);
    void write(std::string_view piece);
    void end() { end(written_.sum, written_.size); }

    // The archive so far.
    std::string finished() const;

  private:
    // The entry being written.
    struct Written {
        std::string name;
        bool deflated = true;
        unsigned method = 0;      // as the headers say
        std::size_t start = 0;    // of its header
        std::size_t content = 0;  // where its packed bytes start
        std::uint32_t sum = 0;
        std::size_t size = 0;
        z_stream stream{};
    };

    void deflatePiece(std::string_view piece, int flush);
    void end(std::uint32_t sum, std::size_t size);

    std::string local_;
    std::string directory_;
    unsigned entries_ = 0;
    Written written_;
};

}  // namespace testkit
