#pragma once

#include <string>

#include "model/host/export.h"

namespace dp {

// One UTF-8 text. The pointers that it answers are zero-terminated, owned by the string and valid
// until it changes or dies.
class DPXLSX_API IString {
  public:
    virtual ~IString() = default;

    virtual const char* database_str() const = 0;
    virtual const char* application_str() const = 0;
    // Replaces the text; returns the stored text.
    virtual std::string& operator=(const std::string& text) = 0;
};

}  // namespace dp
