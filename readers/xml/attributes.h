#pragma once

#include <string>

struct _xmlAttr;  // libxml2's own name; NOLINT(bugprone-reserved-identifier)

class XmlReader;

namespace dp {

// The attributes of the reader's current element. Each is found by walking libxml2's own list,
// because a lookup through the text reader splits the name into prefix and local name every time.
// The cursor does not move; while it is on an attribute, none are found.
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
