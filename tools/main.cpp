#include <filesystem>

#include "tools/csv.h"
#include "tools/exit_code.h"
#include "tools/interrupt.h"
#include "tools/json_view.h"
#include "tools/library.h"
#include "tools/options.h"
#include "tools/output.h"
#include "tools/table_view.h"
#include "tools/text.h"
#include "tools/workbook.h"

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

void show(Workbook& workbook, const Options& options) {
    if (options.view != View::Names) workbook.open();
    if (options.view == View::Csv) return writeCsv(workbook, options);
    Output output(options.target);
    if (options.view == View::Names) showNames(workbook, output);
    if (options.view == View::Json) writeJson(workbook, options, output);
    if (options.view == View::Tables) showTables(workbook, options, output);
    output.finish();
}

// What the library throws becomes a failure that says what to do.
void importBook(const Options& options) {
    refuseToOverwrite(options);
    const Library library(options.library);
    try {
        Workbook workbook(library, options);
        show(workbook, options);
    } catch (const ClosedPipe&) {
        throw;
    } catch (const Interrupted&) {
        throw;
    } catch (...) {
        throw currentFailure(options.book);
    }
}

int run(int count, const char* const* arguments) {
    constexpr int kSignalBase = 128;
    noteInterrupts();
    try {
        const Request request = parseOptions(count, arguments);
        if (request.answer.empty()) {
            importBook(request.options);
        } else {
            print(request.answer);
        }
    } catch (const ClosedPipe&) {
        return kSuccess;
    } catch (const Interrupted& interrupt) {
        return kSignalBase + interrupt.signal;
    } catch (const Failure& failure) {
        printFailure(failure.what());
        return failure.code();
    } catch (const std::exception& error) {
        printFailure(error.what());
        return kSystemFailure;
    }
    return kSuccess;
}

}  // namespace

}  // namespace dp::tool

int main(int count, char** arguments) { return dp::tool::run(count, arguments); }
