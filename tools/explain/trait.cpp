#include "tools/explain/trait.h"

#include "tools/views/text.h"

namespace dp::tool {

std::string quoted(const std::string& text) { return "\"" + text + "\""; }

std::string listed(const Names& names, bool quotes) {
    std::string text;
    for (const std::string& name : names.first) {
        text += (text.empty() ? "" : ", ") + (quotes ? quoted(name) : name);
    }
    if (names.count > names.first.size()) {
        text += " and " + std::to_string(names.count - names.first.size()) + " more";
    }
    return text;
}

std::string worksheets(const Names& names) {
    return (names.count == 1 ? "worksheet " : "worksheets ") + listed(names, true);
}

std::string placed(const Places& places, const std::string& unit) {
    const std::string first = places.count == 1 ? " (" : " (first: ";
    return counted(places.count, unit) + first + places.first + ")";
}

std::string joined(const std::vector<std::string>& texts, const char* between) {
    std::string result;
    for (const std::string& text : texts) result += (result.empty() ? "" : between) + text;
    return result;
}

}  // namespace dp::tool
