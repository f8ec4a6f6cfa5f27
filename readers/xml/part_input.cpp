#include "dpxlsx/readers/xml/part_input.h"

#include <fcntl.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <memory>
#include <optional>
#include <string_view>

#include <libxml/xmlreader.h>

#include "dpxlsx/readers/limits.h"
#include "dpxlsx/readers/xml/markup_marks.h"
#include "dpxlsx/readers/xml/silence.h"

namespace dp {

namespace {

// Whether ASCII bytes have no other meaning in the document's encoding, as in UTF-8, which need not
// be declared, and in the usual single-byte encodings. UTF-16 need not be declared either, but has
// zero bytes.
bool keepsAscii(xmlTextReaderPtr reader) {
    const xmlNode* node = reader ? xmlTextReaderCurrentNode(reader) : nullptr;
    if (!node || !node->doc) return false;
    const xmlChar* encoding = node->doc->encoding;
    const auto beginsWith = [encoding](const char* name) {
        return xmlStrncasecmp(encoding, reinterpret_cast<const xmlChar*>(name),
                              static_cast<int>(std::strlen(name))) == 0;
    };
    return !encoding || beginsWith("UTF-8") || beginsWith("US-ASCII") || beginsWith("ISO-8859-") ||
           beginsWith("windows-125");
}

// The file behind a reader, and how far libxml2 has come in it.
class PartInput {
  public:
    PartInput(const std::string& path, const std::uint32_t& moves)
        : descriptor_(::open(path.c_str(), O_RDONLY | O_CLOEXEC)), moves_(moves) {}
    ~PartInput() {
        if (isOpen()) ::close(descriptor_);
    }
    PartInput(const PartInput&) = delete;
    PartInput& operator=(const PartInput&) = delete;

    bool isOpen() const { return descriptor_ >= 0; }
    void watch(xmlTextReaderPtr reader) { reader_ = reader; }

    // Reads up to `size` bytes; 0 at the end, -1 on an error and beyond the limits.
    int read(char* bytes, int size) {
        const std::size_t waiting = bytesWaiting();
        if (waiting > kMarkupSize || runSize() > kRunSize) return -1;
        if (next_ == end_ && !fill()) return -1;
        const std::ptrdiff_t count = std::min<std::ptrdiff_t>(size, end_ - next_);
        std::copy_n(next_, count, bytes);
        next_ += count;
        const bool isLong = waiting > kLongMarkup;
        const std::string_view supply(bytes, static_cast<std::size_t>(count));
        return countMarks(supply, isLong) ? static_cast<int>(count) : -1;
    }

  private:
    // Buffers the file, because libxml2 asks for few bytes at a time. False on an error; at the end
    // the buffer is empty.
    bool fill() {
        ssize_t count = -1;
        do count = ::read(descriptor_, buffer_.data(), buffer_.size());
        while (count < 0 && errno == EINTR);
        next_ = buffer_.data();
        end_ = next_ + std::max<ssize_t>(count, 0);
        return count >= 0;
    }

    // Bytes that libxml2 has received but not consumed. It consumes text as it arrives, but markup
    // only when complete.
    std::size_t bytesWaiting() const {
        const long used = reader_ ? xmlTextReaderByteConsumed(reader_) : supplied_;
        return used < 0 || used > supplied_ ? 0 : static_cast<std::size_t>(supplied_ - used);
    }
    // Bytes that libxml2 has received during the current move; 0 while a host moves the reader
    // itself.
    std::int64_t runSize() {
        const bool moves = moves_ % 2 == 1;
        if (!moves || moves_ != movesBefore_) runStart_ = supplied_;
        movesBefore_ = moves_;
        return supplied_ - runStart_;
    }

    // False when there are too many marks in the long markup that these bytes belong to.
    // Recognising CDATA sections costs more than counting, so it is done only when the plain count
    // exceeds the limit.
    bool countMarks(std::string_view supply, bool isLong) {
        if (!isLong) {
            marks_ = 0;
            longStart_ = supplied_ + static_cast<std::int64_t>(supply.size());
        }
        supplied_ += static_cast<std::int64_t>(supply.size());
        if (exactMarks_) {
            const std::size_t marks = exactMarks_->countIn(supply);
            if (isLong) marks_ += marks;
        } else if (isLong) {
            marks_ +=
                static_cast<std::size_t>(std::count_if(supply.begin(), supply.end(), isMarkupMark));
            if (marks_ > kLongMarkupMarks && keepsAscii(reader_) && !countExactly()) return false;
        }
        return marks_ <= kLongMarkupMarks;
    }
    // Reads the document from its beginning again, to count exactly. False when that cannot be
    // done.
    bool countExactly() {
        exactMarks_.emplace();
        std::array<char, std::size_t{4} << 10> again;
        for (std::int64_t at = 0; at < supplied_;) {
            const std::int64_t end = at < longStart_ ? longStart_ : supplied_;
            const std::size_t size =
                std::min<std::size_t>(again.size(), static_cast<std::size_t>(end - at));
            const ssize_t count = ::pread(descriptor_, again.data(), size, at);
            if (count < 0 && errno == EINTR) continue;
            if (count <= 0) return false;
            const std::size_t marks =
                exactMarks_->countIn({again.data(), static_cast<std::size_t>(count)});
            marks_ = at < longStart_ ? 0 : marks_ + marks;
            at += count;
        }
        return true;
    }

    int descriptor_;
    const std::uint32_t& moves_;
    std::uint32_t movesBefore_ = 0;
    std::int64_t runStart_ = 0;
    std::array<char, std::size_t{32} << 10> buffer_;
    const char* next_ = nullptr;  // the next byte for libxml2
    const char* end_ = nullptr;   // the end of the buffered bytes
    xmlTextReaderPtr reader_ = nullptr;
    std::int64_t supplied_ = 0;   // bytes
    std::int64_t longStart_ = 0;  // where the unconsumed markup begins to count as long, in bytes
    std::size_t marks_ = 0;       // counted from there on
    std::optional<MarkupMarks> exactMarks_;
};

extern "C" {

int readPart(void* input, char* bytes, int size) {
    return static_cast<PartInput*>(input)->read(bytes, size);
}

int closePart(void* input) {
    delete static_cast<PartInput*>(input);
    return 0;
}

void noteText(void* payload, void* found, const xmlChar*) {
    if (static_cast<const xmlEntity*>(payload)->content) *static_cast<bool*>(found) = true;
}

}  // extern "C"

}  // namespace

xmlTextReaderPtr openDocument(const std::string& path, const std::uint32_t& moves) {
    auto input = std::make_unique<PartInput>(path, moves);
    if (!input->isOpen()) return nullptr;
    PartInput* const watching = input.get();
    // The reader closes the input, also when it cannot be made.
    const xmlTextReaderPtr reader =
        xmlReaderForIO(readPart, closePart, input.release(), nullptr, nullptr,
                       XML_PARSE_NOERROR | XML_PARSE_NOWARNING);
    if (!reader) return nullptr;
    watching->watch(reader);
    // The options alone do not keep libxml2 quiet: it still prints a line for a text of over 10 MB.
    xmlTextReaderSetStructuredErrorHandler(reader, SilentLibxml2::ignore, nullptr);
    return reader;
}

void limitNames(xmlTextReaderPtr reader) {
    const xmlNode* node = xmlTextReaderCurrentNode(reader);
    if (node && node->doc && node->doc->dict) xmlDictSetLimit(node->doc->dict, kXmlNames);
}

bool declaresTooMuch(xmlTextReaderPtr reader) {
    const xmlNode* node = xmlTextReaderCurrentNode(reader);
    const xmlDtd* declarations = node && node->doc ? node->doc->intSubset : nullptr;
    if (!declarations) return false;
    bool tooMuch = declarations->attributes != nullptr;
    if (declarations->entities)
        xmlHashScan(static_cast<xmlHashTablePtr>(declarations->entities), noteText, &tooMuch);
    return tooMuch;
}

}  // namespace dp
