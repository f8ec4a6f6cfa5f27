#include "tools/explain/trait.h"

#include <utility>

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

std::vector<TraitPlace> placesOf(const Tally& cells) {
    std::vector<TraitPlace> places;
    for (const Tally::Entry& entry : cells.entries()) places.push_back({entry.place, entry.count});
    return places;
}

std::string optionsOf(const std::vector<TraitPlace>& places) {
    std::string options;
    for (const TraitPlace& place : places) options += (options.empty() ? "" : " ") + place.options;
    return options;
}

Trait located(Trait trait, std::vector<TraitPlace> places, const std::string& options) {
    trait.places = std::move(places);
    if (!options.empty()) trait.cures.push_back(options);
    return trait;
}

std::string joined(const std::vector<std::string>& texts, const char* between) {
    std::string result;
    for (const std::string& text : texts) result += (result.empty() ? "" : between) + text;
    return result;
}

}  // namespace dp::tool
