#pragma once

#include <cstddef>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace dp {

struct CloseDecoder {
    void operator()(void* decoder) const;
};
using Decoder = std::unique_ptr<void, CloseDecoder>;  // iconv's

// The text of a part as UTF-8, whatever its own encoding.
//
// libxml2 decodes as well, but each version differently: 2.15 takes bytes for characters that
// windows-1252 leaves undefined, the name "ISO8859-15" for Latin-1, and a byte-order mark for more
// certain than the declaration; 2.9 cannot read UTF-32 with the low byte first, knows one kind of
// EBCDIC, and asks ICU for what iconv does not know, if built with it. Therefore libxml2 is given
// nothing but UTF-8.
class PartText {
  public:
    // From where the file behind `descriptor` stands, which must be its beginning. The descriptor
    // remains the caller's.
    explicit PartText(int descriptor);

    // The next bytes, valid until the next call; empty at the end. Nothing when the file cannot be
    // read, its encoding is unknown or what comes next is no character in it.
    std::optional<std::string_view> next();
    // True when the text is not in the encoding that the document declares.
    bool isDecoded() const { return decoder_ != nullptr; }

  private:
    bool fill();
    bool detectEncoding();
    bool startDecoding(const std::string& encoding);

    int descriptor_;
    std::vector<char> bytes_;     // of the file
    std::string_view waiting_;    // those of them that have not been passed on
    std::size_t passedAsIs_ = 0;  // bytes that are passed on next without decoding
    Decoder decoder_;             // null for UTF-8
    std::vector<char> decoded_;
    bool isReadable_;
};

}  // namespace dp
