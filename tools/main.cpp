#include <cstdio>
#include <exception>
#include <filesystem>
#include <system_error>

#include "tools/explain/explain.h"
#include "tools/host/exit_code.h"
#include "tools/host/interrupt.h"
#include "tools/host/library.h"
#include "tools/host/workbook.h"
#include "tools/options/help.h"
#include "tools/options/options.h"
#include "tools/page/page_view.h"
#include "tools/views/csv.h"
#include "tools/views/json_view.h"
#include "tools/views/output.h"
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

void refuseToOverwrite(const Options& options) {
    std::error_code error;
    if (!std::filesystem::equivalent(options.book, options.target, error)) return;
    throw Failure(kUsage, options.target + ": is the workbook itself; name another file to write");
}

void showPage(const Library& library, Workbook& workbook, const Options& options) {
    Output output(options.target);
    writePage(library, workbook, options, output);
    output.finish();
}

void show(Workbook& workbook, const Options& options) {
    workbook.open();
    if (options.view == View::Csv) return writeCsv(workbook, options);
    Output output(options.target);
    if (options.view == View::Json) writeJson(workbook, options, output);
    if (options.view == View::Tables) showTables(workbook, options, output);
    output.finish();
}

// Prints what the user would not notice in the output.
void printNotes(const Workbook& workbook, const Options& options) {
    const std::string note = importNote(options, workbook.folder(), workbook.leftOut());
    if (!note.empty()) printLine(note);
    for (const std::string& more : workbook.notes()) printLine(more);
}

void importBook(const Library& library, const Options& options) {
    Workbook workbook(library, options);
    if (options.view == View::Page) {
        showPage(library, workbook, options);
        return printNotes(workbook, options);
    }
    if (options.view != View::Names) {
        show(workbook, options);
        return printNotes(workbook, options);
    }
    Output output(options.target);
    showNames(workbook, output);
    output.finish();
}

void explainBook(const Library& library, const Options& options) {
    Output output(options.target);
    explain(library, options, output);
    output.finish();
}

// Turns exceptions of the library into failures that say what to do.
void carryOut(const Options& options) {
    refuseToOverwrite(options);
    const Library library(options.library);
    try {
        if (options.explain) return explainBook(library, options);
        importBook(library, options);
    } catch (const ClosedPipe&) {
        throw;
    } catch (const Interrupted&) {
        throw;
    } catch (...) {
        throw explained(currentFailure(options.book), options);
    }
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
        if (request.answer.empty()) {
            carryOut(request.options);
        } else {
            print(request.answer);
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
