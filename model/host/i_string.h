#pragma once

#include <string>

#include "export.h"

namespace dp {

// One UTF-8 text. The pointers that it returns are never null; they are zero-terminated, owned by
// the string and valid until it changes or goes.
class DPXLSX_API IString {
  public:
    virtual ~IString() = default;

    // The text as it is stored. Of a string that the host implements, the library reads this one.
    virtual const char* database_str() const = 0;
    // The text as it is shown; in the library's own strings the same pointer as database_str().
    virtual const char* application_str() const = 0;
    // Replaces the text by a copy of `text`; returns the stored text.
    virtual std::string& operator=(const std::string& text) = 0;
};

}  // namespace dp
