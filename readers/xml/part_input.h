#pragma once

#include <cstdint>
#include <string>

struct _xmlTextReader;  // libxml2's own name; NOLINT(bugprone-reserved-identifier)

namespace dp {

// One move of a document's reader by the library, as long as it lives. What libxml2 reads of the
// file during one move lies between two nodes, and is limited; a host that moves the reader itself
// is on its own. The moves are counted for each thread, because XmlReader, whose fields hosts know,
// has no room for a count of its own. That suffices: while one reader moves, no other reader of
// the thread does.
class DocumentMove {
  public:
    DocumentMove() { ++steps_; }
    ~DocumentMove() { ++steps_; }
    DocumentMove(const DocumentMove&) = delete;
    DocumentMove& operator=(const DocumentMove&) = delete;

    // Odd during a move, and another number in each.
    static std::uint32_t steps() { return steps_; }

  private:
    static inline constinit thread_local std::uint32_t steps_ = 0;
};

// A reader of the document at `path`, owned by the caller; null when it cannot be opened. libxml2
// gets the file's bytes unchanged: if it opened the path itself, it would decompress a compressed
// file and bypass every limit. Markup beyond the limits is a read error.
_xmlTextReader* openDocument(const std::string& path);

// True for a document with declarations that make libxml2 work out of proportion to the document's
// size: entities, which attributes may repeat any number of times, or attributes, for which it
// keeps cross-references. The reader must be on the first node.
bool declaresTooMuch(_xmlTextReader* reader);

// Limits the memory for names of the document. The reader must be on the first node.
void limitNames(_xmlTextReader* reader);

}  // namespace dp
