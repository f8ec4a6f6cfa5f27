#include "tools/host/exit_code.h"

#include <cstdio>
#include <exception>
#include <filesystem>
#include <new>
#include <system_error>

#include "tools/views/text.h"

namespace dp::tool {

namespace {

struct ResultText {
    long result;
    ExitCode code;
    const char* text;
};

constexpr ResultText kResultTexts[] = {
    {-17, kNoSuchFile, "there is no such file; check the name"},
    {-18, kTemporaryDirectory,
     "cannot be copied into the temporary directory; check that you may read the file and that "
     "TMPDIR names a writable folder with free space"},
    {-22, kNoPackage,
     "is not an .xlsx package; save it as an Excel workbook (.xlsx) without a password"},
    {-25, kNoWorkbook,
     "holds no workbook that can be read (its workbook part or style sheet is missing or damaged, "
     "or it is a document of another kind); open it in a spreadsheet program and save it as .xlsx "
     "again"},
};

constexpr const char* kDamaged =
    "is damaged or the disk is full: an entry of the package cannot be unpacked; get a fresh copy "
    "of the file or free some space";
constexpr const char* kMalformed =
    "has a part that is missing or malformed; open it in a spreadsheet program and save it as "
    ".xlsx again";

// Without one, the library lets the file system's exception through.
bool hasTemporaryDirectory() {
    std::error_code error;
    return !std::filesystem::temp_directory_path(error).empty() && !error;
}

}  // namespace

Failure readFailure(const std::string& book, long result) {
    std::error_code error;
    if (result == -kNoSuchFile && std::filesystem::is_directory(book, error)) {
        return {kNoSuchFile, book + ": is a folder; name the workbooks in it, as in FOLDER/*.xlsx"};
    }
    for (const ResultText& entry : kResultTexts) {
        if (entry.result == result) return {entry.code, book + ": " + entry.text};
    }
    return {kReadFailure, book + ": " + kDamaged};
}

Failure currentFailure(const std::string& book) {
    try {
        throw;
    } catch (const Failure& failure) {
        return failure;
    } catch (const std::bad_alloc&) {
        return {kSystemFailure, book +
                                    ": there is not enough memory; close other programs or read "
                                    "fewer worksheets"};
    } catch (const std::exception& error) {
        if (!hasTemporaryDirectory()) return readFailure(book, -kTemporaryDirectory);
        return {kSystemFailure, book + ": " + error.what() +
                                    "; check that the file and the temporary directory can be "
                                    "reached"};
    } catch (...) {
        // The library's reader throws a type of its own, which a host that loads the library does
        // not know.
        return {kMalformedWorkbook, book + ": " + kMalformed};
    }
}

void printLine(const std::string& text) {
    std::fprintf(stderr, "dpxlsx: %s\n", printable(text).c_str());
}

}  // namespace dp::tool
