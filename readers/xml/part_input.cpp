#include "dpxlsx/readers/xml/part_input.h"

#include <fcntl.h>
#include <unistd.h>

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <new>
#include <optional>
#include <string_view>

#include <libxml/xmlreader.h>

#include "dpxlsx/readers/limits.h"
#include "dpxlsx/readers/xml/markup_marks.h"
#include "dpxlsx/readers/xml/part_text.h"
#include "dpxlsx/readers/xml/progress.h"
#include "dpxlsx/readers/xml/silence.h"

namespace dp {

namespace {

// A file open for reading; the destructor closes it.
class File {
  public:
    explicit File(const std::string& path)
        : descriptor_(::open(path.c_str(), O_RDONLY | O_CLOEXEC)) {}
    ~File() {
        if (descriptor_ >= 0) ::close(descriptor_);
    }
    File(const File&) = delete;
    File& operator=(const File&) = delete;

    // Negative when the file could not be opened.
    int descriptor() const { return descriptor_; }

  private:
    int descriptor_;
};

// The file behind a reader, and how far libxml2 has come in it.
class PartInput {
  public:
    explicit PartInput(const std::string& path) : file_(path), text_(file_.descriptor()) {}

    bool isOpen() const { return file_.descriptor() >= 0; }
    bool isDecoded() const { return text_.isDecoded(); }
    void watch(xmlTextReaderPtr reader) { reader_ = reader; }

    // Reads up to `size` bytes; 0 at the end, -1 on an error and beyond the limits.
    int read(char* bytes, int size) {
        const std::size_t waiting = bytesWaiting();
        if (waiting > kMarkupSize || runSize() > kRunSize) return -1;
        if (pending_.empty()) {
            const auto more = text_.next();
            if (!more) return -1;
            pending_ = *more;
        }
        const std::string_view supply = pending_.substr(0, static_cast<std::size_t>(size));
        pending_.remove_prefix(supply.copy(bytes, supply.size()));
        const bool isLong = waiting > kLongMarkup;
        return countMarks(supply, isLong) ? static_cast<int>(supply.size()) : -1;
    }

  private:
    // Bytes that libxml2 has received but not consumed. It consumes text as it arrives, but markup
    // only when complete.
    std::size_t bytesWaiting() const {
        const long used = reader_ ? xmlTextReaderByteConsumed(reader_) : supplied_;
        return used < 0 || used > supplied_ ? 0 : static_cast<std::size_t>(supplied_ - used);
    }
    // Bytes that libxml2 has received during the current move; 0 while a host moves the reader
    // itself.
    std::int64_t runSize() {
        const std::uint32_t steps = DocumentMove::steps();
        const bool moves = steps % 2 == 1;
        if (!moves || steps != stepsBefore_) runStart_ = supplied_;
        stepsBefore_ = steps;
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
            if (marks_ > kLongMarkupMarks && !countExactly()) return false;
        }
        return marks_ <= kLongMarkupMarks;
    }
    // Reads the document from its beginning again, to count exactly. False when that cannot be
    // done.
    bool countExactly() {
        const off_t position = ::lseek(file_.descriptor(), 0, SEEK_CUR);
        if (position < 0 || ::lseek(file_.descriptor(), 0, SEEK_SET) < 0) return false;
        PartText again(file_.descriptor());
        exactMarks_.emplace();
        marks_ = 0;
        for (std::int64_t at = 0; at < supplied_;) {
            const auto bytes = again.next();
            if (!bytes || bytes->empty()) return false;
            const std::string_view supply = bytes->substr(0, sizeOf(at, supplied_));
            const std::string_view before = supply.substr(0, sizeOf(at, longStart_));
            exactMarks_->countIn(before);
            marks_ += exactMarks_->countIn(supply.substr(before.size()));
            at += static_cast<std::int64_t>(supply.size());
        }
        return ::lseek(file_.descriptor(), position, SEEK_SET) >= 0;
    }
    static std::size_t sizeOf(std::int64_t begin, std::int64_t end) {
        return begin < end ? static_cast<std::size_t>(end - begin) : 0;
    }

    const File file_;
    std::uint32_t stepsBefore_ = 0;
    std::int64_t runStart_ = 0;
    PartText text_;
    std::string_view pending_;  // of the text, for libxml2
    xmlTextReaderPtr reader_ = nullptr;
    std::int64_t supplied_ = 0;   // bytes
    std::int64_t longStart_ = 0;  // where the unconsumed markup begins to count as long, in bytes
    std::size_t marks_ = 0;       // counted from there on
    std::optional<MarkupMarks> exactMarks_;
};

extern "C" {

int readPart(void* input, char* bytes, int size) {
    try {
        return static_cast<PartInput*>(input)->read(bytes, size);
    } catch (const std::bad_alloc&) {  // may not pass through libxml2
        return -1;
    }
}

int closePart(void* input) {
    delete static_cast<PartInput*>(input);
    return 0;
}

void noteText(void* payload, void* found, const xmlChar*) {
    if (static_cast<const xmlEntity*>(payload)->content) *static_cast<bool*>(found) = true;
}

}  // extern "C"

// On its own libxml2 does this when it is first used, and two threads may do that at once.
void initialiseLibxml2() { [[maybe_unused]] static const bool done = (xmlInitParser(), true); }

}  // namespace

xmlTextReaderPtr openDocument(const std::string& path) {
    initialiseLibxml2();
    Progress::beginPart(path);
    auto input = std::make_unique<PartInput>(path);
    if (!input->isOpen()) return nullptr;
    PartInput* const watching = input.get();
    const int options =
        XML_PARSE_NOERROR | XML_PARSE_NOWARNING | (input->isDecoded() ? XML_PARSE_IGNORE_ENC : 0);
    // The reader closes the input, also when it cannot be made.
    const xmlTextReaderPtr reader =
        xmlReaderForIO(readPart, closePart, input.release(), nullptr, nullptr, options);
    if (!reader) return nullptr;
    watching->watch(reader);
    // Between the reads, which silence libxml2 themselves, calls for names report a lack of memory
    // (2.15).
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
