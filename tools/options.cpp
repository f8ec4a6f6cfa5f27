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

constexpr const char* kOneView =
    "choose one of --list, --csv, --json and --explain, or --explain with --json";

void require(bool holds, const char* text) {
    if (!holds) throw Failure(kUsage, std::string(text) + "; see dpxlsx --help");
}

// Registers options. What they mean, for users, is in the help.
class OptionList {
  public:
    using Take = std::function<void(const std::string& option, const std::string& value)>;

    explicit OptionList(CLI::App& app) : app_(app) {}

    void flag(const char* name, bool& target) {
        app_.add_flag(name, target)->disable_flag_override();
    }

    CLI::Option* once(const std::string& name, const Take& take) {
        const auto call = [name, take](const std::string& text) { take(name, text); };
        return app_.add_option_function<std::string>(name, call);
    }

    // An option that may be given several times, with one value each time.
    void repeated(const std::string& name, const Take& take) {
        const auto call = [name, take](const std::vector<std::string>& texts) {
            for (const std::string& text : texts) take(name, text);
        };
        app_.add_option_function<std::vector<std::string>>(name, call)->allow_extra_args(false);
    }

    void number(const char* name, unsigned most, const std::function<void(unsigned)>& take) {
        once(name, [most, take](const std::string& option, const std::string& text) {
            take(wholeValue(option, text, 1, most));
        });
    }

    void text(const char* name, std::optional<std::string>& target) {
        once(name, [&target](const std::string&, const std::string& given) { target = given; });
    }

  private:
    CLI::App& app_;
};

void addTarget(OptionList& list, Options& options, const char* name, View view) {
    const auto take = [&options, view](const std::string&, const std::string& target) {
        require(options.view == View::Tables, kOneView);
        options.view = view;
        options.target = target.empty() ? "-" : target;
    };
    list.once(name, take)->expected(0, 1);
}

void addOutput(OptionList& list, Options& options, bool& names) {
    list.flag("--list", names);
    list.flag("--explain", options.explain);
    list.repeated("--sheet", [&options](const std::string&, const std::string& name) {
        options.sheets.push_back(name);
    });
    addTarget(list, options, "--csv", View::Csv);
    addTarget(list, options, "--json", View::Json);
    list.once("--head", [&options](const std::string& option, const std::string& value) {
        options.head = wholeValue(option, value, 0, kLastRow);
    });
    list.flag("--as-shown", options.asShown);
}

void addRows(OptionList& list, ReadSettings& settings) {
    list.once("--names", [&settings](const std::string& option, const std::string& value) {
        settings.names = namesValue(option, value);
    });
    list.number("--name-row", kLastRow, [&settings](unsigned row) { settings.nameRow = row; });
    list.number("--first-row", kLastRow, [&settings](unsigned row) { settings.firstRow = row; });
    list.number("--rows", kLastRow, [&settings](unsigned count) { settings.rows = count; });
    list.flag("--skip-blank-rows", settings.skipBlankRows);
    list.flag("--pad", settings.pad);
    list.flag("--preview", settings.preview);
}

void addSheets(OptionList& list, ReadSettings& settings) {
    list.repeated("--exclude-sheet", [&settings](const std::string&, const std::string& name) {
        settings.excludedSheets.push_back(name);
    });
    list.repeated("--exclude", [&settings](const std::string& option, const std::string& value) {
        settings.excluded.push_back(columnValue(option, value));
    });
    list.repeated("--type", [&settings](const std::string& option, const std::string& value) {
        ColumnAssignment type = assignmentValue(option, value);
        settings.types.emplace_back(type.column, typeValue(option, type.value));
    });
    list.repeated("--rename", [&settings](const std::string& option, const std::string& value) {
        settings.renamed.push_back(assignmentValue(option, value));
    });
    list.repeated("--position", [&settings](const std::string& option, const std::string& value) {
        ColumnAssignment place = assignmentValue(option, value);
        settings.positions.emplace_back(place.column,
                                        wholeValue(option, place.value, 1, kMostBytes));
    });
    list.number("--max-name", kMostCharacters,
                [&settings](unsigned length) { settings.maxName = length; });
    list.flag("--clean-sheet-names", settings.cleanSheetNames);
}

void addMissing(OptionList& list, ReadSettings& settings) {
    list.once("--missing", [&settings](const std::string& option, const std::string& value) {
        settings.missing = numberValue(option, value);
    });
    list.once("--missing-number", [&settings](const std::string& option, const std::string& value) {
        const auto [from, to] = splitValue(option, value, '=');
        settings.missingNumber.emplace(numberOrMissingValue(option, from),
                                       numberOrMissingValue(option, to));
    });
    list.once("--missing-word", [&settings](const std::string& option, const std::string& value) {
        const auto [from, to] = splitValue(option, value, '=');
        settings.missingWord.emplace(from, numberOrMissingValue(option, to));
    });
    list.once("--missing-text", [&settings](const std::string& option, const std::string& value) {
        settings.missingText = splitValue(option, value, '=');
    });
    list.text("--missing-display", settings.missingDisplay);
}

void addValues(OptionList& list, ReadSettings& settings) {
    list.once("--decimal", [&settings](const std::string& option, const std::string& value) {
        settings.decimal = symbolValue(option, value);
    });
    list.once("--range", [&settings](const std::string& option, const std::string& value) {
        const auto [least, most] = splitValue(option, value, ':');
        settings.range.emplace(numberValue(option, least), numberValue(option, most));
    });
    list.once("--max-text", [&settings](const std::string& option, const std::string& value) {
        settings.maxText =
            value == "none" ? kNoLimit : static_cast<int>(wholeValue(option, value, 1, kMostBytes));
    });
    list.flag("--clean-text", settings.cleanText);
    list.flag("--dates-as-text", settings.datesAsText);
    list.text("--true", settings.trueText);
    list.text("--false", settings.falseText);
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
    require(options.view != View::Names || options.sheets.empty(),
            "--list names all worksheets: leave out either --list or --sheet");
    require(!options.explain || options.sheets.empty(),
            "--explain looks at the whole book: leave out either --explain or --sheet");
}

std::string firstLine(const std::string& text) { return text.substr(0, text.find('\n')); }

// The parser's words begin with the option, and tell of a number when there are too many values.
std::string mismatchText(const std::string& words) {
    const bool tooMany = words.find("received") != std::string::npos;
    return words.substr(0, words.find(':')) +
           (tooMany ? ": give it once, with one value" : ": its value is missing") +
           "; see dpxlsx --help";
}

}  // namespace

Request parseOptions(int count, const char* const* arguments) {
    Request request;
    Options& options = request.options;
    bool names = false;
    CLI::App app;
    app.set_help_flag("-h,--help");
    app.set_version_flag("--version", std::string("dpxlsx ") + DPXLSX_VERSION);
    OptionList list(app);
    list.once("--library",
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
        request.answer = helpText();
        return request;
    } catch (const CLI::CallForVersion& version) {
        request.answer = firstLine(version.what()) + "\n";
        return request;
    } catch (const CLI::ArgumentMismatch& error) {
        throw Failure(kUsage, mismatchText(error.what()));
    } catch (const CLI::ExtrasError& error) {
        const std::string words = firstLine(error.what());
        const std::string extra = words.substr(words.rfind(": ") + 2);
        throw Failure(kUsage, extra +
                                  ": there is no such option, and one workbook is read at a time" +
                                  "; see dpxlsx --help");
    } catch (const CLI::ParseError& error) {
        throw Failure(kUsage, firstLine(error.what()) + "; see dpxlsx --help");
    }
    require(!names || (options.view == View::Tables && !options.explain), kOneView);
    require(!options.explain || options.view != View::Csv, kOneView);
    if (names) options.view = View::Names;
    takeBookFromTarget(options);
    check(options);
    return request;
}

}  // namespace dp::tool
