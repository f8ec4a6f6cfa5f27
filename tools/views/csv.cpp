#include "tools/views/csv.h"

#include <algorithm>
#include <cstdint>
#include <deque>
#include <filesystem>
#include <set>
#include <system_error>

#include "tools/host/exit_code.h"
#include "tools/host/interrupt.h"
#include "tools/views/output.h"
#include "tools/views/text.h"

namespace dp::tool {

namespace {

namespace fs = std::filesystem;

std::string csvText(const std::string& text) {
    const bool spaces = !text.empty() && (text.front() == ' ' || text.back() == ' ');
    if (!spaces && text.find_first_of(",\"\r\n") == std::string::npos) return text;
    std::string result = "\"";
    for (const char c : text) {
        if (c == '"') result += '"';
        result += c;
    }
    return result + '"';
}

std::string nameOf(const Column& column) {
    const std::string name = column.name();
    return name.empty() ? "C" + std::to_string(column.host().GetPosition()) : name;
}

template <class TextOf>
void writeLine(Output& output, const LoadedWorksheet& worksheet, TextOf textOf) {
    std::string line;
    for (const Column& column : worksheet.columns) {
        if (&column != &worksheet.columns.front()) line += ',';
        line += csvText(validUtf8(textOf(column)));
    }
    // Programs that read CSV skip empty lines; an empty field must still be a row.
    output.write(line.empty() ? "\"\"\n" : line + "\n");
}

void writeWorksheet(const LoadedWorksheet& worksheet, const Options& options, Output& output) {
    const size_t rows = std::min(worksheet.layout.rows, options.head.value_or(SIZE_MAX));
    writeLine(output, worksheet, nameOf);
    for (size_t row = 0; row < rows; ++row) {
        stopIfInterrupted();
        writeLine(output, worksheet, [&](const Column& column) {
            return options.asShown ? column.shown(row) : column.exact(row);
        });
    }
    output.close();
}

// A file name made of the title: it does not lead out of the folder, and every file system accepts
// it.
std::string fileName(const std::string& title) {
    constexpr size_t kLongest = 200;  // bytes
    std::string name = validUtf8(title);
    for (char& c : name) {
        const bool control = static_cast<unsigned char>(c) < 0x20;
        if (control || std::string("/\\:*?\"<>|").find(c) != std::string::npos) c = '_';
    }
    if (name.empty() || name.front() == '.') name.insert(0, "_");
    return validUtf8(name.substr(0, kLongest));
}

void writeFolder(Workbook& workbook, const Options& options,
                 const std::vector<SheetEntry>& sheets) {
    const fs::path folder(options.target);
    std::error_code error;
    fs::create_directories(folder, error);
    if (error) {
        throw Failure(kOutputFailure, options.target + ": the folder cannot be made (" +
                                          error.message() + "); name another one");
    }
    std::deque<Output> files;
    std::set<std::string> taken;
    for (const SheetEntry& sheet : sheets) {
        std::string name = fileName(sheet.title);
        while (!taken.insert(name).second) name += "-" + std::to_string(sheet.key);
        files.emplace_back((folder / (name + ".csv")).string());
        writeWorksheet(workbook.load(sheet), options, files.back());
    }
    for (Output& file : files) file.finish();
}

}  // namespace

bool meansFolder(const std::string& target) {
    std::error_code error;
    return target.ends_with('/') || fs::is_directory(target, error);
}

std::string folderOf(const std::string& book, const std::string& target) {
    fs::path name = fs::path(book).filename();
    if (namesWorkbook(book)) name = name.stem();
    return (fs::path(target) / fileName(name.string())).string() + "/";
}

void writeCsv(Workbook& workbook, const Options& options) {
    const std::vector<SheetEntry> sheets = workbook.worksheets();
    if (meansFolder(options.target)) return writeFolder(workbook, options, sheets);
    if (sheets.empty()) {
        printLine(options.book + ": no worksheet with values is left to write");
        return Output(options.target).finish();
    }
    if (sheets.size() > 1) {
        throw Failure(kUsage, options.book + ": " + worksheetsText(sheets) +
                                  "; add --sheet and the name or number of one, or name a folder "
                                  "for all: --csv FOLDER/");
    }
    Output output(options.target);
    writeWorksheet(workbook.load(sheets.front()), options, output);
    output.finish();
}

}  // namespace dp::tool
