#include "dpxlsx/readers/standard/part_name.h"

#include <algorithm>
#include <charconv>
#include <vector>

#include "dpxlsx/readers/limits.h"
#include "dpxlsx/readers/xml/xml_reader.h"

namespace dp::standard {

namespace {

// The byte of an escape such as "%20" at the beginning of `text`, or -1. What would become a
// separator or end the name stays escaped.
int escapedByte(std::string_view text) {
    if (text.size() < 3 || text.front() != '%') return -1;
    int byte = -1;
    const char* const end = text.data() + 3;
    const auto result = std::from_chars(text.data() + 1, end, byte, 16);
    if (result.ptr != end || byte == '/' || byte == '\\' || byte <= 0) return -1;
    return byte;
}

std::string decoded(std::string_view text) {
    std::string name;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const int byte = escapedByte(text.substr(i));
        name += byte >= 0 ? static_cast<char>(byte) : text[i] == '\\' ? '/' : text[i];
        if (byte >= 0) i += 2;
    }
    return name;
}

void appendSegments(std::string_view path, std::vector<std::string_view>& segments) {
    while (!path.empty()) {
        const std::size_t slash = path.find('/');
        const std::string_view segment = path.substr(0, slash);
        path.remove_prefix(slash == path.npos ? path.size() : slash + 1);
        if (segment == "..") {
            if (!segments.empty()) segments.pop_back();
        } else if (!segment.empty() && segment != ".") {
            segments.push_back(segment);
        }
    }
}

}  // namespace

std::string resolvePartName(std::string_view source, std::string_view target) {
    if (target.size() > kTargetSize) throw CmXmlException(kXmlError);
    const std::string path = decoded(target);
    std::vector<std::string_view> segments;
    if (!path.starts_with('/')) {
        appendSegments(source, segments);
        if (!segments.empty()) segments.pop_back();
    }
    appendSegments(path, segments);
    std::string name;
    for (const std::string_view segment : segments)
        name.append(name.empty() ? "" : "/").append(segment);
    return name;
}

std::string relationshipPartOf(std::string_view source) {
    const std::size_t slash = source.rfind('/');
    const std::size_t file = slash == source.npos ? 0 : slash + 1;
    return std::string(source.substr(0, file)) + "_rels/" + std::string(source.substr(file)) +
           ".rels";
}

std::string foldPartName(std::string_view name) {
    std::string folded(name);
    std::transform(folded.begin(), folded.end(), folded.begin(), [](char c) {
        return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
    });
    return folded;
}

}  // namespace dp::standard
