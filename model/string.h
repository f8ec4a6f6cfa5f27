#pragma once

#include <string>

#include "dpxlsx/model/host/i_string.h"

namespace dp {

// The text type of all host interfaces. Storage and display form are the same UTF-8 text.
class DPXLSX_API String : public IString {
  public:
    String();
    explicit String(std::string text);
    String(const String& other);
    String(String&& other) noexcept;
    String& operator=(const String& other);
    String& operator=(String&& other) noexcept;
    ~String() override;

    const char* database_str() const override;
    const char* application_str() const override;
    std::string& operator=(const std::string& text) override;

    // The text itself, for those who fill or read it in place.
    std::string& text() { return text_; }
    const std::string& text() const { return text_; }

  private:
    std::string text_;
};

// The empty text for a null pointer: hosts may pass null wherever a text is optional.
inline const char* textOrEmpty(const char* text) { return text ? text : ""; }

}  // namespace dp
