#include "dpxlsx/formats/section_texts.h"

#include <algorithm>
#include <iterator>
#include <vector>

namespace dp {
namespace {

using Tokens = std::vector<FormatToken>;

bool isLiteral(const FormatToken& token) { return token.kind == FormatToken::Kind::Literal; }

bool isBlank(const FormatToken& token) {
    return token.text.find_first_not_of(' ') == token.text.npos;
}

Tokens::const_iterator firstShown(const Tokens& tokens) {
    return std::find_if_not(tokens.begin(), tokens.end(), isLiteral);
}

Tokens::const_iterator behindLastShown(const Tokens& tokens) {
    return std::find_if_not(tokens.rbegin(), tokens.rend(), isLiteral).base();
}

std::string joined(Tokens::const_iterator begin, Tokens::const_iterator end) {
    std::string text;
    for (auto token = begin; token != end; ++token) text += token->text;
    return text;
}

void trimLeft(std::string& text) { text.erase(0, text.find_first_not_of(' ')); }

void trimRight(std::string& text) { text.resize(text.find_last_not_of(' ') + 1); }

// With the spaces between them and the number.
SectionTexts textsAround(const FormatSection& section) {
    const Tokens& tokens = section.tokens;
    const auto first = firstShown(tokens);
    SectionTexts texts{joined(tokens.begin(), first), {}};
    if (first != tokens.end()) texts.behind = joined(behindLastShown(tokens), tokens.end());
    trimLeft(texts.before);
    trimRight(texts.behind);
    return texts;
}

void remove(std::string& text, const std::string& unit) {
    if (const std::size_t found = text.find(unit); found != text.npos)
        text.erase(found, unit.size());
}

}  // namespace

bool isTextAlone(const FormatSection& section) {
    return firstShown(section.tokens) == section.tokens.end();
}

bool hasTextWithin(const FormatSection& section) {
    const Tokens& tokens = section.tokens;
    const auto first = firstShown(tokens);
    return first != tokens.end() &&
           std::any_of(first, behindLastShown(tokens), [](const FormatToken& token) {
               return isLiteral(token) && !isBlank(token);
           });
}

SectionTexts textsOf(const NumberFormatCode& code, std::size_t position) {
    const FormatSection& first = code.sections.front();
    const FormatSection& section = code.sections[position];
    SectionTexts texts = textsAround(section);
    if (position > 0 && !isTextAlone(first)) {
        const SectionTexts units = textsAround(first);
        remove(texts.before, units.before);
        remove(texts.behind, units.behind);
    }
    trimLeft(texts.before);
    trimRight(isTextAlone(section) ? texts.before : texts.behind);
    return texts;
}

}  // namespace dp
