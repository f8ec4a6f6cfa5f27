#include <dlfcn.h>

#include <csignal>
#include <functional>
#include <sys/resource.h>
#include <sys/statvfs.h>

#include "provider/xlsx_data_provider.h"
#include "readers/limits.h"
#include "tests/package_builder.h"
#include "tests/temporary_files.h"

#include "fuzz/zip_writer.h"

// Faults of the machine, made on purpose: this program stands between the library and the C library.
// Whatever fails, the disk is clean once the provider is closed, and the same provider opens a good
// workbook. What lacks memory or descriptors and what has
// spoilt bytes is tested in fuzz/.
namespace {

std::uint64_t freeBytes = 0;                         // of every file system; 0 for the truth
std::function<bool()> copies = [] { return true; };  // asked once; false for an error

}  // namespace

extern "C" int statvfs(const char* path, struct statvfs* status) noexcept {
    static const auto real = reinterpret_cast<decltype(&statvfs)>(::dlsym(RTLD_NEXT, "statvfs"));
    const int result = real(path, status);
    if (freeBytes > 0) status->f_bavail = freeBytes / status->f_frsize;
    return result;
}

// Called by the C++ library, which must see it.
extern "C" [[gnu::visibility("default")]] ssize_t sendfile(int out, int in, off_t* offset, std::size_t size) noexcept {
    static const auto real = reinterpret_cast<decltype(&sendfile)>(::dlsym(RTLD_NEXT, "sendfile"));
    if (std::exchange(copies, [] { return true; })()) return real(out, in, offset, size);
    errno = EIO;
    return -1;
}

namespace {

namespace fs = boost::filesystem;

class Faults : public TemporaryFiles {
  protected:
    void SetUp() override {
        TemporaryFiles::SetUp();
        PackageBuilder::of({"<row><c><v>1</v></c></row>"}).write(good());
    }
    std::string good() const { return file("good.xlsx"); }

    // The result code, 2 for the file system's exception.
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
    void expectResult(const std::string& path, long result) {
        EXPECT_EQ(open(path), result);
        expectRecovery();
    }

    dp::xlsxDataProvider provider;
};

TEST_F(Faults, OfTemporaryDirectories) {
    for (const auto& [directory, result] : {std::pair{file("nowhere"), 2}, {good(), 2}, {"/proc", -18}}) {
        ::setenv("TMPDIR", directory.c_str(), 1);
        EXPECT_EQ(open(good()), result) << directory;
        ::setenv("TMPDIR", temporary().c_str(), 1);
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
    // The write that fails, and what the file system says that it has: room for nothing, for the copy
    // and not for what is in it, for all.
    for (const auto& [bytes, result] : {std::pair{100U, -18}, {50'000U, -1}, {200'000U, 0}}) {
        const rlimit less{bytes, limit.rlim_max};
        ::setrlimit(RLIMIT_FSIZE, &less);
        EXPECT_EQ(open(file("large.xlsx")), result) << bytes;
        ::setrlimit(RLIMIT_FSIZE, &limit);
        expectRecovery();
        freeBytes = bytes;
        EXPECT_EQ(open(file("large.xlsx")), result) << bytes;
        EXPECT_EQ(fs::exists(provider.GetTempDirectoryPath()), result == 0);
        freeBytes = 0;
        expectRecovery();
    }
}

TEST_F(Faults, OfPackagesBeyondTheLimits) {
    fuzz::ZipWriter growth;
    growth.add({"bomb", "", true, false, 0xFFFFFFFF});
    fuzz::ZipWriter entries;
    for (std::uint64_t i = 0; i <= dp::kPackageEntries; ++i) entries.add({"e", "", false});
    for (const fuzz::ZipWriter* archive : {&growth, &entries}) {
        EXPECT_EQ(open(write("large.xlsx", archive->finished())), -1);
        EXPECT_FALSE(fs::exists(provider.GetTempDirectoryPath()));
        expectRecovery();
    }
}

}  // namespace
