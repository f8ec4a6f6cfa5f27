#pragma once

#include <optional>
#include <string>
#include <utility>
#include <vector>

#include <dpxlsx/model/host/i_data_provider.h>

#include "tools/options/column_reference.h"

namespace dp::tool {

enum class View { Tables, Names, Csv, Json, Page };

// A number as the user writes it; no value stands for the word "missing".
using NumberOrMissing = std::optional<double>;

// In place of a limit of text length.
constexpr int kNoLimit = -1;

// Settings that the host passes to the provider. Those that are not set keep the library's
// defaults.
struct ReadSettings {
    std::optional<EVariableNameRowSetting> names;
    unsigned nameRow = 0;   // 1-based, 0 for not given
    unsigned firstRow = 0;  // 1-based, 0 for not given
    std::optional<unsigned> rows;
    bool skipBlankRows = false;
    bool pad = false;
    std::vector<std::string> excludedSheets;

    std::vector<std::pair<ColumnReference, IVariable::BasicDataType>> types;
    std::vector<ColumnReference> excluded;
    std::vector<ColumnAssignment> renamed;
    std::vector<std::pair<ColumnReference, unsigned>> positions;
    std::optional<unsigned> maxName;  // characters

    std::optional<char> decimal;
    std::optional<double> missing;
    std::optional<std::pair<std::string, std::string>> missingText;
    std::optional<std::pair<NumberOrMissing, NumberOrMissing>> missingNumber;
    std::optional<std::pair<std::string, NumberOrMissing>> missingWord;
    std::optional<std::string> missingDisplay;
    std::optional<std::pair<double, double>> range;
    std::optional<std::string> trueText;
    std::optional<std::string> falseText;
    std::optional<int> maxText;  // bytes, or kNoLimit
    bool datesAsText = false;
    bool cleanText = false;
    bool cleanSheetNames = false;
    bool preview = false;
};

struct Options {
    std::string book;
    std::string turn;  // the book's place among several, such as "2 of 7: ", for the progress line
    std::string library;
    View view = View::Tables;
    std::string target = "-";         // file or folder of a CSV, JSON or page view
    std::vector<std::string> sheets;  // names or keys; empty for all
    std::optional<size_t> head;       // rows
    bool asShown = false;
    bool standard = false;  // read by the standard
    bool explain = false;   // instead of an import; the view is Tables or Json
    ReadSettings settings;
};

struct Request {
    std::vector<std::string> books;
    Options options;       // for each of them
    std::string answer;    // the help, to be printed instead of doing anything
    bool version = false;  // to be printed instead of doing anything
};

// Whether the name ends in .xlsx, in any letter case.
bool namesWorkbook(const std::string& text);

// What the command line asks for. Throws a Failure with kUsage when it is wrong.
Request parseOptions(int count, const char* const* arguments);

}  // namespace dp::tool
