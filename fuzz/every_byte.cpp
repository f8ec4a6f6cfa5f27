// every_byte [STRIDE]: opens a small workbook cut before every byte, with every byte set to 0x00
// and to 0xFF, and with every byte's top bit flipped; with STRIDE only one of STRIDE bytes. Each is
// opened as a host does and must leave nothing behind. In between, the undamaged workbook must open
// as before.

#include <cstdio>
#include <cstdlib>
#include <map>
#include <string>

#include "fuzz/checks.h"
#include "fuzz/opening.h"
#include "testkit/allocated_bytes.h"
#include "testkit/package_builder.h"
#include "testkit/workspace.h"

namespace {

using testkit::PackageBuilder;

std::map<long, int> results;

long open(const std::string& bytes) {
    static const std::string path = fuzz::ownFiles() + "/book.xlsx";
    testkit::writeFile(path, bytes);
    long result = 0;
    fuzz::leavingNothing([&] { result = fuzz::openAsHost(path); });
    ++results[result];
    return result;
}

// Calls `use` with every damaged form of `bytes`.
template <class Use>
void damage(const std::string& bytes, std::size_t stride, Use use) {
    const std::string sound = PackageBuilder::small().bytes();
    for (std::size_t at = 0; at < bytes.size(); at += stride) {
        use(bytes.substr(0, at));
        for (const char other : {'\0', '\xFF', static_cast<char>(bytes[at] ^ 0x80)}) {
            std::string damaged = bytes;
            damaged[at] = other;
            use(damaged);
        }
        if (at % 64 == 0) fuzz::require(open(sound) == 0, "the sound workbook does not open");
    }
}

// Opens the undamaged workbook again and again; memory must not grow.
void openOften() {
    constexpr int kTimes = 300;
    constexpr std::size_t kBytes =
        4096;  // of growth that are tolerated: a leak of each open would exceed this
    const std::string sound = PackageBuilder::small().bytes();
    open(sound);
    const std::size_t before = testkit::allocatedBytes();
    for (int i = 0; i < kTimes; ++i) open(sound);
    fuzz::require(testkit::allocatedBytes() < before + kBytes, "memory grows from open to open");
}

}  // namespace

int main(int argc, char** argv) {
    const int given = argc > 1 ? std::atoi(argv[1]) : 1;
    const auto stride = static_cast<std::size_t>(given > 0 ? given : 1);
    const PackageBuilder& sound = PackageBuilder::small();
    damage(sound.bytes(), stride, open);
    for (std::size_t part = 0; part < sound.parts.size(); ++part)
        damage(sound.parts[part].second, stride, [&](const std::string& damaged) {
            PackageBuilder package = sound;
            package.parts[part].second = damaged;
            open(package.bytes());
        });
    openOften();
    for (const auto& [result, count] : results) std::printf("%4ld: %d\n", result, count);
    return 0;
}
