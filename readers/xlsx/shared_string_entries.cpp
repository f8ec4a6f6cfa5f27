#include "dpxlsx/readers/xlsx/shared_string_entries.h"

#include <algorithm>
#include <cstdint>

#include <boost/filesystem.hpp>

#include "dpxlsx/readers/xlsx/excel_xlsx_reader.h"
#include "dpxlsx/readers/xml/cm_xml_cast.h"
#include "dpxlsx/store/text_cleaning.h"

namespace dp {

namespace {

// The shortest entry is "<si/>", so a part cannot hold more of them than this. A declared count is
// only a hint, and a hostile one must not allocate.
std::size_t entriesThatFit(const std::string& path) {
    constexpr std::uintmax_t kShortestEntry = 5;  // bytes
    boost::system::error_code error;
    const std::uintmax_t size = boost::filesystem::file_size(path, error);
    return error ? 0 : static_cast<std::size_t>(size / kShortestEntry);
}

}  // namespace

SharedStringEntries::SharedStringEntries(SharedStringTable& table, const std::string& path)
    : table_(table), path_(path) {
    table_.clear();
}

void SharedStringEntries::begin(const char* uniqueCount) {
    int count = 0;
    CmXmlCast::instance().mCast(count, uniqueCount);
    table_.reserve(std::min(static_cast<std::size_t>(std::max(count, 0)), entriesThatFit(path_)));
}

void SharedStringEntries::endEntry() {
    addEntry(text_);
    text_.clear();
}

void SharedStringEntries::addEntry(std::string_view text) {
    if (isAllSpaces(text)) return table_.add({});
    if (text.find("_x00") == text.npos) return table_.add(text);  // without any escape
    std::string decoded(text);
    ExcelXLSXReader::mParseCharString(decoded);
    table_.add(decoded);
}

}  // namespace dp
