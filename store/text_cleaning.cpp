#include "dpxlsx/store/text_cleaning.h"

#include <algorithm>
#include <cctype>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <string_view>

#include <unicode/brkiter.h>
#include <unicode/utext.h>

namespace dp {

namespace {

bool isSpace(char byte) { return std::isspace(static_cast<unsigned char>(byte)) != 0; }

bool isAscii(char byte) { return static_cast<unsigned char>(byte) < 0x80; }

bool isAsciiControl(char byte) {
    return isAscii(byte) && std::iscntrl(static_cast<unsigned char>(byte)) != 0;
}

bool isUnprintableAscii(char byte) {
    return isAscii(byte) && std::isprint(static_cast<unsigned char>(byte)) == 0;
}

struct CloseText {
    void operator()(UText* text) const { utext_close(text); }
};

// One iterator serves all calls of a thread, because creating one takes far longer than walking a
// name.
thread_local std::unique_ptr<icu::BreakIterator> characters;

// Null when ICU makes none.
icu::BreakIterator* breakIterator() {
    UErrorCode status = U_ZERO_ERROR;
    if (!characters)
        characters.reset(
            icu::BreakIterator::createCharacterInstance(icu::Locale::getDefault(), status));
    return characters.get();
}

// The iterator over the characters of `text`, which the caller keeps until the next call; null when
// there is none.
icu::BreakIterator* charactersOf(std::string_view text) {
    icu::BreakIterator* const iterator = breakIterator();
    if (!iterator) return nullptr;
    UErrorCode status = U_ZERO_ERROR;
    const std::unique_ptr<UText, CloseText> walked(
        utext_openUTF8(nullptr, text.data(), static_cast<std::int64_t>(text.size()), &status));
    iterator->setText(walked.get(), status);
    return U_FAILURE(status) ? nullptr : iterator;
}

// Every byte is a character of its own; only a carriage return may join with a line feed.
bool isPlainAscii(std::string_view text) {
    return std::all_of(text.begin(), text.end(), [](char c) { return isAscii(c) && c != '\r'; });
}

}  // namespace

void ltrim(std::string& text) {
    text.erase(text.begin(), std::find_if_not(text.begin(), text.end(), isSpace));
}

void trim(std::string& text) {
    text.erase(std::find_if_not(text.rbegin(), text.rend(), isSpace).base(), text.end());
    ltrim(text);
}

void CleanText(std::string& text) {
    trim(text);
    std::erase_if(text, isAsciiControl);
    const auto bothSpaces = [](char left, char right) { return left == ' ' && right == ' '; };
    text.erase(std::unique(text.begin(), text.end(), bothSpaces), text.end());
}

void CleanWorksheetName(std::string& name) {
    constexpr std::string_view kForbidden = "?*/:<>|\"\\";
    std::replace_if(
        name.begin(), name.end(), [&](char c) { return kForbidden.find(c) != kForbidden.npos; },
        '_');
    trim(name);
}

void truncateToCharLength(std::string& text, unsigned short maxChars) {
    // No character is shorter than a byte, so such a text cannot be too long.
    if (maxChars == 0 || text.size() <= maxChars) return;
    if (isPlainAscii(text)) {
        text.erase(maxChars);
        return;
    }
    icu::BreakIterator* const iterator = charactersOf(text);
    if (!iterator) return;
    std::int32_t boundary = iterator->first();
    for (unsigned passed = 0; passed < maxChars; ++passed) {
        boundary = iterator->next();
        if (boundary == icu::BreakIterator::DONE) return;
    }
    text.erase(static_cast<std::size_t>(boundary));
}

std::size_t wholeCharacters(std::string_view text, std::size_t bytes) {
    std::size_t codePoints = bytes;
    while (codePoints > 0 && (static_cast<unsigned char>(text[codePoints]) & 0xC0U) == 0x80U)
        --codePoints;
    icu::BreakIterator* const iterator = charactersOf(text);
    if (!iterator) return codePoints;
    const auto end = static_cast<std::int32_t>(codePoints);
    const std::int32_t boundary = iterator->isBoundary(end) ? end : iterator->preceding(end);
    return boundary > 0 ? static_cast<std::size_t>(boundary) : codePoints;
}

void cleanVariableName(std::string& name, unsigned short maxChars) {
    truncateToCharLength(name, maxChars);
    std::replace(name.begin(), name.end(), '\n', ' ');
    trim(name);
    if (!name.empty() && name.front() == '*') name.front() = '_';
    std::replace_if(
        name.begin(), name.end(),
        [](char c) { return c == '\'' || c == '#' || isUnprintableAscii(c); }, '_');
}

bool isAllSpaces(std::string_view text) { return text.find_first_not_of(' ') == text.npos; }

}  // namespace dp
