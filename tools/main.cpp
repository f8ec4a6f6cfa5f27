#include <cstdio>
#include <exception>
#include <filesystem>
#include <system_error>

#include "tools/explain/explain.h"
#include "tools/host/exit_code.h"
#include "tools/host/interrupt.h"
#include "tools/host/library.h"
#include "tools/host/version.h"
#include "tools/host/workbook.h"
#include "tools/options/help.h"
#include "tools/options/options.h"
#include "tools/page/page_view.h"
#include "tools/views/csv.h"
#include "tools/views/json_view.h"
#include "tools/views/output.h"
#include "tools/views/several.h"
#include "tools/views/table_view.h"
#include "tools/views/text.h"

namespace dp::tool {

namespace {

void print(const std::string& text) {
    Output output("-");
    output.write(text);
    output.finish();
}

void showNames(Workbook& workbook, Output& output) {
    for (const std::string& name : workbook.worksheetNames()) output.write(printable(name) + "\n");
}

void refuseToOverwrite(const std::string& book, const std::string& target) {
    std::error_code error;
    if (!std::filesystem::equivalent(book, target, error)) return;
    throw Failure(kUsage, target + ": is the workbook itself; name another file to write");
}

void show(Workbook& workbook, const Options& options, Output& output) {
    workbook.open();
    if (options.view == View::Csv) writeCsv(workbook, options);
    if (options.view == View::Json) writeJson(workbook, options, output);
    if (options.view == View::Tables) showTables(workbook, options, output);
}

// What the user would not notice in the output.
std::vector<std::string> notesOn(const Workbook& workbook, const Options& options) {
    std::vector<std::string> notes = workbook.notes();
    const std::string note = importNote(options, workbook.folder(), workbook.leftOut());
    if (!note.empty()) notes.insert(notes.begin(), note);
    return notes;
}

std::vector<std::string> importBook(const Library& library, const Options& options,
                                    Output& output) {
    Workbook workbook(library, options);
    if (options.view == View::Names) {
        showNames(workbook, output);
        return {};
    }
    if (options.view == View::Page) {
        writePage(library, workbook, options, output);
    } else {
        show(workbook, options, output);
    }
    return notesOn(workbook, options);
}

// Turns exceptions of the library into failures that say what to do.
std::vector<std::string> carryOut(const Library& library, const Options& options, Output& output) {
    try {
        if (!options.explain) return importBook(library, options, output);
        explain(library, options, output);
        return {};
    } catch (const ClosedPipe&) {
        throw;
    } catch (const Interrupted&) {
        throw;
    } catch (...) {
        throw explained(currentFailure(options.book), options);
    }
}

int carryOut(const Request& request) {
    const std::string& target = request.options.target;
    for (const std::string& book : request.books) refuseToOverwrite(book, target);
    const Library library(request.options.library);
    const auto one = [&library](const Options& options, Output& output) {
        return carryOut(library, options, output);
    };
    if (request.books.size() > 1) return carryOutEach(request, one);
    Options options = request.options;
    options.book = request.books.front();
    // CSV has files of its own.
    Output output = options.view == View::Csv ? Output::inMemory() : Output(target);
    const std::vector<std::string> notes = one(options, output);
    output.finish();
    for (const std::string& note : notes) printLine(note);
    return kSuccess;
}

int run(int count, const char* const* arguments) {
    constexpr int kSignalBase = 128;
    noteInterrupts();
    if (count < 2) {
        std::fputs(shortHelpText().c_str(), stderr);
        return kUsage;
    }
    try {
        const Request request = parseOptions(count, arguments);
        if (request.version) {
            print(versionText(request.options.library));
        } else if (!request.answer.empty()) {
            print(request.answer);
        } else {
            return carryOut(request);
        }
    } catch (const ClosedPipe&) {
        return kSuccess;
    } catch (const Interrupted& interrupt) {
        return kSignalBase + interrupt.signal;
    } catch (const Failure& failure) {
        printLine(failure.what());
        return failure.code();
    } catch (const std::exception& error) {
        printLine(error.what());
        return kSystemFailure;
    }
    return kSuccess;
}

}  // namespace

}  // namespace dp::tool

int main(int count, char** arguments) { return dp::tool::run(count, arguments); }
