#include "tools/explain/explain.h"

#include <algorithm>
#include <cctype>
#include <exception>
#include <optional>
#include <vector>

#include <nlohmann/json.hpp>

#include "tools/explain/inspection.h"
#include "tools/explain/traits.h"
#include "tools/host/interrupt.h"
#include "tools/host/workbook.h"
#include "tools/views/text.h"

namespace dp::tool {

namespace {

using Json = nlohmann::ordered_json;

constexpr const char* kNothing = "nothing to explain";

struct Attempt {
    std::optional<Failure> failure;  // none when the import goes well
    Lost lost;
    Imported imported;
};

ImportedSheet described(const LoadedWorksheet& worksheet, const ReadSettings& settings) {
    ImportedSheet sheet{worksheet.key,
                        worksheet.layout.nameRow,
                        worksheet.layout.firstDataRow,
                        {},
                        worksheet.leftOut,
                        {}};
    for (size_t i = 0; i < worksheet.columns.size(); ++i) {
        sheet.columns.emplace(worksheet.numbers[i], worksheet.columns[i].kind());
    }
    for (const auto& [where, type] : settings.types) {
        const std::string& name = where.worksheet;
        const bool here =
            name.empty() || name == worksheet.title || name == std::to_string(worksheet.key);
        if (here) sheet.chosen.insert(where.column);
    }
    return sheet;
}

Attempt tryImport(const Library& library, const Options& options) {
    Attempt attempt;
    try {
        Workbook workbook(library, options);
        workbook.open();
        attempt.imported.leftOut = workbook.leftOut();
        attempt.imported.cleaned = options.settings.cleanSheetNames;
        for (const SheetEntry& sheet : workbook.worksheets()) {
            const LoadedWorksheet worksheet = workbook.load(sheet);
            workbook.noteShown(worksheet);
            attempt.imported.sheets.emplace(sheet.title, described(worksheet, options.settings));
        }
        attempt.lost = workbook.losses().lost();
    } catch (const Interrupted&) {
        throw;
    } catch (...) {
        attempt = {currentFailure(options.book), {}, {}};
    }
    return attempt;
}

// Whether the failure says nothing about the book.
bool isOfTheSystem(const Failure& failure) {
    const int code = failure.code();
    return code == kNoSuchFile || code == kTemporaryDirectory || code == kSystemFailure ||
           code == kLibraryFailure || code == kUsage;
}

// Nothing when the inspection fails: the result of the import itself stands.
Findings quickFindings(const std::string& book, const std::string& folder,
                       const std::set<std::string>& leftOut) {
    try {
        return inspectQuickly(book, folder, leftOut);
    } catch (const std::exception&) {
        return {};
    }
}

std::string line(const Trait& trait) {
    std::string text = printable(trait.found + ": " + trait.effect + "; " + trait.advice);
    text[0] = static_cast<char>(std::toupper(static_cast<unsigned char>(text[0])));
    return text + "\n";
}

Json traitJson(const Trait& trait) {
    Json cures = Json::array();
    for (const std::string& cure : trait.cures) cures.push_back(validUtf8(cure));
    Json places = Json::array();
    for (const TraitPlace& place : trait.places) {
        if (place.place.empty()) continue;  // a column that is not known
        Json json = {{"place", validUtf8(place.place)}};
        if (place.cells > 0) json["cells"] = place.cells;
        if (!place.options.empty()) json["cure"] = validUtf8(place.options);
        places.push_back(std::move(json));
    }
    return {{"trait", trait.key},
            {"found", validUtf8(trait.found)},
            {"effect", validUtf8(trait.effect)},
            {"advice", validUtf8(trait.advice)},
            {"importFails", trait.fatal},
            {"cures", std::move(cures)},
            {"places", std::move(places)}};
}

}  // namespace

std::vector<Trait> findTraits(const Library& library, const Options& options) {
    const Attempt attempt = tryImport(library, options);
    const std::optional<Failure>& failure = attempt.failure;
    if (failure && isOfTheSystem(*failure)) throw *failure;
    // A package that the library cannot unpack is not inspected either.
    const bool unpacked = !failure || failure->code() != kReadFailure;
    Findings findings = unpacked ? inspect(options.book, attempt.imported) : Findings();
    findings.lost = attempt.lost;
    findings.textLimit = options.settings.maxText.value_or(kDefaultLongestText);
    std::vector<Trait> traits = underRules(
        traitsOf(findings, askForStyles(library, options.book, findings.formats, options.standard)),
        options.standard);
    const bool explained =
        std::any_of(traits.begin(), traits.end(), [](const Trait& trait) { return trait.fatal; });
    if (failure && !explained) traits.push_back(unreadableTrait(findings, failure->code()));
    return traits;
}

Json explanationJson(const std::string& book, const std::vector<Trait>& traits) {
    Json list = Json::array();
    for (const Trait& trait : traits) list.push_back(traitJson(trait));
    return {{"file", validUtf8(book)}, {"traits", list}};
}

void explain(const Library& library, const Options& options, Output& output) {
    const std::vector<Trait> traits = findTraits(library, options);
    if (options.view == View::Json) {
        return output.write(explanationJson(options.book, traits).dump() + "\n");
    }
    for (const Trait& trait : traits) output.write(line(trait));
    if (traits.empty()) output.write(printable(options.book) + ": " + kNothing + "\n");
}

std::string importNote(const Options& options, const std::string& folder,
                       const std::set<std::string>& leftOut) {
    const std::string& book = options.book;
    std::string text;
    const Findings findings = quickFindings(book, folder, leftOut);
    for (const Trait& trait : underRules(quickTraitsOf(findings), options.standard)) {
        if (trait.note.empty()) continue;
        text += (text.empty() ? "" : "; ") + trait.note;
    }
    return text.empty() ? text : book + ": " + text + "; see dpxlsx --explain";
}

Failure explained(const Failure& failure, const Options& options) {
    const std::string& book = options.book;
    const int code = failure.code();
    if (code != kMalformedWorkbook && code != kNoPackage && code != kNoWorkbook) return failure;
    const Findings findings = quickFindings(book, "", {});
    for (const Trait& trait : underRules(traitsOf(findings, {}), options.standard)) {
        if (!trait.fatal) continue;
        return {failure.code(),
                book + ": " + trait.found + "; " + trait.advice + "; see dpxlsx --explain"};
    }
    if (code == kMalformedWorkbook) {
        return {failure.code(),
                std::string(failure.what()) + "; dpxlsx --explain may name the part"};
    }
    return failure;
}

}  // namespace dp::tool
