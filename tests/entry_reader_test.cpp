#include "dpxlsx/provider/entry_reader.h"

#include <cstddef>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include <gtest/gtest.h>
#include <minizip/unzip.h>

#include "testkit/workspace.h"
#include "testkit/zip_writer.h"

namespace {

struct CloseArchive {
    void operator()(void* archive) const { unzClose(archive); }
};

// What minizip does itself, with zlib.
class MinizipEntry {
  public:
    explicit MinizipEntry(unzFile archive) : archive_(archive) {}
    int open() { return unzOpenCurrentFile(archive_); }
    int read(char* bytes, std::size_t size) { return unzReadCurrentFile(archive_, bytes, static_cast<unsigned>(size)); }
    int close() { return unzCloseCurrentFile(archive_); }

  private:
    unzFile archive_;
};

// The content of every entry or the error that ends it, a line each.
template <class Entry>
std::string contentOf(const std::string& path) {
    const std::unique_ptr<void, CloseArchive> archive(unzOpen64(path.c_str()));
    if (!archive) return "no archive";
    std::string all;
    std::vector<char> bytes(1000);
    Entry entry(archive.get());
    for (int more = unzGoToFirstFile(archive.get()); more == UNZ_OK; more = unzGoToNextFile(archive.get())) {
        int result = entry.open();
        std::string content;
        if (result == UNZ_OK) {
            while ((result = entry.read(bytes.data(), bytes.size())) > 0)
                content.append(bytes.data(), static_cast<std::size_t>(result));
            const int closed = entry.close();
            if (result == 0) result = closed;
        }
        all += result == UNZ_OK ? content.substr(0, 9) + '#' + std::to_string(std::hash<std::string>{}(content))
                                : std::to_string(result);
        all += '\n';
    }
    return all;
}

std::string archiveOfAllKinds() {
    std::string mixed;
    for (int i = 0; i < 400; ++i) mixed += static_cast<char>('a' + i * i % 23);
    testkit::ZipWriter archive;
    archive.add({"fixed codes", "abc"});
    archive.add({"own codes", mixed});
    archive.add({"stored", "as it is", false});
    archive.add({"empty", ""});
    archive.add({"repeated", std::string(3000, 'x')});
    archive.add({"wrong sum", "abc", true, true});
    archive.add({"more than it holds", "abc", true, false, 90});
    archive.add({"less than it holds", mixed, true, false, 90});
    archive.add({"stored, wrong sum", "as it is", false, true});
    archive.add({"of a method that minizip does not check", "abc", false, true, 0, 0, 12});
    // "abc" in fixed codes, and three bytes from a place in front of them.
    constexpr std::uint32_t kSumOfAbc = 0x352441C2;
    archive.add({"damaged behind what it holds", "KLJ\x06\x12zz", false, false, 3, kSumOfAbc, Z_DEFLATED});
    return archive.finished();
}

// Entries are inflated by another library than minizip's where there is one.
TEST(EntryReader, AnswersAsMinizipDoesToEveryDamage) {
    const testkit::Workspace workspace(testkit::Workspace::Place::Memory);
    const std::string whole = archiveOfAllKinds();
    const std::string path = workspace.write("whole.zip", whole);
    const std::string wholeContent = contentOf<MinizipEntry>(path);
    EXPECT_EQ(contentOf<dp::EntryReader>(path), wholeContent);
    std::size_t changed = 0;
    for (std::size_t at = 0; at < whole.size() && !HasFailure(); ++at)
        for (const int change : {0x01, 0x06, 0x80, 0xFF}) {
            std::string bytes = whole;
            bytes[at] = static_cast<char>(bytes[at] ^ change);
            const std::string damaged = workspace.write("damaged.zip", bytes);
            const std::string wanted = contentOf<MinizipEntry>(damaged);
            EXPECT_EQ(contentOf<dp::EntryReader>(damaged), wanted) << at << " with " << change;
            changed += wanted != wholeContent;
        }
    EXPECT_GT(changed, whole.size());
}

}  // namespace
