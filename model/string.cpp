#include "dpxlsx/model/string.h"

#include <utility>

namespace dp {

String::String() = default;
String::String(std::string text) : text_(std::move(text)) {}
String::String(const String&) = default;
String::String(String&&) noexcept = default;
String& String::operator=(const String&) = default;
String& String::operator=(String&&) noexcept = default;
String::~String() = default;

const char* String::database_str() const { return text_.c_str(); }
const char* String::application_str() const { return text_.c_str(); }
std::string& String::operator=(const std::string& text) { return text_ = text; }

}  // namespace dp
