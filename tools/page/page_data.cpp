#include "tools/page/page_data.h"

#include <algorithm>
#include <iterator>
#include <optional>
#include <utility>

#include <nlohmann/json.hpp>

#include "tools/explain/explain.h"
#include "tools/host/calendar.h"
#include "tools/host/interrupt.h"
#include "tools/options/column_reference.h"
#include "tools/page/column_summary.h"
#include "tools/page/page_limits.h"
#include "tools/views/json_view.h"
#include "tools/views/text.h"

namespace dp::tool {

namespace {

using Json = nlohmann::ordered_json;

// Cuts the long texts of a list; returns [row, characters of the whole text] for each.
Json cutTexts(Json& values, size_t bytes) {
    Json cut = Json::array();
    for (size_t row = 0; row < values.size(); ++row) {
        if (!values[row].is_string()) continue;
        const std::string text = values[row];
        if (text.size() <= bytes) continue;
        values[row] = std::string(beginning(text, bytes));
        cut.push_back({row, characterCount(text)});
    }
    return cut;
}

// A text, cut if it is long, with the characters that it has then.
Json excerpt(const std::string& text, size_t bytes) {
    const std::string valid = validUtf8(text);
    Json json = {{"text", beginning(valid, bytes)}};
    if (valid.size() > bytes) json["characters"] = characterCount(valid);
    return json;
}

Json frequentJson(const TextCounts& counts, const PageLimits& limits) {
    Json list = Json::array();
    for (const TextCounts::Entry& entry : counts.mostFrequent(limits.frequent)) {
        Json json = excerpt(entry.text, limits.bytes);
        json["count"] = entry.count;
        json["row"] = entry.row;
        list.push_back(std::move(json));
    }
    return {{"different", counts.different()}, {"frequent", std::move(list)}};
}

Json distributionJson(const Distribution& numbers) {
    if (numbers.bins.empty()) return nullptr;
    return {{"least", numbers.least},
            {"median", numbers.median},
            {"greatest", numbers.greatest},
            {"eachNumber", numbers.eachNumber},
            {"bins", numbers.bins}};
}

Json stripJson(const RowStrip& strip) { return strip.empty() ? Json() : Json(strip.counts()); }

Json isoJson(const Distribution& days, const std::string& pattern) {
    Json list = Json::array();
    for (const double day : {days.least, days.median, days.greatest}) {
        list.push_back(isValidSerial(day) ? Json(isoText(day, pattern, ' ')) : Json());
    }
    return list;
}

Json convertedJson(const ColumnSummary& summary, const PageLimits& limits) {
    Json json = frequentJson(summary.contents, limits);
    json["strip"] = stripJson(summary.converted);
    json["firstRows"] = Json::array();
    for (const ConvertedCell& cell : summary.firstConverted) {
        Json shown = excerpt(cell.content, limits.bytes);
        shown["row"] = cell.row;
        json["firstRows"].push_back(std::move(shown));
    }
    return json;
}

Json summaryJson(const Column& column, const ColumnSummary& summary, const PageLimits& limits) {
    Json json;
    const bool texts = column.kind() == Kind::Text;
    json[texts ? "lengths" : "distribution"] = distributionJson(summary.numbers);
    if (texts) json["texts"] = frequentJson(summary.texts, limits);
    if (column.kind() == Kind::DateTime && !summary.numbers.bins.empty()) {
        json["iso"] = isoJson(summary.numbers, column.pattern());
    }
    json["missing"] = stripJson(summary.missing);
    if (!summary.converted.empty()) json["converted"] = convertedJson(summary, limits);
    return json;
}

// Makes the data worksheet by worksheet; no more than one is loaded at a time.
class PageData {
  public:
    PageData(Workbook& workbook, const Options& options) : workbook_(workbook) {
        const std::vector<SheetEntry> sheets = workbook.worksheets();
        size_t columns = 0;
        for (const SheetEntry& sheet : sheets) columns += workbook.columnCount(sheet);
        limits_ = pageLimits(columns, options.head);
        for (const SheetEntry& sheet : sheets) add(workbook.load(sheet));
    }

    Json worksheets = Json::array();
    Json summaries = Json::array();

  private:
    void add(const LoadedWorksheet& worksheet) {
        Json columns = Json::array();
        Json ofColumns = Json::array();
        std::vector<bool> filled(worksheet.layout.rows);
        for (size_t i = 0; i < worksheet.columns.size(); ++i) {
            stopIfInterrupted();
            const Column& column = worksheet.columns[i];
            Json json = columnJson(column, limits_.rows);
            Json summary = summaryOfColumn(column, worksheet.layout.rows);
            summary["reference"] =
                validUtf8(columnReference(worksheet.title, worksheet.key, worksheet.numbers[i]));
            summary["letters"] = columnLetters(worksheet.numbers[i]);
            summary["cut"] = cutTexts(json["values"], limits_.bytes);
            columns.push_back(std::move(json));
            ofColumns.push_back(std::move(summary));
            for (size_t row = 0; row < column.rows(); ++row) {
                if (!column.isMissing(row)) filled[row] = true;
            }
        }
        Json json = worksheetJson(worksheet);
        json["columns"] = std::move(columns);
        worksheets.push_back(std::move(json));
        const auto empty = std::count(filled.begin(), filled.end(), false);
        summaries.push_back({{"emptyRows", empty}, {"columns", std::move(ofColumns)}});
    }

    Json summaryOfColumn(const Column& column, size_t rows) {
        std::optional<Column> texts;
        if (column.convertedMissing() > 0) texts = workbook_.asTexts(column);
        return summaryJson(column, summaryOf(column, texts, rows, limits_), limits_);
    }

    Workbook& workbook_;
    PageLimits limits_ = {};
};

}  // namespace

std::string pageData(Workbook& workbook, const Options& options, const std::vector<Trait>& traits) {
    PageData data(workbook, options);
    Json import = bookJson(workbook, options);
    import["worksheets"] = std::move(data.worksheets);
    const Json json = {{"version", DPXLSX_VERSION},
                       {"import", std::move(import)},
                       {"summaries", std::move(data.summaries)},
                       {"explanation", explanationJson(options.book, traits)},
                       {"blankRowsLeftOut", options.settings.skipBlankRows}};
    return json.dump();
}

std::string embeddable(std::string_view json) {
    constexpr std::pair<std::string_view, const char*> kEscapes[] = {
        {"<", "\\u003c"},    {">", "\\u003e"},      {"&", "\\u0026"},
        {"\x7F", "\\u007f"}, {"\u2028", "\\u2028"}, {"\u2029", "\\u2029"},
    };
    constexpr const char* kFirstBytes = "<>&\x7F\xE2";
    std::string text;
    text.reserve(json.size());
    for (size_t plain = 0; (plain = json.find_first_of(kFirstBytes)) != std::string_view::npos;) {
        text += json.substr(0, plain);
        json.remove_prefix(plain);
        const auto escape =
            std::find_if(std::begin(kEscapes), std::end(kEscapes),
                         [&](const auto& entry) { return json.starts_with(entry.first); });
        const bool found = escape != std::end(kEscapes);
        text += found ? std::string_view(escape->second) : json.substr(0, 1);
        json.remove_prefix(found ? escape->first.size() : 1);
    }
    text += json;
    return text;
}

}  // namespace dp::tool
