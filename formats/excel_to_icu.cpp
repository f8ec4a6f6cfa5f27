#include "dpxlsx/formats/excel_to_icu.h"

#include <map>

namespace dp {
namespace excel2icu {
namespace {

// "h" counts 24 hours unless the code carries AM/PM; zeros of fractional seconds become "S".
const std::map<std::string, std::string> map = {
    {"m/d", "M/d"},
    {"d/m", "d/M"},
    {"m/d/yy", "M/d/yy"},
    {"mm/dd/yy", "MM/dd/yy"},
    {"d/m/yy", "d/M/yy"},
    {"dd/mm/yy", "dd/MM/yy"},
    {"d-mmm", "d-MMM"},
    {"d-mmm-yy", "d-MMM-yy"},
    {"dd-mmm-yy", "dd-MMM-yy"},
    {"mmm-yy", "MMM-yy"},
    {"mmmm-yy", "MMMM-yy"},
    {"mmmm d, yyyy", "MMMM d, yyyy"},
    {"m/d/yy h:mm AM/PM", "M/d/yy h:mm a"},
    {"m/d/yy h:mm", "M/d/yy H:mm"},
    {"mmmmm", "MMMMM"},
    {"mmmmm-yy", "MMMMM-yy"},
    {"m/d/yyyy", "M/d/yyyy"},
    {"d/m/yyyy", "d/M/yyyy"},
    {"d-mmm-yyyy", "d-MMM-yyyy"},
    {"dddd, mmmm dd, yyyy", "EEEE, MMMM dd, yyyy"},
    {"h:mm", "H:mm"},
    {"h:mm AM/PM", "h:mm a"},
    {"h:mm:ss", "H:mm:ss"},
    {"h:mm:ss.000", "H:mm:ss.SSS"},
    {"h:mm:ss AM/PM", "h:mm:ss a"},
    {"h:mm:ss.000 AM/PM", "h:mm:ss.SSS a"},
    {"mm:ss.0", "mm:ss.S"},
    {"mm:ss", "mm:ss"},
};

}  // namespace
}  // namespace excel2icu

const std::string* icuPatternOf(const std::string& excelCode) {
    const auto found = excel2icu::map.find(excelCode);
    return found == excel2icu::map.end() ? nullptr : &found->second;
}

}  // namespace dp
