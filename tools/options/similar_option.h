#pragma once

#include <string>
#include <string_view>

namespace dp::tool {

// The option that may be meant by a word that is none; empty when none is similar.
std::string similarOption(std::string_view word);

}  // namespace dp::tool
