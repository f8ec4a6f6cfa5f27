#pragma once

#include <string>
#include <vector>

#include "dpxlsx/readers/xml/xml_reader.h"

namespace dp::xml {

// Names as the document's own copies, so that comparing pointers nearly always suffices. Valid as
// long as the reader, and only for names that this reader returns.
class KnownNames {
  public:
    KnownNames(XmlReader& reader, const std::vector<std::string>& names);

    // The index of a name that the reader returned, -1 when it is not one of these.
    int find(const char* name) const;

  private:
    std::vector<const char*> names_;
};

// Moves to the next element whose name is among `names` and returns the name's index; stays where
// it is when the current element is one. -1 at the end of the document; without names it reads to
// there. Throws CmXmlException.
int readToOneOf(XmlReader& reader, const KnownNames& names);

// Moves to the next node of content, skipping comments and processing instructions. False at the
// end of the document. Throws CmXmlException.
bool readContent(XmlReader& reader);

}  // namespace dp::xml
