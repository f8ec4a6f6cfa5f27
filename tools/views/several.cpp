#include "tools/views/several.h"

#include <algorithm>
#include <iterator>
#include <map>
#include <optional>

#include "tools/host/exit_code.h"
#include "tools/host/interrupt.h"
#include "tools/options/option_values.h"
#include "tools/views/csv.h"
#include "tools/views/json_view.h"
#include "tools/views/text.h"

namespace dp::tool {

namespace {

// From the best to the worst: what does not fit one workbook, what is wrong with one workbook, and
// what is wrong with the machine, which may have spared the others by luck.
constexpr int kOrder[] = {kSuccess,       kUsage,         kNoSuchFile,
                          kNoPackage,     kNoWorkbook,    kMalformedWorkbook,
                          kReadFailure,   kOutputFailure, kTemporaryDirectory,
                          kSystemFailure, kLibraryFailure};

bool isBetter(int code, int other) {
    return std::ranges::find(kOrder, code) < std::ranges::find(kOrder, other);
}

// How the workbooks so far have ended.
class Outcomes {
  public:
    void add(int code) { ++counts_[code]; }

    int worst() const {
        int worst = kSuccess;
        for (const auto& [code, count] : counts_) worst = std::max(worst, code, isBetter);
        return worst;
    }

    // "7 workbooks: 5 done, 2 failed (exit code 22: 1, 25: 1)".
    std::string summary(size_t given) const {
        size_t all = 0;
        std::string codes;
        for (const auto& [code, count] : counts_) {
            all += count;
            if (code == kSuccess) continue;
            codes += (codes.empty() ? " (exit code " : ", ") + std::to_string(code) + ": " +
                     std::to_string(count);
        }
        const size_t done = counts_.contains(kSuccess) ? counts_.at(kSuccess) : 0;
        return (all < given ? std::to_string(all) + " of " : "") + counted(given, "workbook") +
               ": " + std::to_string(done) + " done, " + std::to_string(all - done) + " failed" +
               (codes.empty() ? codes : codes + ")");
    }

  private:
    std::map<int, size_t> counts_;
};

// The folder of each workbook.
std::vector<std::string> foldersFor(const Request& request) {
    const std::string& target = request.options.target;
    if (!meansFolder(target)) {
        wrongUsage("several workbooks need a folder for their CSV files: --csv FOLDER/");
    }
    std::vector<std::string> folders;
    std::map<std::string, std::string> taken;
    for (const std::string& book : request.books) {
        folders.push_back(folderOf(book, target));
        const auto [other, isNew] = taken.emplace(folders.back(), book);
        if (isNew) continue;
        wrongUsage(
            other->second + " and " + book + " would both be written to " + folders.back() +
            "; nothing was written: import one of them in another call, into another folder");
    }
    return folders;
}

class Several {
  public:
    explicit Several(const Request& request) : request_(request) {
        if (request.options.view == View::Csv) {
            folders_ = foldersFor(request);
        } else {
            output_.emplace(request.options.target);
        }
    }

    int carryOutEach(const CarryOut& carryOut) {
        const size_t count = request_.books.size();
        try {
            for (size_t i = 0; i < count; ++i) {
                stopIfInterrupted();
                carryOutOne(carryOut, i);
            }
        } catch (const Interrupted&) {
            printLine(outcomes_.summary(count));
            throw;
        }
        if (output_) output_->finish();
        printLine(outcomes_.summary(count));
        return outcomes_.worst();
    }

  private:
    void carryOutOne(const CarryOut& carryOut, size_t index) {
        Options options = request_.options;
        options.book = request_.books[index];
        options.turn =
            std::to_string(index + 1) + " of " + std::to_string(request_.books.size()) + ": ";
        if (!folders_.empty()) options.target = folders_[index];
        Output output = Output::inMemory();
        std::optional<Failure> failure;
        std::vector<std::string> notes;
        try {
            notes = carryOut(options, output);
        } catch (const Failure& thrown) {
            failure = thrown;
            notes = {thrown.what()};
        }
        outcomes_.add(failure ? failure->code() : kSuccess);
        if (output_) show(options, output.text(), failure);
        for (const std::string& note : notes) printLine(note);
    }

    void show(const Options& options, const std::string& text,
              const std::optional<Failure>& failure) {
        if (options.view == View::Json) {
            output_->write(failure ? failureJson(options.book, *failure) : text);
        } else if (!failure) {
            output_->write((hasShown_ ? "\n" : "") + printable(options.book) + ":\n" + text);
            hasShown_ = true;
        }
        output_->flush();
    }

    const Request& request_;
    std::vector<std::string> folders_;  // for CSV, of each workbook
    std::optional<Output> output_;      // for all other views
    bool hasShown_ = false;
    Outcomes outcomes_;
};

}  // namespace

int carryOutEach(const Request& request, const CarryOut& carryOut) {
    return Several(request).carryOutEach(carryOut);
}

}  // namespace dp::tool
