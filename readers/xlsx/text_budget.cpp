#include "dpxlsx/readers/xlsx/text_budget.h"

#include <boost/filesystem.hpp>

#include "dpxlsx/readers/xml/xml_reader.h"

namespace dp {

void TextBudget::addPart(const std::string& path) {
    boost::system::error_code error;
    const std::uintmax_t size = boost::filesystem::file_size(path, error);
    if (!error) left_ += size * kTextGrowth;
}

void TextBudget::spend(std::size_t size) {
    if (size > left_) throw CmXmlException(kXmlError);
    left_ -= size;
}

}  // namespace dp
