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

bool isOfWord(char c) {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c & '\x80') != 0;
}

bool hasMinus(const std::string& text) {
    if (text.find("\u2212") != text.npos) return true;
    for (std::size_t i = text.find('-'); i != text.npos; i = text.find('-', i + 1)) {
        const bool isHyphen =
            i > 0 && i + 1 < text.size() && isOfWord(text[i - 1]) && isOfWord(text[i + 1]);
        if (!isHyphen) return true;
    }
    return false;
}

void trimLeft(std::string& text) { text.erase(0, text.find_first_not_of(' ')); }

void trimRight(std::string& text) { text.resize(text.find_last_not_of(' ') + 1); }

// The literals around what the section shows.
struct Literals {
    Tokens before;
    Tokens behind;
};

Literals literalsAround(const FormatSection& section) {
    const Tokens& tokens = section.tokens;
    const auto first = firstShown(tokens);
    Literals literals{{tokens.begin(), first}, {}};
    if (first != tokens.end()) literals.behind.assign(behindLastShown(tokens), tokens.end());
    return literals;
}

// With the spaces between them and the number.
SectionTexts textsOf(const Literals& literals) {
    SectionTexts texts{joined(literals.before.begin(), literals.before.end()),
                       joined(literals.behind.begin(), literals.behind.end())};
    trimLeft(texts.before);
    trimRight(texts.behind);
    return texts;
}

// Whole literals that make up the unit together.
void remove(Tokens& literals, const std::string& unit) {
    if (unit.empty()) return;
    for (auto begin = literals.begin(); begin != literals.end(); ++begin) {
        std::string text;
        for (auto end = begin; end != literals.end() && text.size() < unit.size();) {
            text += (end++)->text;
            if (text != unit) continue;
            literals.erase(begin, end);
            return;
        }
    }
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

bool showMinus(const SectionTexts& texts) {
    const auto has = [](const std::string& text, char c) { return text.find(c) != text.npos; };
    return hasMinus(texts.before) || hasMinus(texts.behind) ||
           (has(texts.before, '(') && has(texts.behind, ')'));
}

SectionTexts textsOf(const NumberFormatCode& code, std::size_t position) {
    const FormatSection& first = code.sections.front();
    const FormatSection& section = code.sections[position];
    Literals literals = literalsAround(section);
    if (position > 0 && !isTextAlone(first) && !isTextAlone(section)) {
        const SectionTexts units = textsOf(literalsAround(first));
        remove(literals.before, units.before);
        remove(literals.behind, units.behind);
    }
    SectionTexts texts = textsOf(literals);
    if (isTextAlone(section)) trimRight(texts.before);
    return texts;
}

}  // namespace dp
