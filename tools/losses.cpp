#include "tools/losses.h"

#include <algorithm>

#include "model/host/i_finders.h"
#include "tools/column_reference.h"
#include "tools/settings.h"
#include "tools/text.h"

namespace dp::tool {

namespace {

// Rows that are missing although the column of texts has content there other than the mark.
size_t lostRows(const Column& column, const Column& texts, const std::string& mark) {
    size_t count = 0;
    for (size_t row = 0; row < column.rows(); ++row) {
        if (column.isMissing(row) && !texts.isMissing(row) && texts.text(row) != mark) ++count;
    }
    return count;
}

// With a text that marks missing numbers: the library counts its cells, whatever they become.
size_t lostBesideWord(IDataProvider& provider, const Column& column, const Options& options) {
    IColumn* found = nullptr;
    auto type = IVariableFormat::FormatType::Numeric;
    provider.GetVariableFinder()->FindColumn(column.host().GetPrimeKey(), &found,
                                             IVariable::StorageType::Text, &type, true);
    if (found == nullptr) return 0;
    const Column texts(found, kDefaultMissing, options.settings.preview);
    // An option of the column may force its kind: then the library's count has to do.
    return texts.kind() == Kind::Text ? lostRows(column, texts, options.settings.missingWord->first)
                                      : static_cast<size_t>(column.convertedMissing());
}

// With numbers that the user wants to be missing: the library counts their cells too.
size_t lostBesideNumbers(IDataProvider& provider, const Column& column, const Options& options) {
    const ReadSettings& settings = options.settings;
    if (settings.missingNumber && !settings.missingNumber->first) return 0;  // none is missing then
    ReadSettings plain;
    plain.missing = settings.missing;
    if (settings.missingNumber) plain.missingNumber.emplace(std::nullopt, std::nullopt);
    if (settings.range) plain.range.emplace(-kDefaultRange, kDefaultRange);
    applyNumbers(provider, plain);
    IColumn* found = nullptr;
    provider.GetVariableFinder()->FindColumn(column.host().GetPrimeKey(), &found, true);
    applyNumbers(provider, settings);
    if (found == nullptr) return 0;
    const Column unmarked(found, kDefaultMissing, settings.preview);
    return static_cast<size_t>(unmarked.convertedMissing());
}

}  // namespace

void Losses::note(IDataProvider& provider, const std::string& worksheet, const Column& column) {
    const ReadSettings& settings = options_.settings;
    auto count = static_cast<size_t>(column.convertedMissing());
    if (count > 0 && settings.missingWord) {
        count = lostBesideWord(provider, column, options_);
    } else if (count > 0 && (settings.missingNumber || settings.range)) {
        count = lostBesideNumbers(provider, column, options_);
    }
    if (count == 0) return;
    const std::string letters = columnLetters(numberOf(worksheet, column));
    losses_.push_back({worksheet + "!" + letters, column.name(), count});
}

std::string Losses::text() const {
    constexpr size_t kMost = 3;
    size_t total = 0;
    size_t listed = 0;
    std::string places;
    std::string options;
    for (size_t i = 0; i < losses_.size(); ++i) {
        const Loss& loss = losses_[i];
        total += loss.cells;
        if (i >= kMost) continue;
        listed += loss.cells;
        places += (i == 0 ? "" : ", ") + std::to_string(loss.cells) + " in " + loss.place;
        if (!loss.name.empty()) places += " (" + loss.name + ")";
        options += " --type " + shellWord(loss.place + "=text");
    }
    if (losses_.empty()) return {};
    if (losses_.size() > kMost) {
        const size_t more = losses_.size() - kMost;
        places += " and " + std::to_string(total - listed) + " in " + std::to_string(more) +
                  (more == 1 ? " more column" : " more columns");
    }
    return options_.book + ": " + std::to_string(total) + (total == 1 ? " cell" : " cells") +
           " became missing on conversion: " + places + "; to keep them: " + options.substr(1);
}

// The column's place in the worksheet: the host's, unless an option gave it another one.
unsigned Losses::numberOf(const std::string& worksheet, const Column& column) const {
    const auto position = static_cast<unsigned>(column.host().GetPosition());
    for (const auto& [where, given] : options_.settings.positions) {
        const bool here = where.worksheet.empty() || where.worksheet == worksheet;
        if (here && given == position) return where.column;
    }
    return position;
}

}  // namespace dp::tool
