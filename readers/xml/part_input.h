#pragma once

#include <cstdint>
#include <string>

struct _xmlTextReader;  // libxml2's own name; NOLINT(bugprone-reserved-identifier)

namespace dp {

// A reader of the document at `path`, owned by the caller; null when it cannot be opened. `moves`
// is odd while the reader is moving, changes with each move, and outlives the reader. libxml2 gets
// the file's bytes unchanged: if it opened the path itself, it would decompress a compressed file
// and bypass every limit. Markup beyond the limits is a read error.
_xmlTextReader* openDocument(const std::string& path, const std::uint32_t& moves);

// True for a document with declarations that make libxml2 work out of proportion to the document's
// size: entities, which attributes may repeat any number of times, or attributes, for which it
// keeps cross-references. The reader must be on the first node.
bool declaresTooMuch(_xmlTextReader* reader);

// Limits the memory for names of the document. The reader must be on the first node.
void limitNames(_xmlTextReader* reader);

}  // namespace dp
