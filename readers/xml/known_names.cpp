#include "dpxlsx/readers/xml/known_names.h"

#include <algorithm>
#include <cstring>

#include <libxml/xmlreader.h>

namespace dp::xml {

KnownNames::KnownNames(XmlReader& reader, const std::vector<std::string>& names) {
    for (const std::string& name : names) names_.push_back(reader.knownName(name.c_str()));
}

int KnownNames::find(const char* name) const {
    const auto position = [this](auto isName) {
        const auto found = std::find_if(names_.begin(), names_.end(), isName);
        return found == names_.end() ? -1 : static_cast<int>(found - names_.begin());
    };
    const int same = position([name](const char* known) { return known == name; });
    if (same != -1 || !name) return same;
    // A name with a prefix is another copy: compare characters.
    return position([name](const char* known) { return std::strcmp(known, name) == 0; });
}

int readToOneOf(XmlReader& reader, const KnownNames& names) {
    bool onElement = reader.nodeType() == XML_READER_TYPE_ELEMENT || reader.readToElement();
    for (; onElement; onElement = reader.readToElement())
        if (const int found = names.find(reader.nodeName()); found != -1) return found;
    return -1;
}

bool readContent(XmlReader& reader) {
    while (reader.readNode()) {
        const int type = reader.nodeType();
        if (type != XML_READER_TYPE_COMMENT && type != XML_READER_TYPE_PROCESSING_INSTRUCTION)
            return true;
    }
    return false;
}

}  // namespace dp::xml
