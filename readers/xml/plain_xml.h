#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <set>
#include <string>
#include <string_view>
#include <vector>

namespace dp {

// How a document comes into memory. A test makes both sizes small, so that the edges fall
// everywhere.
struct ReadingWindow {
    // Bytes of the file in memory at a time. Longer tags and texts are not plain.
    std::size_t size = std::size_t{256} << 10;
    // Bytes that are read at most at a time.
    std::size_t step = std::size_t{256} << 10;
};

// Reads XML as spreadsheet programs write it, several times as fast as libxml2's text reader.
//
// It accepts only what is well-formed beyond doubt and means the same to libxml2: UTF-8, elements,
// attributes, text, character references and the five predefined entities, names in ASCII. All else
// is "not plain": errors, document types, comments, CDATA sections, other encodings, whatever comes
// near a limit of libxml2 or of ours. Not plain says nothing about a document but that libxml2 is
// to read it, from its beginning.
class PlainXml {
  public:
    enum class Node {
        Start,     // of an element; its End follows
        Empty,     // an element that is one tag; no End follows
        End,       // of an element
        Text,      // all characters up to the next tag
        Finished,  // the document ended
        NotPlain,
    };

    explicit PlainXml(ReadingWindow window = {});
    ~PlainXml();
    PlainXml(const PlainXml&) = delete;
    PlainXml& operator=(const PlainXml&) = delete;

    // Opens the document, once. False when it cannot be read or does not begin plainly.
    bool open(const std::string& path);

    // Moves to the next node. After Finished or NotPlain there is none.
    Node next();

    // The name of the Start, Empty or End node with its prefix; valid until the next move.
    std::string_view name() const { return name_; }
    // The name without its prefix of the element that holds the Text node.
    std::string_view parentName() const;
    // The value of an attribute without prefix of the Start or Empty node, null when it has none of
    // that name. Valid until the next move.
    const char* attribute(std::string_view name);
    // The characters of the Text node, at least one, with a zero behind them. Valid until the next
    // move.
    std::string_view text();

    // --- For callers who know what usually comes next ---

    // Zeros behind the bytes that have been read: callers may compare so many bytes at a time.
    static constexpr std::size_t kZeros = 16;
    // The bytes from the next node on, and behind those that have been read so far kZeros zeros.
    // The caller may write to them, and puts back what was there.
    char* ahead();
    // Goes on at `place`, which is behind plain elements that begin at ahead() and are complete;
    // they must be inside the root element.
    void skipTo(char* place) { at_ = place; }
    bool isInsideRoot() const { return !openLengths_.empty(); }
    // The first byte from `text` on that is not an ordinary ASCII character of a text.
    static char* endOfOrdinaryText(char* text);

  private:
    enum class Scan { Complete, Incomplete, NotPlain };
    struct Attribute {
        std::string_view name;
        char* value;
        char* valueEnd;
        bool raw;  // as it stands in the document, and not the same as its value
    };
    struct Prefix {
        std::string name;
        std::size_t depth;  // of the element that declares it
    };
    static constexpr std::size_t kAttributes = 48;

    bool fill();
    Node nextOutsideRoot();
    Scan scanMarkup(Node& node);
    Scan scanStartTag(Node& node);
    Scan scanEndTag();
    Scan scanText();
    Scan scanAttributes(char*& p);
    Scan scanAttribute(char*& p);
    Scan scanValue(char*& p, Attribute& attribute);
    Scan scanCharacter(char*& p) const;
    Scan scanReference(char*& p) const;
    Scan stopAt(const char* p) const { return p == end_ ? Scan::Incomplete : Scan::NotPlain; }
    bool acceptTag();
    bool acceptName(std::string_view name);
    bool acceptAttribute(const Attribute& attribute);
    bool isUnique(std::size_t index) const;
    bool isDeclared(std::string_view prefix) const;
    bool remember(std::string_view text);
    void pushElement();
    void popElement();
    std::string_view innermost() const;

    ReadingWindow window_;
    int descriptor_ = -1;
    std::unique_ptr<char[]> buffer_;
    char* at_ = nullptr;   // where the next node begins
    char* end_ = nullptr;  // behind the bytes read so far; kZeros zeros follow
    bool endOfFile_ = false;
    bool readError_ = false;
    bool rootSeen_ = false;
    std::size_t blanksOutside_ = 0;  // bytes of white space outside the root so far
    bool lessIsZero_ = false;        // at_ points to a zero that stands for a '<'
    std::string_view name_;
    char* text_ = nullptr;
    char* textEnd_ = nullptr;
    bool textRaw_ = false;
    std::array<Attribute, kAttributes> attributes_;
    std::size_t attributeCount_ = 0;
    std::string openNames_;  // of the open elements, one behind the other
    std::vector<std::uint16_t> openLengths_;
    std::vector<Prefix> prefixes_;
    std::set<std::string> known_;  // ordered: hashes could be made to collide
    std::size_t knownSize_ = 0;    // bytes
    std::array<std::string, 64> lately_;
};

}  // namespace dp
