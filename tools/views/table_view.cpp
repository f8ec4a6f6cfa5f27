#include "tools/views/table_view.h"

#include <unistd.h>

#include <algorithm>

#include <dpxlsx/model/host/i_column.h>

#include "tools/views/table.h"
#include "tools/views/terminal.h"
#include "tools/views/text.h"

namespace dp::tool {

namespace {

constexpr size_t kFirstRows = 10;

std::string layoutText(const LoadedWorksheet& worksheet) {
    const Layout& layout = worksheet.layout;
    std::string text = counted(worksheet.columns.size(), "column");
    if (!worksheet.leftOut.empty()) {
        text += " (" + std::to_string(worksheet.leftOut.size()) + " more left out)";
    }
    text += ", " + counted(layout.rows, "row") + " of data; ";
    text += layout.nameRow == 0 ? "no variable names"
                                : "variable names in row " + std::to_string(layout.nameRow);
    text += ", data from row " + std::to_string(layout.firstDataRow);
    return text + ", last used row " + std::to_string(layout.usedRows);
}

Table columnTable(const LoadedWorksheet& worksheet) {
    Table table({{"key", true},
                 {"position", true},
                 {"name", false},
                 {"kind", false},
                 {"rows", true},
                 {"missing", true},
                 {"converted", true},
                 {"format", false}});
    for (const Column& column : worksheet.columns) {
        const IColumn& host = column.host();
        const bool text = column.kind() == Kind::Text;
        table.addRow({std::to_string(host.GetPrimeKey()), std::to_string(host.GetPosition()),
                      column.name(), kindName(column.kind()), std::to_string(host.GetRowCount()),
                      std::to_string(host.GetMissingCount()),
                      text ? "-" : std::to_string(column.convertedMissing()), column.formatText()});
    }
    return table;
}

std::string cellText(const Column& column, size_t row, const std::string& missing) {
    if (row >= column.rows()) return {};
    return column.kind() != Kind::Text && column.isMissing(row) ? missing : column.shown(row);
}

Table valueTable(const LoadedWorksheet& worksheet, size_t rows, const std::string& missing) {
    std::vector<Table::Heading> headings{{"row", true}};
    for (const Column& column : worksheet.columns) {
        const std::string name = column.name();
        headings.push_back({name.empty() ? "C" + std::to_string(column.host().GetPosition()) : name,
                            column.kind() != Kind::Text});
    }
    Table table(headings);
    for (size_t row = 0; row < rows; ++row) {
        std::vector<std::string> texts{std::to_string(row + 1)};
        for (const Column& column : worksheet.columns) {
            texts.push_back(cellText(column, row, missing));
        }
        table.addRow(texts);
    }
    return table;
}

void showWorksheet(const LoadedWorksheet& worksheet, const Options& options, Output& output) {
    const std::optional<int> width = terminalWidth(STDOUT_FILENO);
    const std::string missing = options.settings.missingDisplay.value_or("*");
    const size_t rows = std::min(options.head.value_or(kFirstRows), worksheet.layout.rows);
    const std::string title =
        "Worksheet " + std::to_string(worksheet.key) + ": " + printable(worksheet.title);
    output.write(outputLine(title, width));
    output.write(outputLine(layoutText(worksheet), width) + "\n");
    columnTable(worksheet).print(output, width);
    if (rows == 0) return;
    output.write("\n");
    valueTable(worksheet, rows, missing).print(output, width);
    if (rows < worksheet.layout.rows) {
        output.write("and " + counted(worksheet.layout.rows - rows, "more row") + "\n");
    }
}

}  // namespace

void showTables(Workbook& workbook, const Options& options, Output& output) {
    const std::vector<SheetEntry> sheets = workbook.worksheets();
    if (sheets.empty()) {
        const bool leftOut = !options.settings.excludedSheets.empty();
        output.write(leftOut ? "All worksheets are left out\n" : "No worksheet with values\n");
    }
    for (size_t i = 0; i < sheets.size(); ++i) {
        if (i > 0) output.write("\n");
        showWorksheet(workbook.load(sheets[i]), options, output);
    }
}

}  // namespace dp::tool
