// every_byte [STRIDE]: a small workbook, cut before every byte, and with every byte set to 0x00 and
// 0xFF and with its top bit flipped; of every STRIDE bytes one. Each is opened as a host does it
// and must leave nothing behind. In between, the sound workbook opens as before.

#include <malloc.h>

#include <cstdio>
#include <cstdlib>
#include <map>
#include <string>

#include "fuzz/checks.h"
#include "fuzz/opening.h"
#include "fuzz/parts.h"
#include "fuzz/zip_writer.h"

namespace {

std::map<long, int> results;

long open(const std::string& bytes) {
    static const std::string path = fuzz::ownFiles() + "/book.xlsx";
    fuzz::writeFile(path, bytes);
    long result = 0;
    fuzz::leavingNothing([&] { result = fuzz::openAsHost(path); });
    ++results[result];
    return result;
}

using Parts = std::map<std::string, std::string>;

std::string packageOf(const Parts& parts) {
    fuzz::ZipWriter archive;
    for (const auto& [name, content] : parts) archive.add({name, content});
    return archive.finished();
}

// Calls `use` with every spoilt form of `bytes`.
template <class Use>
void spoil(const std::string& bytes, std::size_t stride, Use use) {
    const std::string sound = packageOf(fuzz::soundParts());
    for (std::size_t at = 0; at < bytes.size(); at += stride) {
        use(bytes.substr(0, at));
        for (const char other : {'\0', '\xFF', static_cast<char>(bytes[at] ^ 0x80)}) {
            std::string spoilt = bytes;
            spoilt[at] = other;
            use(spoilt);
        }
        if (at % 64 == 0) fuzz::require(open(sound) == 0, "the sound workbook does not open");
    }
}

// Opens the sound workbook again and again; memory must stay as it was.
void openOften() {
    constexpr int kTimes = 300;
    constexpr std::size_t kBytes = 4096;  // in which nothing adds up
    const std::string sound = packageOf(fuzz::soundParts());
    open(sound);
    const std::size_t before = ::mallinfo2().uordblks;
    for (int i = 0; i < kTimes; ++i) open(sound);
    fuzz::require(::mallinfo2().uordblks < before + kBytes, "memory grows from open to open");
}

}  // namespace

int main(int argc, char** argv) {
    const int given = argc > 1 ? std::atoi(argv[1]) : 1;
    const auto stride = static_cast<std::size_t>(given > 0 ? given : 1);
    spoil(packageOf(fuzz::soundParts()), stride, open);
    for (const auto& [name, content] : fuzz::soundParts())
        spoil(content, stride, [&name = name](const std::string& spoilt) {
            Parts parts = fuzz::soundParts();
            parts[name] = spoilt;
            open(packageOf(parts));
        });
    openOften();
    for (const auto& [result, count] : results) std::printf("%4ld: %d\n", result, count);
    return 0;
}
