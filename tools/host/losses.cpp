#include "tools/host/losses.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <optional>
#include <system_error>

#include <dpxlsx/model/host/i_finders.h>

#include "tools/options/settings.h"
#include "tools/views/text.h"

namespace dp::tool {

namespace {

constexpr size_t kColumnsInNotes = 3;  // --explain names all

// The number of rows that are missing although the same column loaded as texts has content there
// other than the mark.
size_t lostRows(const Column& column, const Column& texts, const std::string& mark) {
    size_t count = 0;
    for (size_t row = 0; row < column.rows(); ++row) {
        if (column.isMissing(row) && !texts.isMissing(row) && texts.text(row) != mark) ++count;
    }
    return count;
}

// Lost cells when a text marks missing numbers: the library's count includes the cells with that
// text.
size_t lostBesideWord(IDataProvider& provider, const Column& column, const Options& options) {
    const std::optional<Column> texts = loadedAsTexts(provider, column, options.settings.preview);
    // When an option forces the kind of the column, only the library's count is available.
    return texts ? lostRows(column, *texts, options.settings.missingWord->first)
                 : static_cast<size_t>(column.convertedMissing());
}

// Lost cells when a number marks missing ones: the library's count includes the cells with that
// number.
size_t lostBesideNumbers(IDataProvider& provider, const Column& column, const Options& options) {
    const ReadSettings& settings = options.settings;
    if (settings.missingNumber && !settings.missingNumber->first)
        return 0;  // no number is declared missing then
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

// How many of the lost cells have no text either: by the standard, content that is not what the
// cell's type says is missing in every kind of column.
size_t countWithoutTexts(IDataProvider& provider, const Column& column, const Options& options,
                         size_t lost) {
    if (lost == 0 || column.kind() == Kind::Text) return 0;
    const std::optional<Column> texts = loadedAsTexts(provider, column, options.settings.preview);
    return texts ? lost - std::min(lost, lostRows(column, *texts, {})) : 0;
}

// The number that a displayed text shows; none for dates and other texts.
std::optional<double> readBack(std::string text, char decimal) {
    std::replace(text.begin(), text.end(), decimal, '.');
    const bool negative = text.size() > 2 && text.front() == '(' && text.back() == ')';
    if (negative) text = "-" + text.substr(1, text.size() - 2);
    const bool percent = !text.empty() && text.back() == '%';
    if (percent) text.pop_back();
    const size_t sign = !text.empty() && text.front() == '+' ? 1 : 0;
    double number = 0;
    const char* const end = text.data() + text.size();
    const auto [stop, error] = std::from_chars(text.data() + sign, end, number);
    if (error != std::errc() || stop != end) return std::nullopt;
    return percent ? number / 100 : number;
}

bool isSame(double shown, double number) {
    constexpr double kDigits = 1e-9;
    return std::abs(shown - number) <= kDigits * std::abs(number);
}

// The column loaded again with another limit of text length.
std::optional<Column> uncut(IDataProvider& provider, const Column& column, const Options& options,
                            int limit) {
    provider.SetMaximumTextLength(kNoLimit);
    IColumn* found = nullptr;
    provider.GetVariableFinder()->FindColumn(column.host().GetPrimeKey(), &found, true);
    provider.SetMaximumTextLength(limit);
    if (found == nullptr) return std::nullopt;
    return Column(found, kDefaultMissing, options.settings.preview);
}

// The library trims a name after cutting it, so a cut name can be one byte shorter than the limit.
bool mayBeCut(const Column& column, size_t limit) {
    return column.longestText() >= limit || column.name().size() + 1 >= limit;
}

}  // namespace

void Losses::note(IDataProvider& provider, const std::string& place, const Column& column) {
    noteCells(provider, place, column);
    noteTexts(provider, place, column);
}

void Losses::noteCells(IDataProvider& provider, const std::string& place, const Column& column) {
    const ReadSettings& settings = options_.settings;
    auto count = static_cast<size_t>(column.convertedMissing());
    if (count > 0 && settings.missingWord) {
        count = lostBesideWord(provider, column, options_);
    } else if (count > 0 && (settings.missingNumber || settings.range)) {
        count = lostBesideNumbers(provider, column, options_);
    }
    const size_t unreadable =
        options_.standard ? countWithoutTexts(provider, column, options_, count) : 0;
    if (unreadable > 0) lost_.unreadable.add({place, column.name(), unreadable});
    if (count > unreadable) lost_.cells.add({place, column.name(), count - unreadable});
}

void Losses::noteTexts(IDataProvider& provider, const std::string& place, const Column& column) {
    const int limit = options_.settings.maxText.value_or(kDefaultLongestText);
    if (limit < 0 || !mayBeCut(column, static_cast<size_t>(limit))) return;
    const std::optional<Column> whole = uncut(provider, column, options_, limit);
    if (!whole) return;
    size_t count = 0;
    const auto noteLength = [&](size_t length) {
        if (length <= static_cast<size_t>(limit)) return;
        ++count;
        lost_.longest = std::max(lost_.longest, length);
    };
    noteLength(whole->name().size());
    const size_t rows = whole->kind() == Kind::Text ? whole->rows() : 0;
    for (size_t row = 0; row < rows; ++row) noteLength(whole->text(row).size());
    if (count > 0) lost_.cutTexts.add({place, column.name(), count});
}

void Losses::noteShown(IDataProvider& provider, const std::string& place, const Column& column) {
    if (column.kind() != Kind::Text) return;
    IColumn* found = nullptr;
    auto type = IVariableFormat::FormatType::Text;
    provider.GetVariableFinder()->FindColumn(column.host().GetPrimeKey(), &found,
                                             IVariable::StorageType::Numeric, &type, true);
    if (found == nullptr) return;
    const Column numbers(found, kDefaultMissing, options_.settings.preview);
    if (numbers.kind() == Kind::Text) return;  // an option makes it a column of texts
    const char decimal = options_.settings.decimal.value_or('.');
    const double missing = options_.settings.missing.value_or(kDefaultMissing);
    size_t count = 0;
    for (size_t row = 0; row < std::min(column.rows(), numbers.rows()); ++row) {
        if (column.isMissing(row) || numbers.isMissing(row) || numbers.number(row) == missing) {
            continue;
        }
        const auto shown = readBack(trimmed(column.text(row)), decimal);
        if (!shown || !isSame(*shown, numbers.number(row))) ++count;
    }
    if (count > 0) lost_.shown.add({place, column.name(), count});
}

std::string Losses::cellsNote() const {
    const Tally& cells = lost_.cells;
    if (cells.empty()) return {};
    const bool all = cells.columns() <= kColumnsInNotes;
    return options_.book + ": " + counted(cells.total(), "cell") +
           " became missing on conversion: " + cells.text(kColumnsInNotes) +
           "; to keep the content as displayed: " + cells.textTypes(kColumnsInNotes) +
           (all ? "" : "; --explain names all columns");
}

std::string Losses::unreadableNote() const {
    const Tally& cells = lost_.unreadable;
    if (cells.empty()) return {};
    const bool one = cells.total() == 1;
    return options_.book + ": " + counted(cells.total(), "cell") + (one ? " is" : " are") +
           " missing because the content is not what the cell's type says: " +
           cells.text(kColumnsInNotes) + "; to keep it, correct " + (one ? "it" : "them") +
           " in the workbook";
}

std::string Losses::textsNote() const {
    const Tally& texts = lost_.cutTexts;
    if (texts.empty()) return {};
    const int limit = options_.settings.maxText.value_or(kDefaultLongestText);
    return options_.book + ": " + counted(texts.total(), "text") +
           (texts.total() == 1 ? " was" : " were") + " cut at " + std::to_string(limit) +
           " bytes: " + texts.text(kColumnsInNotes) + "; to keep all of it: --max-text " +
           std::to_string(lost_.longest);
}

}  // namespace dp::tool
