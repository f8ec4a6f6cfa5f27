#include "dpxlsx/readers/xlsx/repeated_parts.h"

#include <algorithm>

#include <boost/filesystem.hpp>

#include "dpxlsx/readers/xml/xml_reader.h"

namespace dp {

void RepeatedParts::visit(const std::string& path) {
    if (paths_.insert(path).second) return;
    boost::system::error_code error;
    const std::uint64_t size = boost::filesystem::file_size(path, error);
    const std::uint64_t cost = error ? kLeastReading : std::max(size, kLeastReading);
    if (cost > left_) throw CmXmlException(kXmlError);
    left_ -= cost;
}

}  // namespace dp
