#include <algorithm>
#include <string_view>
#include <utility>

#include "dpxlsx/readers/xlsx/any_shared_strings.h"
#include "dpxlsx/readers/xlsx/excel_xlsx_reader.h"
#include "dpxlsx/readers/xlsx/opened_package.h"
#include "dpxlsx/readers/xlsx/plain_shared_strings.h"

// The shared-string table and the escapes of its texts.
namespace dp {

namespace {

constexpr std::string_view kEscape = "_x00";  // how each begins

int hexDigit(char digit) {
    if (digit >= '0' && digit <= '9') return digit - '0';
    if (digit >= 'A' && digit <= 'F') return digit - 'A' + 10;
    return 0;
}

}  // namespace

void ExcelXLSXReader::mReadSharedStrings() {
    if (!hasSharedStrings) return;
    const std::string path = xlDir + "/sharedStrings.xml";
    if (!readPlainSharedStrings(path, opened_->sharedStrings))
        readAnySharedStrings(path, opened_->sharedStrings);
    opened_->textBudget.addPart(path);
}

void ExcelXLSXReader::mParseCharString(std::string& text) {
    constexpr std::size_t kLength = 7;  // of "_x000D_"
    std::size_t escape = text.find(kEscape);
    if (escape == text.npos) return;

    std::string decoded;
    std::size_t copied = 0;
    for (; escape != text.npos; escape = text.find(kEscape, copied)) {
        decoded.append(text, copied, escape - copied);
        const std::string_view code = std::string_view(text).substr(escape, kLength);
        copied = escape + kLength;
        if (code == "_x005F_") {
            decoded += '_';
        } else if (code >= "_x0001_" && code <= "_x001F_") {
            // The check above guarantees a fifth character, but the text may end there: then there
            // is no sixth.
            const int low = code.size() > 5 ? hexDigit(code[5]) : 0;
            decoded += static_cast<char>((code[4] == '1' ? 16 : 0) + low);
        } else {
            decoded += kEscape;
            copied = escape + kEscape.size();
        }
    }
    decoded.append(text, std::min(copied, text.size()), text.npos);
    text = std::move(decoded);
}

}  // namespace dp
