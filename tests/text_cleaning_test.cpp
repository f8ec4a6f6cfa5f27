#include "dpxlsx/store/text_cleaning.h"

#include "dpxlsx/store/conversion.h"
#include "tests/case_table.h"

namespace {

TEST(TextCleaning, CutsAndReplacesInPlace) {
    for (const auto& c : caseTable("text_cleaning.txt")) {
        std::string text = c[1];
        if (c[0] == "trim") dp::trim(text);
        if (c[0] == "ltrim") dp::ltrim(text);
        if (c[0] == "CleanText") dp::CleanText(text);
        if (c[0] == "CleanWorksheetName") dp::CleanWorksheetName(text);
        if (c[0].starts_with("cut"))
            dp::truncateToCharLength(text, static_cast<unsigned short>(std::stoi(c[0].substr(4))));
        EXPECT_EQ(text, c[2]) << c[0] << " of " << c[1];
    }
}

TEST(TextCleaning, ATextThatIsCutReturnsItsMemory) {
    std::string text(1000, 'x');
    dp::cutToBytes(text, 4);
    EXPECT_EQ(text, "xxxx");
    EXPECT_LT(text.capacity(), 300U);
}

}  // namespace
