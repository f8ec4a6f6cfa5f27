// soak OPENS SEED PROCESSES BOOK...: every process opens that many of the workbooks, in random
// order and under random settings, half of them damaged at random, and loads everything in them.
// All processes have one temporary directory. Afterwards the resident memory must be what it was
// after the first thousand opens, but for a MiB, and no descriptor and no file may be left. Prints
// what it saw.

#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <iterator>
#include <map>
#include <random>
#include <string>
#include <sys/wait.h>
#include <vector>

#include <boost/filesystem.hpp>

#include "dpxlsx/model/host/entry_points.h"
#include "dpxlsx/model/host/i_data_provider.h"
#include "dpxlsx/model/host/reference.h"
#include "dpxlsx/readers/xml/xml_reader.h"
#include "fuzz/checks.h"
#include "fuzz/host.h"
#include "testkit/workspace.h"

namespace {

namespace fs = boost::filesystem;
using fuzz::require;

constexpr unsigned long kWarmUp = 1'000;    // opens after which every buffer has been needed once
constexpr long kTolerated = 1024;           // KiB of growth
constexpr std::size_t kLargest = 1 << 20U;  // bytes of a workbook; larger ones are left out

struct Book {
    std::string extension;
    std::string bytes;
};

std::vector<Book> readBooks(char** begin, char** end) {
    std::vector<Book> books;
    for (char** path = begin; path < end; ++path) {
        std::ifstream file(*path, std::ios::binary);
        std::string bytes{std::istreambuf_iterator<char>(file), {}};
        if (!bytes.empty() && bytes.size() <= kLargest)
            books.push_back({fs::path(*path).extension().string(), std::move(bytes)});
    }
    require(!books.empty(), "no workbooks");
    return books;
}

// KiB
long residentMemory() {
    std::ifstream status("/proc/self/status");
    for (std::string line; std::getline(status, line);)
        if (line.rfind("VmRSS:", 0) == 0) return std::atol(line.c_str() + 6);
    fuzz::fail("no resident memory");
}

std::ptrdiff_t openFiles() {
    const fs::directory_iterator descriptors("/proc/self/fd");
    return std::distance(begin(descriptors), end(descriptors));
}

class Soak {
  public:
    Soak(const std::vector<Book>& books, unsigned seed, const std::string& folder)
        : books_(books), random_(seed), folder_(folder) {
        fs::create_directories(folder_);
    }

    void run(unsigned long opens) {
        long before = 0;
        const std::ptrdiff_t files = openFiles();
        for (unsigned long i = 0; i < opens; ++i) {
            if (i == kWarmUp) before = residentMemory();
            ++results_[openOne()];
        }
        const long after = residentMemory();
        std::printf("%lu opens, %ld KiB after the first %lu, %ld KiB in the end;", opens, before,
                    kWarmUp, after);
        for (const auto& [result, count] : results_) std::printf(" %ld: %lu", result, count);
        std::printf("\n");
        require(openFiles() == files, "descriptors were left open");
        require(opens <= kWarmUp || after <= before + kTolerated, "memory grows");
        require(results_[0] > opens / 4, "too few workbooks open");
    }

  private:
    unsigned below(std::size_t bound) { return static_cast<unsigned>(random_() % bound); }
    bool either() { return below(2) == 0; }

    std::string damaged(std::string bytes) {
        if (below(4) == 0) bytes.resize(below(bytes.size()));
        for (unsigned i = below(8); i > 0 && !bytes.empty(); --i)
            bytes[below(bytes.size())] = static_cast<char>(random_());
        return bytes;
    }
    void choose(dp::IDataProvider& provider) {
        require(dp::SetReadingRules(&provider, either() ? 1 : 0) == 0, "no rules");
        if (either()) provider.SetDateTimeVariableFormatHelper(new fuzz::Helper);
        provider.SetReadOptionIgnoreBlankRows(either());
        provider.SetReadOptionPadColumnsWithMissingValues(either());
        provider.SetReadOptionCleanTextValues(either());
        provider.SetReadOptionCleanWorksheetNames(either());
        provider.SetReadOptionConvertDateTimeToText(either());
        if (either()) provider.SetMissingText("N/A", "");
        if (either()) provider.SetMissingNumeric(-99, -98);
        if (either()) provider.SetMaxVariableNameLength(1 + below(40));
        provider.SetPreviewing(below(4) == 0);
    }
    long openOne() {
        const Book& book = books_[below(books_.size())];
        const std::string path = folder_ + "/book" + book.extension;
        testkit::writeFile(path, either() ? book.bytes : damaged(book.bytes));
        dp::IDataProvider* created = nullptr;
        require(dp::CreateDataProvider("xlsx", &created) == 0, "no provider");
        const dp::Reference provider(created);
        choose(*provider);
        long result = 0;
        try {
            result = provider->OpenFile(path.c_str(), dp::IDataProvider::FileAccess::Read);
        } catch (const CmXmlException& e) {
            result = e.code();
        }
        fuzz::takeEverything(*provider);
        if (either()) provider->CloseFile();
        return result;
    }

    const std::vector<Book>& books_;
    std::mt19937 random_;
    std::string folder_;
    std::map<long, unsigned long> results_;
};

}  // namespace

int main(int argc, char** argv) {
    if (argc < 5) {
        std::fputs("usage: soak OPENS SEED PROCESSES BOOK...\n", stderr);
        return 2;
    }
    const unsigned long opens = std::strtoul(argv[1], nullptr, 10);
    const auto seed = static_cast<unsigned>(std::strtoul(argv[2], nullptr, 10));
    const auto processes = static_cast<unsigned>(std::strtoul(argv[3], nullptr, 10));
    const std::vector<Book> books = readBooks(argv + 4, argv + argc);

    const testkit::Workspace workspace(testkit::Workspace::Place::Memory);
    bool failed = false;
    for (unsigned i = 0; i < processes; ++i)
        if (::fork() == 0) {
            Soak(books, seed + i, workspace.file(std::to_string(i))).run(opens);
            std::fflush(stdout);
            ::_exit(0);
        }
    for (int status = 0; ::wait(&status) > 0;) failed = failed || status != 0;
    for (const fs::path& left : fs::directory_iterator(workspace.temporary())) {
        std::printf("left: %s\n", left.c_str());
        failed = true;
    }
    return failed ? 1 : 0;
}
