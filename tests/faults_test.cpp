#include <dlfcn.h>

#include <algorithm>
#include <cerrno>
#include <csignal>
#include <deque>
#include <functional>
#include <sys/resource.h>
#include <sys/statvfs.h>
#include <utility>

#include "dpxlsx/provider/unpacking_limits.h"
#include "dpxlsx/provider/xlsx_data_provider.h"
#include "dpxlsx/readers/xml/file_copy.h"
#include "dpxlsx/readers/xml/xml_reader.h"
#include "testkit/package_builder.h"
#include "testkit/process_settings.h"
#include "testkit/recording_provider.h"
#include "testkit/zip_writer.h"
#include "tests/temporary_files.h"

// Simulated faults of the machine: this program replaces functions of the C library that the library calls. Whatever
// fails, nothing is left on the disk once the provider is closed, and the same provider can open a good workbook. Lack
// of memory or descriptors and damaged bytes are tested in fuzz/.
namespace {

// The free bytes that the next checks of the file system report, the last number from then on; empty for the real ones.
std::deque<std::uint64_t> freeBytes;
std::function<bool()> copies = [] { return true; };  // called once; false makes the call fail
bool slow = false;                                   // reads and writes are interrupted and transfer one byte at a time
bool closes = true;                                  // called once; false makes the call fail
int soundReads = -1;                                 // reads before one fails; -1 when none fails or it has failed

constexpr std::uint64_t kNoBlocks = 0;  // free bytes of a file system that does not count them

// True for every other call while `slow` is set.
bool interrupted() {
    static bool turn = false;
    turn = slow && !turn;
    if (turn) errno = EINTR;
    return turn;
}

}  // namespace

template <class Function>
Function* realOne(Function*, const char* name) {
    return reinterpret_cast<Function*>(::dlsym(RTLD_NEXT, name));
}

extern "C" int statvfs(const char* path, struct statvfs* status) noexcept {
    static const auto real = realOne(&statvfs, "statvfs");
    const int result = real(path, status);
    if (freeBytes.empty()) return result;
    status->f_frsize = 1;
    status->f_bavail = freeBytes.front();
    status->f_blocks = freeBytes.front() == kNoBlocks ? 0 : 1;
    if (freeBytes.size() > 1) freeBytes.pop_front();
    return result;
}

// Replaces the function for the library only; the C++ library does not see it.
extern "C" ssize_t read(int file, void* bytes, std::size_t size) {
    static const auto real = realOne(&read, "read");
    if (soundReads >= 0 && soundReads-- == 0) {
        errno = EIO;
        return -1;
    }
    return interrupted() ? -1 : real(file, bytes, slow ? std::min<std::size_t>(size, 1) : size);
}
extern "C" ssize_t write(int file, const void* bytes, std::size_t size) {
    static const auto real = realOne(&write, "write");
    return interrupted() ? -1 : real(file, bytes, slow ? std::min<std::size_t>(size, 1) : size);
}
extern "C" int close(int file) {
    static const auto real = realOne(&close, "close");
    return real(file) == 0 && std::exchange(closes, true) ? 0 : -1;
}

// Called by the C++ library, which must see them; which of the two comes first depends on its version.
extern "C" [[gnu::visibility("default")]] ssize_t copy_file_range(int in, off64_t* inOffset, int out,
                                                                  off64_t* outOffset, std::size_t size,
                                                                  unsigned flags) {
    static const auto real = realOne(&copy_file_range, "copy_file_range");
    if (std::exchange(copies, [] { return true; })()) return real(in, inOffset, out, outOffset, size, flags);
    errno = EIO;
    return -1;
}
extern "C" [[gnu::visibility("default")]] ssize_t sendfile(int out, int in, off_t* offset, std::size_t size) noexcept {
    static const auto real = realOne(&sendfile, "sendfile");
    if (std::exchange(copies, [] { return true; })()) return real(out, in, offset, size);
    errno = EIO;
    return -1;
}

namespace {

namespace fs = boost::filesystem;
using testkit::PackageBuilder;

class Faults : public TemporaryFiles {
  protected:
    void SetUp() override { PackageBuilder::of({"<row><c><v>1</v></c></row>"}).write(good()); }
    std::string good() const { return file("good.xlsx"); }

    // The result code; 2 for the file system's exception.
    long open(const std::string& path) {
        try {
            return provider.OpenFile(path.c_str(), dp::IDataProvider::FileAccess::Read);
        } catch (const fs::filesystem_error&) {
            return 2;
        }
    }
    void expectRecovery() {
        provider.CloseFile();
        provider.ClearWorksheets();
        EXPECT_TRUE(fs::is_empty(temporary()));
        EXPECT_EQ(open(good()), 0);
        EXPECT_EQ(provider.GetColumnPrimeKeys(1)->Count(), 1UL);
        provider.CloseFile();
        provider.ClearWorksheets();
    }
    // Opens with this free space, and checks that nothing is left when it does not suffice.
    void expectOutcome(const char* name, const std::deque<std::uint64_t>& space, long result) {
        SCOPED_TRACE(name + std::to_string(space.back()));
        freeBytes = space;
        EXPECT_EQ(open(file(name)), result);
        freeBytes.clear();
        EXPECT_EQ(fs::exists(provider.GetTempDirectoryPath()), result == 0);
        expectRecovery();
    }
    void expectResult(const std::string& path, long result) {
        EXPECT_EQ(open(path), result);
        expectRecovery();
    }

    dp::xlsxDataProvider provider;
};

TEST_F(Faults, OfTemporaryDirectories) {
    for (const auto& [directory, result] : {std::pair{file("nowhere"), 2}, {good(), 2}, {"/proc", -18}}) {
        {
            const testkit::EnvironmentVariable elsewhere("TMPDIR", directory);
            EXPECT_EQ(open(good()), result) << directory;
        }
        expectRecovery();
    }
}

TEST_F(Faults, OfSources) {
    const std::string path = file("source.xlsx");
    fs::copy_file(good(), path);
    copies = [] { return false; };
    expectResult(path, -18);
    copies = [&] { return fs::resize_file(path, fs::file_size(path) / 2), true; };
    expectResult(path, -18);
    fs::copy_file(good(), path, fs::copy_options::overwrite_existing);
    copies = [&] { return fs::remove(path); };
    expectResult(path, 0);  // it is open
}

TEST_F(Faults, OfFullDisks) {
    std::signal(SIGXFSZ, SIG_IGN);
    rlimit limit{};
    ::getrlimit(RLIMIT_FSIZE, &limit);
    PackageBuilder::of({std::string(100'000, ' ')}).write(file("large.xlsx"));
    // The size from which writes fail: there is room for nothing, for the copy but not for its content, for everything.
    for (const auto& [bytes, result] : {std::pair{100U, -18}, {50'000U, -1}, {200'000U, 0}}) {
        const rlimit less{bytes, limit.rlim_max};
        ::setrlimit(RLIMIT_FSIZE, &less);
        EXPECT_EQ(open(file("large.xlsx")), result) << bytes;
        ::setrlimit(RLIMIT_FSIZE, &limit);
        expectRecovery();
        expectOutcome("large.xlsx", {bytes}, result);
    }
    // A share of the space is left to other processes, which may also fill the disk while an entry is written.
    constexpr std::uint64_t kLarge = 1 << 30;
    PackageBuilder::of({""}).add("a", std::string(2 * dp::kSpaceCheckInterval + 100'000, ' ')).write(file("huge.xlsx"));
    expectOutcome("large.xlsx", {105'000}, -1);
    expectOutcome("large.xlsx", {115'000}, 0);
    expectOutcome("huge.xlsx", {kLarge, kLarge, kLarge / dp::kSpareSpaceDivisor}, 0);
    expectOutcome("huge.xlsx", {kLarge, kLarge, kLarge, kLarge / dp::kSpareSpaceDivisor - 1}, -1);
    expectOutcome("huge.xlsx", {kNoBlocks}, 0);
}

TEST_F(Faults, OfSlowAndBadDisks) {
    slow = true;
    EXPECT_EQ(open(good()), 0);
    slow = false;
    EXPECT_EQ(provider.GetColumnPrimeKeys(1)->Count(), 1UL);
    expectRecovery();
    closes = false;
    expectResult(good(), -1);
    copies = [] { return false; };
    EXPECT_FALSE(dp::copyFile(good(), file("copy.xlsx")));
    EXPECT_FALSE(fs::exists(file("copy.xlsx")));
}

// A plain part is read again when reading it fails, so that an open may well succeed: with everything that is there.
TEST_F(Faults, OfEveryRead) {
    const PackageBuilder package = PackageBuilder::of({"<row><c><v>1</v></c></row><row><c t='s'><v>1</v></c></row>"});
    PackageBuilder(package)
        .set("xl/sharedStrings.xml", "<sst uniqueCount='2'><si><t>a</t></si><si><t>b</t></si></sst>")
        .write(file("texts.xlsx"));
    testkit::RecordingProvider recording;
    int reads = 0;
    for (bool failed = true; failed; ++reads) {
        soundReads = reads;
        bool opened = false;
        try {
            opened = recording.OpenFile(file("texts.xlsx").c_str(), dp::IDataProvider::FileAccess::Read) == 0;
        } catch (const CmXmlException&) {
        }
        failed = std::exchange(soundReads, -1) < 0;
        EXPECT_TRUE(opened || failed) << "read " << reads;
        const std::string calls = recording.taken();
        if (opened) {
            EXPECT_EQ(calls, "+S1 @0 0,0=1 1,0='b' @0") << "read " << reads;
        }
        recording.CloseFile();
        recording.ClearWorksheets();
        EXPECT_TRUE(fs::is_empty(temporary())) << "read " << reads;
    }
    EXPECT_GT(reads, 10);
}

TEST_F(Faults, OfPackagesBeyondTheLimits) {
    testkit::ZipWriter growth;
    growth.add({"bomb", "", true, false, 0xFFFFFFFF});
    testkit::ZipWriter entries;
    for (std::uint64_t i = 0; i <= dp::kPackageEntries; ++i) entries.add({"e", "", false});
    for (const testkit::ZipWriter* archive : {&growth, &entries}) {
        EXPECT_EQ(open(write("large.xlsx", archive->finished())), -1);
        EXPECT_FALSE(fs::exists(provider.GetTempDirectoryPath()));
        expectRecovery();
    }
}

}  // namespace
