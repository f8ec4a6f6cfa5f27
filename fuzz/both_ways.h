#pragma once

#include <string>

#include "dpxlsx/readers/xml/plain_xml.h"

namespace fuzz {

// Reads a worksheet or shared-string part by the reader of plain parts, with that window, and by
// libxml2's, and fails unless both give the same. True when the part is plain.
bool readBothWays(bool strings, const std::string& path, dp::ReadingWindow window);

// Whole windows for a step of 0; else as many bytes at a time, but a part in 256 steps at most.
dp::ReadingWindow windowOf(std::size_t step, std::size_t partSize);

}  // namespace fuzz
