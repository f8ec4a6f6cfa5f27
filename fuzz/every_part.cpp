// every_part BOOK.xlsx...: reads every worksheet and shared-string part of the workbooks both ways,
// by the reader of plain parts and by libxml2's, several times with windows of other sizes. Prints
// which parts are not plain and how many are.

#include <array>
#include <cstddef>
#include <cstdio>
#include <memory>
#include <regex>
#include <string>

#include <minizip/unzip.h>

#include "dpxlsx/provider/entry_reader.h"
#include "fuzz/both_ways.h"
#include "fuzz/checks.h"
#include "testkit/workspace.h"

namespace {

struct CloseArchive {
    void operator()(void* archive) const { unzClose(archive); }
};

int parts = 0;
int plainParts = 0;

std::string contentOf(dp::EntryReader& entry) {
    std::string content;
    std::array<char, 1 << 16> bytes;
    fuzz::require(entry.open() == UNZ_OK, "an entry that does not open");
    int size = 0;
    while ((size = entry.read(bytes.data(), bytes.size())) > 0)
        content.append(bytes.data(), static_cast<std::size_t>(size));
    fuzz::require(entry.close() == UNZ_OK && size == 0, "a damaged entry");
    return content;
}

void readPart(const std::string& book, const std::string& name, const std::string& content) {
    static const std::string path = fuzz::ownFiles() + "/part.xml";
    testkit::writeFile(path, content);
    const bool strings = name.find("worksheets/") == name.npos;
    const bool plain = fuzz::readBothWays(strings, path, {});
    for (const std::size_t step : {1U, 2U, 3U, 101U, 255U})
        fuzz::require(
            fuzz::readBothWays(strings, path, fuzz::windowOf(step, content.size())) == plain,
            "plain in other steps only");
    if (!plain) std::printf("%s: %s is not plain\n", book.c_str(), name.c_str());
    ++parts;
    plainParts += plain;
}

void readBook(const std::string& book) {
    const std::unique_ptr<void, CloseArchive> archive(unzOpen64(book.c_str()));
    if (!archive) return;
    const std::regex read("(.*/)?(worksheets/[^/]+|sharedStrings)\\.xml", std::regex::icase);
    dp::EntryReader entry(archive.get());
    std::array<char, 4096> name{};
    for (int more = unzGoToFirstFile(archive.get()); more == UNZ_OK;
         more = unzGoToNextFile(archive.get())) {
        unzGetCurrentFileInfo64(archive.get(), nullptr, name.data(), name.size() - 1, nullptr, 0,
                                nullptr, 0);
        if (std::regex_match(name.data(), read)) readPart(book, name.data(), contentOf(entry));
    }
}

}  // namespace

int main(int argc, char** argv) {
    for (int i = 1; i < argc; ++i) readBook(argv[i]);
    std::printf("%d parts, %d of them plain\n", parts, plainParts);
    return parts > 0 ? 0 : 1;
}
