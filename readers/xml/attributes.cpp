#include "dpxlsx/readers/xml/attributes.h"

#include <cstring>

#include <libxml/xmlreader.h>

#include "dpxlsx/readers/xml/xml_reader.h"

namespace dp {

namespace {

bool equal(const xmlChar* name, const char* wanted) {
    return std::strcmp(reinterpret_cast<const char*>(name), wanted) == 0;
}

}  // namespace

Attributes::Attributes(XmlReader& reader) : first_(nullptr) {
    const xmlNode* element = xmlTextReaderCurrentNode(reader.textReader);
    if (element && element->type == XML_ELEMENT_NODE) first_ = element->properties;
}

const char* Attributes::find(const char* name, const char* prefix) & {
    for (const xmlAttr* attribute = first_; attribute; attribute = attribute->next) {
        const xmlChar* own = attribute->ns ? attribute->ns->prefix : nullptr;
        const bool samePrefix = prefix ? own && equal(own, prefix) : !own;
        if (samePrefix && equal(attribute->name, name)) return valueOf(attribute);
    }
    return nullptr;
}

const char* Attributes::valueOf(const xmlAttr* attribute) & {
    const xmlNode* value = attribute->children;
    if (!value) return "";
    // When memory runs out, libxml2 leaves a text node without content.
    if (value->type == XML_TEXT_NODE && !value->next)
        return value->content ? reinterpret_cast<const char*>(value->content) : "";
    // Values with character or entity references may have several nodes.
    xmlChar* text = xmlNodeListGetString(attribute->doc, value, 1);
    expanded_ = text ? reinterpret_cast<const char*>(text) : "";
    xmlFree(text);
    return expanded_.c_str();
}

}  // namespace dp
