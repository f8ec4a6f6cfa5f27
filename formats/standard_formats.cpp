#include "dpxlsx/formats/standard_formats.h"

#include <algorithm>
#include <iterator>

#include "dpxlsx/formats/date_time_translation.h"

namespace dp {
namespace {

struct BuiltInCode {
    int id;
    std::string_view code;
};

constexpr BuiltInCode kBuiltInCodes[] = {
    {1, "0"},
    {2, "0.00"},
    {3, "#,##0"},
    {4, "#,##0.00"},
    {5, R"("$"#,##0_);\("$"#,##0\))"},
    {6, R"("$"#,##0_);[Red]\("$"#,##0\))"},
    {7, R"("$"#,##0.00_);\("$"#,##0.00\))"},
    {8, R"("$"#,##0.00_);[Red]\("$"#,##0.00\))"},
    {9, "0%"},
    {10, "0.00%"},
    {11, "0.00E+00"},
    {12, "# ?/?"},
    {13, "# ?\?/?\?"},
    {14, "m/d/yyyy"},
    {15, "d-mmm-yy"},
    {16, "d-mmm"},
    {17, "mmm-yy"},
    {18, "h:mm AM/PM"},
    {19, "h:mm:ss AM/PM"},
    {20, "h:mm"},
    {21, "h:mm:ss"},
    {22, "m/d/yyyy h:mm"},
    {37, R"(#,##0_);\(#,##0\))"},
    {38, R"(#,##0_);[Red]\(#,##0\))"},
    {39, R"(#,##0.00_);\(#,##0.00\))"},
    {40, R"(#,##0.00_);[Red]\(#,##0.00\))"},
    {41, R"(_(* #,##0_);_(* \(#,##0\);_(* "-"_);_(@_))"},
    {42, R"(_("$"* #,##0_);_("$"* \(#,##0\);_("$"* "-"_);_(@_))"},
    {43, R"(_(* #,##0.00_);_(* \(#,##0.00\);_(* "-"??_);_(@_))"},
    {44, R"(_("$"* #,##0.00_);_("$"* \(#,##0.00\);_("$"* "-"??_);_(@_))"},
    {45, "mm:ss"},
    {46, "[h]:mm:ss"},
    {47, "mm:ss.0"},
    {48, "##0.0E+0"},
    {49, "@"},
};

// The ids that mean something else in each language, as those of US English.
struct SameFormats {
    int first;
    int last;
    int as;           // the format of the first id
    bool increasing;  // that of the next id for the next id, and so on
};

constexpr SameFormats kSameFormats[] = {
    {27, 31, 14, false}, {32, 35, 21, false}, {36, 36, 14, false}, {50, 58, 14, false},
    {59, 62, 1, true},   {63, 66, 5, true},   {67, 68, 9, true},   {69, 70, 12, true},
    {71, 71, 14, true},  {72, 75, 14, true},  {76, 78, 20, true},  {79, 81, 45, true},
};

int inUsEnglish(int id) {
    for (const SameFormats& same : kSameFormats)
        if (id >= same.first && id <= same.last)
            return same.increasing ? same.as + id - same.first : same.as;
    return id;
}

}  // namespace

std::string_view builtInFormatCode(int id) {
    const auto* found = std::find_if(
        std::begin(kBuiltInCodes), std::end(kBuiltInCodes),
        [english = inUsEnglish(id)](const BuiltInCode& entry) { return entry.id == english; });
    return found == std::end(kBuiltInCodes) ? "General" : found->code;
}

EXCEL_FORMAT_TYPE formatType(const NumberFormatCode& code) {
    return dateTimeType(code.sections.front());
}

}  // namespace dp
