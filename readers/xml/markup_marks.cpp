#include "dpxlsx/readers/xml/markup_marks.h"

namespace dp {

std::size_t MarkupMarks::countIn(std::string_view bytes) {
    std::size_t count = 0;
    for (const char c : bytes) {
        take(c);
        if (isMarkupMark(c) && enclosed_ != &kSection) ++count;
    }
    return count;
}

void MarkupMarks::take(char c) {
    last_ = last_ << 8 | static_cast<unsigned char>(c);
    ++length_;
    if (enclosed_) {
        // The opening and the closing share no bytes: "<!-->" does not end a comment.
        const bool isLongEnough = length_ >= enclosed_->opening.size() + enclosed_->closing.size();
        if (isLongEnough && endsWith(enclosed_->closing)) enclosed_ = nullptr;
    } else if (quote_ != '\0') {
        if (c == quote_) quote_ = '\0';
    } else if (c == '<') {
        // Possible within a tag too: a document type contains declarations and comments.
        inTag_ = true;
        length_ = 0;
    } else if (inTag_) {
        takeInTag(c);
    }
}

void MarkupMarks::takeInTag(char c) {
    if (c == '"' || c == '\'') quote_ = c;
    for (const Enclosed* each : {&kComment, &kSection, &kInstruction})
        if (length_ == each->opening.size() && endsWith(each->opening)) enclosed_ = each;
    if (c == '>' || enclosed_) inTag_ = false;
}

bool MarkupMarks::endsWith(std::string_view text) const {
    std::uint64_t bytes = 0;
    for (const char c : text) bytes = bytes << 8 | static_cast<unsigned char>(c);
    return last_ << (64 - 8 * text.size()) == bytes << (64 - 8 * text.size());
}

}  // namespace dp
