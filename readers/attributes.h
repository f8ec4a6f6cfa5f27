#pragma once

#include <string>

struct _xmlAttr;  // libxml2's own name; NOLINT(bugprone-reserved-identifier)

class XmlReader;

namespace dp {

// The attributes of the element on which a reader stands, found by walking its list once each: a
// look-up through the text reader takes the name apart every time. The cursor does not move; none
// are found while it stands on an attribute.
class Attributes {
  public:
    explicit Attributes(XmlReader& reader);

    // The value of an attribute without prefix, or of `prefix`:`name`; null when there is none.
    // Valid until the next call or read, and no longer than this object.
    const char* find(const char* name, const char* prefix = nullptr) &;

    const _xmlAttr* first() const { return first_; }
    // The value of one of the element's attributes; valid until the next call or read.
    const char* valueOf(const _xmlAttr* attribute) &;

  private:
    const _xmlAttr* first_;
    std::string expanded_;
};

}  // namespace dp
