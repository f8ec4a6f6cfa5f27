#include "store/text_cleaning.h"

#include <string>

#include <gtest/gtest.h>

namespace dp {
namespace {

template <unsigned short Length>
void cut(std::string& text) {
    truncateToCharLength(text, Length);
}

TEST(TextCleaning, CutsAndReplacesInPlace) {
    const struct {
        const char* name;
        void (*clean)(std::string&);
        std::string before;
        std::string after;
    } cases[] = {
        {"white space at both ends", trim, " \t a b\v\f\r\n", "a b"},
        {"nothing but white space", trim, " \t\n", ""},
        {"no ASCII white space", trim, "\u00A0x\xA0", "\u00A0x\xA0"},
        {"leading white space alone", ltrim, "\n a ", "a "},
        {"control characters and runs of spaces", CleanText, "  a\t\tb   c ", "ab c"},
        {"a space uncovered at the end", CleanText, "a \x01", "a "},
        {"spaces on both sides of a control character", CleanText, "a \x7F b", "a b"},
        {"control characters beyond ASCII", CleanText, "\u0080\u00E9", "\u0080\u00E9"},
        {"a worksheet name", CleanWorksheetName, " Q1/Q2: sales? ", "Q1_Q2_ sales_"},
        {"all that worksheet names lack", CleanWorksheetName, "?*/:<>|\"\\'[]", "_________'[]"},
        {"accents", cut<3>, "R\u00E9sum\u00E9", "R\u00E9s"},
        {"just long enough", cut<3>, "R\u00E9s", "R\u00E9s"},
        {"shorter than the limit", cut<9>, "R\u00E9s", "R\u00E9s"},
        {"ASCII", cut<3>, "abcd", "abc"},
        {"no limit", cut<0>, "R\u00E9s", "R\u00E9s"},
        {"a line end is one character", cut<1>, "\r\nab", "\r\n"},
        {"a lone carriage return", cut<1>, "\rab", "\r"},
        {"combining marks", cut<2>, "e\u0301\u0302xy", "e\u0301\u0302x"},
        {"joined signs", cut<1>, "\U0001F469\u200D\U0001F466!", "\U0001F469\u200D\U0001F466"},
        {"broken UTF-8", cut<2>, "\xC3(\xC3x", "\xC3("},
    };
    for (const auto& [name, clean, before, after] : cases) {
        std::string text = before;
        clean(text);
        EXPECT_EQ(text, after) << name;
    }
}

}  // namespace
}  // namespace dp
