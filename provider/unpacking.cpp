#include "dpxlsx/provider/unpacking.h"

#include <fcntl.h>
#include <string.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdint>
#include <iterator>
#include <limits>
#include <sys/stat.h>
#include <utility>

#include <boost/filesystem.hpp>
#include <minizip/unzip.h>

#include "dpxlsx/provider/archive.h"
#include "dpxlsx/provider/entry_name.h"
#include "dpxlsx/provider/entry_reader.h"
#include "dpxlsx/provider/temporary_directory.h"
#include "dpxlsx/provider/unpacking_limits.h"
#include "dpxlsx/readers/xml/progress.h"

// The archive's entries, one after the other, into the private directory.
namespace dp {

namespace {

namespace fs = boost::filesystem;

constexpr std::size_t kBufferSize = std::size_t{64} << 10;  // bytes
constexpr std::size_t kLongestName = 255;                   // bytes; longer names are cut
constexpr int kEntryFailed = UNZ_INTERNALERROR;

// Tells a file from all others, whatever its name.
struct FileIdentity {
    dev_t device = 0;
    ino_t number = 0;

    bool operator==(const FileIdentity&) const = default;
};

FileIdentity identityOf(const struct stat& status) { return {status.st_dev, status.st_ino}; }

// A file being written; the destructor closes it.
class OutputFile {
  public:
    // Does not follow a link, and does not open the file that must be `kept`. The file is readable
    // by its owner whatever the umask, and empty.
    OutputFile(const std::string& path, const FileIdentity& kept)
        : descriptor_(::open(path.c_str(), O_WRONLY | O_CREAT | O_NOFOLLOW | O_CLOEXEC, kMode)) {
        if (isOpen() && !prepare(kept)) ::close(std::exchange(descriptor_, -1));
    }
    ~OutputFile() {
        if (isOpen()) ::close(descriptor_);
    }
    OutputFile(const OutputFile&) = delete;
    OutputFile& operator=(const OutputFile&) = delete;

    bool isOpen() const { return descriptor_ >= 0; }

    bool write(const char* bytes, std::size_t size) {
        while (size > 0) {
            const ssize_t written = ::write(descriptor_, bytes, size);
            if (written < 0 && errno == EINTR) continue;
            if (written <= 0) return false;
            bytes += written;
            size -= static_cast<std::size_t>(written);
        }
        return true;
    }

    // False when the file system reports a failed write only on closing.
    bool close() { return ::close(std::exchange(descriptor_, -1)) == 0; }

  private:
    static constexpr mode_t kMode = S_IRUSR | S_IWUSR;

    // Looks before it changes anything: on a journaling file system a change of the mode costs ten
    // times as much as a look, and there is seldom one to make.
    bool prepare(const FileIdentity& kept) const {
        struct stat status {};
        if (::fstat(descriptor_, &status) != 0 || identityOf(status) == kept) return false;
        if ((status.st_mode & kMode) != kMode && ::fchmod(descriptor_, kMode) != 0) return false;
        return status.st_size == 0 || ::ftruncate(descriptor_, 0) == 0;
    }

    int descriptor_;
};

// The contents that an archive claims. Entries never unpack to more bytes than they claim.
struct Claims {
    std::uint64_t entries = 0;
    std::uint64_t bytes = 0;   // saturates
    std::uint64_t toRead = 0;  // bytes of the entries that are named like parts that are read
};

// Whether programs give such a name to the parts of a workbook that the library reads. Others,
// pictures and pivot caches for example, are only unpacked. A wrong guess makes progress uneven.
bool isNameOfReadPart(const char* name) {
    constexpr const char* kWordsOfNames[] = {"sheet", "sharedStrings", "styles", "workbook"};
    return std::any_of(std::begin(kWordsOfNames), std::end(kWordsOfNames),
                       [name](const char* word) { return ::strcasestr(name, word) != nullptr; });
}

// The sum over the entries before the first damaged one; stops when there are too many.
Claims claimsOf(unzFile archive) {
    Claims claims;
    for (int result = unzGoToFirstFile(archive); result == UNZ_OK;
         result = unzGoToNextFile(archive)) {
        unz_file_info64 info{};
        std::array<char, kLongestName + 1> name{};
        if (unzGetCurrentFileInfo64(archive, &info, name.data(), kLongestName, nullptr, 0, nullptr,
                                    0) != UNZ_OK)
            break;
        const std::uint64_t room = std::numeric_limits<std::uint64_t>::max() - claims.bytes;
        const auto bytes = std::min<std::uint64_t>(info.uncompressed_size, room);
        claims.bytes += bytes;
        if (isNameOfReadPart(name.data())) claims.toRead += bytes;
        if (++claims.entries > kPackageEntries) break;
    }
    return claims;
}

bool exceedsLimits(const Claims& claims, std::uint64_t packageSize, std::uint64_t space) {
    return claims.entries > kPackageEntries || claims.bytes > space ||
           claims.bytes > kUnpackedAllowance + kUnpackedGrowth * packageSize;
}

class Unpacking {
  public:
    Unpacking(unzFile archive, const std::string& archivePath, const std::string& directory)
        : archive_(archive), reader_(archive), archivePath_(archivePath), directory_(directory) {}

    PackageStatus run() {
        const std::uint64_t space = freeSpace(directory_);
        spareSpace_ = space / kSpareSpaceDivisor;
        struct stat status {};
        if (::stat(archivePath_.c_str(), &status) != 0) return PackageStatus::TooLarge;
        const Claims claims = claimsOf(archive_);
        if (exceedsLimits(claims, static_cast<std::uint64_t>(status.st_size), space - spareSpace_))
            return PackageStatus::TooLarge;
        Progress::expect(claims.bytes, claims.toRead);
        package_ = identityOf(status);
        const int result = unpackEntries();
        if (spaceIsShort_) return PackageStatus::TooLarge;
        return result == UNZ_END_OF_LIST_OF_FILE ? PackageStatus::Success
                                                 : PackageStatus::EntryError;
    }

  private:
    int unpackEntries() {
        int result = unzGoToFirstFile(archive_);
        while (result == UNZ_OK) {
            result = unpackEntry();
            if (result == UNZ_OK) result = unzGoToNextFile(archive_);
        }
        return result;
    }

    int unpackEntry() {
        count(0);  // an entry takes its time even when it is empty
        std::array<char, kLongestName + 1> name{};
        const int result = unzGetCurrentFileInfo64(archive_, nullptr, name.data(), kLongestName,
                                                   nullptr, 0, nullptr, 0);
        if (result != UNZ_OK) return result;
        EntryName entry;
        if (!parseEntryName(name.data(), entry)) return kEntryFailed;
        if (!makeDirectories(entry.directory)) return kEntryFailed;
        if (entry.file.empty()) return UNZ_OK;
        return unpackFile((fs::path(directory_) / entry.directory / entry.file).string());
    }

    // Makes the directories that lead to `relative`; true when all of them exist afterwards. Links
    // are not followed: the library makes none, so somebody else must have put them into the
    // private directory.
    bool makeDirectories(const std::string& relative) {
        if (relative == known_) return true;
        fs::path path = directory_;
        for (const fs::path& component : fs::path(relative)) {
            path /= component;
            if (makeOwnDirectory(path.string())) continue;
            boost::system::error_code error;
            const fs::file_type type = fs::symlink_status(path, error).type();
            if (type == fs::symlink_file || type == fs::status_error || type == fs::file_not_found)
                return false;
        }
        known_ = relative;
        return true;
    }

    int unpackFile(const std::string& path) {
        int result = reader_.open();
        if (result != UNZ_OK) return result;
        result = copyCurrentFile(path);
        const int closed = reader_.close();
        return result != UNZ_OK ? result : closed;
    }

    // The last read result: 0 at the entry's end, negative on an error.
    int copyCurrentFile(const std::string& path) {
        OutputFile file(path, package_);
        if (!file.isOpen()) return kEntryFailed;
        int size = 0;
        while ((size = reader_.read(buffer_.data(), buffer_.size())) > 0) {
            const auto bytes = static_cast<std::size_t>(size);
            if (!hasSpaceFor(size) || !file.write(buffer_.data(), bytes)) return kEntryFailed;
            count(bytes);
        }
        if (!file.close()) return kEntryFailed;
        return size;
    }

    static void count(std::size_t bytes) {
        Progress::countUnpacked(bytes);
        Progress::tell();
    }

    // Asked again and again, because other processes write to the same file system.
    bool hasSpaceFor(int size) {
        unchecked_ += static_cast<std::uint64_t>(size);
        if (unchecked_ < kSpaceCheckInterval) return true;
        unchecked_ = 0;
        spaceIsShort_ = freeSpace(directory_) < spareSpace_;
        return !spaceIsShort_;
    }

    unzFile archive_;
    EntryReader reader_;
    std::array<char, kBufferSize> buffer_;
    const std::string& archivePath_;
    const std::string& directory_;
    FileIdentity package_;          // which no entry replaces
    std::string known_;             // the directory that was made or looked at last
    std::uint64_t spareSpace_ = 0;  // bytes
    std::uint64_t unchecked_ = 0;   // bytes written since the last check of the free space
    bool spaceIsShort_ = false;
};

}  // namespace

PackageStatus unpackArchive(const std::string& archivePath, const std::string& directory) {
    Archive archive(archivePath);
    if (!archive.handle()) return PackageStatus::NotAPackage;
    const PackageStatus status = Unpacking(archive.handle(), archivePath, directory).run();
    const bool closed = archive.close() == UNZ_OK;
    return status == PackageStatus::Success && !closed ? PackageStatus::ArchiveNotClosed : status;
}

}  // namespace dp
