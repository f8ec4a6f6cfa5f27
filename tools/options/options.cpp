#include "tools/options/options.h"

#include <algorithm>

#include <CLI/CLI.hpp>

#include "tools/options/help.h"
#include "tools/options/option_table.h"
#include "tools/options/option_values.h"
#include "tools/options/similar_option.h"

namespace dp::tool {

namespace {

void require(bool holds, const char* text) {
    if (!holds) wrongUsage(text);
}

// Has the parser hand the values of an option to its row of the table.
void add(CLI::App& app, const OptionRow& row, Request& request) {
    Options& options = request.options;
    const std::string names = row.names;
    const auto take = [&row, &options](const std::string& value) {
        row.action.take(options, {row.names, value});
    };
    switch (row.action.takes) {
        case Takes::Nothing:
            app.add_flag_callback(names, [take] { take(""); })
                ->multi_option_policy(CLI::MultiOptionPolicy::TakeLast)
                ->disable_flag_override();
            break;
        case Takes::Value:
            app.add_option_function<std::string>(names, take);
            break;
        case Takes::ValueOrNothing:
            app.add_option_function<std::string>(names, take)->expected(0, 1);
            break;
        case Takes::ValueEachTime:
            app.add_option_function<std::vector<std::string>>(
                   names, [take](const auto& values) { std::ranges::for_each(values, take); })
                ->allow_extra_args(false);
            break;
        case Takes::Help:
            app.set_help_flag(names);
            break;
        case Takes::Version:
            app.add_flag(names, request.version);
            break;
    }
}

// "--csv BOOK.xlsx" means the workbook, not a CSV file of that name.
void takeBookFromTarget(Request& request) {
    if (!namesWorkbook(request.options.target)) return;
    request.books.insert(request.books.begin(), request.options.target);
    request.options.target = "-";
}

void check(const Request& request) {
    const Options& options = request.options;
    const ReadSettings& settings = options.settings;
    const bool given = settings.names.value_or(VNR_GIVEN) == VNR_GIVEN;
    require(!request.books.empty(), "no workbook is given: dpxlsx BOOK.xlsx");
    require(settings.nameRow == 0 || given, "--name-row needs --names given");
    require(!settings.missingNumber || !settings.missingWord,
            "--missing-number and --missing-word share one replacement: give one of them");
    require(!settings.missingWord || !settings.missingWord->first.empty(),
            "--missing-word needs a text before the \"=\"");
    require(!settings.range || settings.range->first <= settings.range->second,
            "--range: the first number must not be above the second");
    require(!options.asShown || options.view == View::Csv, "--as-shown needs --csv");
    require(!options.explain || options.view == View::Tables || options.view == View::Json,
            kOneView);
    require(options.view != View::Page || request.books.size() == 1,
            "--page shows one workbook: give one, and call dpxlsx for each");
    require(options.view != View::Names || options.sheets.empty(),
            "--list names all worksheets: leave out either --list or --sheet");
    require(!options.explain || options.sheets.empty(),
            "--explain looks at the whole book: leave out either --explain or --sheet");
}

std::string unknownText(const std::string& words) {
    const std::string meant = similarOption(words.substr(0, words.find(' ')));
    return words + ": there is no such option" + (meant.empty() ? meant : "; perhaps " + meant);
}

std::string firstLine(const std::string& text) { return text.substr(0, text.find('\n')); }

// Rewords a message of the parser. It begins with the option, and says "received" when there are
// too many values.
std::string mismatchText(const std::string& words) {
    const bool flag = words.find("override") != std::string::npos;
    if (flag) return "--" + words.substr(0, words.find(' ')) + ": it takes no value";
    const bool tooMany = words.find("received") != std::string::npos;
    return words.substr(0, words.find(':')) +
           (tooMany ? ": give it once, with one value" : ": its value is missing");
}

}  // namespace

bool namesWorkbook(const std::string& text) {
    const std::string extension = ".xlsx";
    if (text.size() <= extension.size()) return false;
    std::string end = text.substr(text.size() - extension.size());
    return CLI::detail::to_lower(end) == extension;
}

Request parseOptions(int count, const char* const* arguments) {
    Request request;
    CLI::App app;
    for (const OptionGroup& group : optionGroups()) {
        for (const OptionRow& row : group.rows) add(app, row, request);
    }
    app.add_option("BOOK", request.books);
    const CLI::Option* table = app.add_flag("--option-table");  // for scripts/make-option-pages
    try {
        app.parse(count, arguments);
    } catch (const CLI::CallForHelp&) {
        request.answer = helpText();
        return request;
    } catch (const CLI::ArgumentMismatch& error) {
        wrongUsage(mismatchText(error.what()));
    } catch (const CLI::ExtrasError& error) {
        const std::string words = firstLine(error.what());
        wrongUsage(unknownText(words.substr(words.rfind(": ") + 2)));
    } catch (const CLI::ParseError& error) {
        wrongUsage(firstLine(error.what()));
    }
    if (*table) {
        request.answer = optionTableText();
        return request;
    }
    if (request.version) return request;
    takeBookFromTarget(request);
    check(request);
    return request;
}

}  // namespace dp::tool
