#pragma once

#include <string_view>

namespace dp::tool {

// The page of page.html with its style and script in it; cmake/embed-page.cmake makes the source.
std::string_view pageTemplate();

// Where the data belongs.
inline constexpr std::string_view kDataMark = "@DATA@";

}  // namespace dp::tool
