#include "tools/options.h"

#include <functional>

#include <CLI/CLI.hpp>

#include "tools/exit_code.h"
#include "tools/help.h"
#include "tools/option_values.h"

namespace dp::tool {

namespace {

constexpr unsigned kLastRow = 1048576;
constexpr unsigned kMostCharacters = 65535;
constexpr unsigned kMostBytes = 2147483647;

// Registers options, group by group.
class OptionList {
  public:
    using Take = std::function<void(const std::string& option, const std::string& value)>;

    explicit OptionList(CLI::App& app) : app_(app) {}

    void group(const char* name) { app_.option_defaults()->group(name); }

    void flag(const char* name, bool& target, const char* help) {
        app_.add_flag(name, target, help);
    }

    CLI::Option* once(const std::string& name, const char* value, const char* help,
                      const Take& take) {
        const auto call = [name, take](const std::string& text) { take(name, text); };
        return app_.add_option_function<std::string>(name, call, help)->option_text(value);
    }

    // An option that may be given several times, with one value each time.
    void repeated(const std::string& name, const char* value, const char* help, const Take& take) {
        const auto call = [name, take](const std::vector<std::string>& texts) {
            for (const std::string& text : texts) take(name, text);
        };
        app_.add_option_function<std::vector<std::string>>(name, call, help)
            ->option_text(value)
            ->allow_extra_args(false);
    }

    void number(const char* name, const char* value, const char* help, unsigned most,
                const std::function<void(unsigned)>& take) {
        once(name, value, help, [most, take](const std::string& option, const std::string& text) {
            take(wholeValue(option, text, 1, most));
        });
    }

    void text(const char* name, const char* value, const char* help,
              std::optional<std::string>& target) {
        once(name, value, help,
             [&target](const std::string&, const std::string& given) { target = given; });
    }

  private:
    CLI::App& app_;
};

void addTarget(OptionList& list, Options& options, const char* name, const char* value,
               const char* help, View view) {
    const auto take = [&options, view](const std::string& option, const std::string& target) {
        if (options.view != View::Tables) {
            throw Failure(kUsage, option + ": choose one of --list, --csv and --json");
        }
        options.view = view;
        options.target = target.empty() ? "-" : target;
    };
    list.once(name, value, help, take)->expected(0, 1);
}

void addOutput(OptionList& list, Options& options, bool& names) {
    list.group("What to show (without any: each worksheet's columns and first rows)");
    list.flag("--list", names, "only the names of the worksheets, without reading cells");
    list.repeated("--sheet", "NAME|KEY", "only this worksheet (may be given several times)",
                  [&options](const std::string&, const std::string& name) {
                      options.sheets.push_back(name);
                  });
    addTarget(list, options, "--csv", "[FILE|DIR|-]", "values as CSV; one file each into a folder",
              View::Csv);
    addTarget(list, options, "--json", "[FILE|-]", "everything that a host can read, as JSON",
              View::Json);
    list.once("--head", "N", "the first N rows only (tables: 10 unless given)",
              [&options](const std::string& option, const std::string& value) {
                  options.head = wholeValue(option, value, 0, kLastRow);
              });
    list.flag("--as-shown", options.asShown, "CSV with values as displayed, not in full precision");
}

void addRows(OptionList& list, ReadSettings& settings) {
    list.group("Rows");
    list.once("--names", "given|none|infer", "where variable names are: a row (default), nowhere",
              [&settings](const std::string& option, const std::string& value) {
                  settings.names = namesValue(option, value);
              });
    list.number("--name-row", "ROW", "row of the variable names (1)", kLastRow,
                [&settings](unsigned row) { settings.nameRow = row; });
    list.number("--first-row", "ROW", "first row of data (the one after the names)", kLastRow,
                [&settings](unsigned row) { settings.firstRow = row; });
    list.number("--rows", "N", "number of data rows to read", kLastRow,
                [&settings](unsigned count) { settings.rows = count; });
    list.flag("--skip-blank-rows", settings.skipBlankRows, "leave out rows without any cell");
    list.flag("--pad", settings.pad, "fill short columns with missing values");
    list.flag("--preview", settings.preview, "read the first 101 rows of each column only");
}

void addSheets(OptionList& list, ReadSettings& settings) {
    list.group("Worksheets and columns (COLUMN: C, 3 or SHEET!C)");
    list.repeated("--exclude-sheet", "NAME|KEY", "leave a worksheet out",
                  [&settings](const std::string&, const std::string& name) {
                      settings.excludedSheets.push_back(name);
                  });
    list.repeated("--exclude", "COLUMN", "leave a column out",
                  [&settings](const std::string& option, const std::string& value) {
                      settings.excluded.push_back(columnValue(option, value));
                  });
    list.repeated("--type", "COLUMN=TYPE", "read as numeric, text or datetime",
                  [&settings](const std::string& option, const std::string& value) {
                      ColumnAssignment type = assignmentValue(option, value);
                      settings.types.emplace_back(type.column, typeValue(option, type.value));
                  });
    list.repeated("--rename", "COLUMN=NAME", "name of the variable",
                  [&settings](const std::string& option, const std::string& value) {
                      settings.renamed.push_back(assignmentValue(option, value));
                  });
    list.repeated("--position", "COLUMN=N", "place of the column at the host",
                  [&settings](const std::string& option, const std::string& value) {
                      ColumnAssignment place = assignmentValue(option, value);
                      settings.positions.emplace_back(
                          place.column, wholeValue(option, place.value, 1, kMostBytes));
                  });
    list.number("--max-name", "N", "longest variable name, in characters", kMostCharacters,
                [&settings](unsigned length) { settings.maxName = length; });
    list.flag("--clean-sheet-names", settings.cleanSheetNames,
              "replace ? * / : < > | \" \\ in names of worksheets");
}

void addMissing(OptionList& list, ReadSettings& settings) {
    list.group("Missing values (a number or the word missing where it says NUMBER)");
    list.once("--missing", "VALUE", "number that marks a missing value (1.23456e30)",
              [&settings](const std::string& option, const std::string& value) {
                  settings.missing = numberValue(option, value);
              });
    list.once("--missing-number", "NUMBER=NUMBER", "numbers equal to the first become the second",
              [&settings](const std::string& option, const std::string& value) {
                  const auto [from, to] = splitValue(option, value, '=');
                  settings.missingNumber.emplace(numberOrMissingValue(option, from),
                                                 numberOrMissingValue(option, to));
              });
    list.once("--missing-word", "TEXT=NUMBER", "texts in numeric columns that become a number",
              [&settings](const std::string& option, const std::string& value) {
                  const auto [from, to] = splitValue(option, value, '=');
                  settings.missingWord.emplace(from, numberOrMissingValue(option, to));
              });
    list.once("--missing-text", "TEXT=TEXT", "texts equal to the first become the second",
              [&settings](const std::string& option, const std::string& value) {
                  settings.missingText = splitValue(option, value, '=');
              });
    list.text("--missing-display", "TEXT", "how a missing number is shown (*)",
              settings.missingDisplay);
}

void addValues(OptionList& list, ReadSettings& settings) {
    list.group("Values");
    list.once("--decimal", "SYMBOL", "decimal symbol of numbers in texts and on display (.)",
              [&settings](const std::string& option, const std::string& value) {
                  settings.decimal = symbolValue(option, value);
              });
    list.once("--range", "MIN:MAX", "numbers outside become missing (-1.001e18:1.001e18)",
              [&settings](const std::string& option, const std::string& value) {
                  const auto [least, most] = splitValue(option, value, ':');
                  settings.range.emplace(numberValue(option, least), numberValue(option, most));
              });
    list.number("--max-text", "N", "longest text, in bytes (80)", kMostBytes,
                [&settings](unsigned length) { settings.maxText = static_cast<int>(length); });
    list.flag("--clean-text", settings.cleanText, "trim texts, drop control characters");
    list.flag("--dates-as-text", settings.datesAsText, "read date-times as their texts");
    list.text("--true", "TEXT", "text of a Boolean that holds (TRUE)", settings.trueText);
    list.text("--false", "TEXT", "text of a Boolean that does not (FALSE)", settings.falseText);
}

bool namesWorkbook(const std::string& text) {
    const std::string extension = ".xlsx";
    if (text.size() <= extension.size()) return false;
    std::string end = text.substr(text.size() - extension.size());
    return CLI::detail::to_lower(end) == extension;
}

// "--csv BOOK.xlsx" means the workbook, not a CSV file of that name.
void takeBookFromTarget(Options& options) {
    if (!options.book.empty() || !namesWorkbook(options.target)) return;
    options.book = options.target;
    options.target = "-";
}

void require(bool holds, const char* text) {
    if (!holds) throw Failure(kUsage, std::string(text) + "; see dpxlsx --help");
}

void check(const Options& options) {
    const ReadSettings& settings = options.settings;
    const bool given = settings.names.value_or(VNR_GIVEN) == VNR_GIVEN;
    require(!options.book.empty(), "no workbook is given: dpxlsx BOOK.xlsx");
    require(settings.nameRow == 0 || given, "--name-row needs --names given");
    require(!settings.missingNumber || !settings.missingWord,
            "--missing-number and --missing-word share one replacement: give one of them");
    require(!settings.missingWord || !settings.missingWord->first.empty(),
            "--missing-word needs a text before the \"=\"");
    require(!settings.range || settings.range->first <= settings.range->second,
            "--range: the first number must not be above the second");
    require(!options.asShown || options.view == View::Csv, "--as-shown needs --csv");
}

std::string firstLine(const std::string& text) { return text.substr(0, text.find('\n')); }

}  // namespace

Request parseOptions(int count, const char* const* arguments) {
    Request request;
    Options& options = request.options;
    bool names = false;
    CLI::App app("Imports an Excel workbook (.xlsx) through the import library, as a host does.",
                 "dpxlsx");
    app.option_defaults()->group("Program");
    app.set_help_flag("-h,--help", "this text");
    app.set_version_flag("--version", std::string("dpxlsx ") + DPXLSX_VERSION, "the version");
    OptionList list(app);
    list.once("--library", "FILE", "the import library to load",
              [&options](const std::string&, const std::string& file) { options.library = file; });
    addOutput(list, options, names);
    addRows(list, options.settings);
    addSheets(list, options.settings);
    addMissing(list, options.settings);
    addValues(list, options.settings);
    app.add_option("BOOK", options.book);
    try {
        app.parse(count, arguments);
    } catch (const CLI::CallForHelp&) {
        request.answer = helpText(app);
        return request;
    } catch (const CLI::CallForVersion& version) {
        request.answer = firstLine(version.what()) + "\n";
        return request;
    } catch (const CLI::ParseError& error) {
        throw Failure(kUsage, firstLine(error.what()) + "; see dpxlsx --help");
    }
    require(!names || options.view == View::Tables, "choose one of --list, --csv and --json");
    if (names) options.view = View::Names;
    takeBookFromTarget(options);
    check(options);
    return request;
}

}  // namespace dp::tool
