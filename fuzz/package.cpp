// Packages, opened through the entry points as a host does. If the first byte is odd, the input is
// the file itself. Otherwise it describes entries of a package, which replace parts of a small
// valid workbook, so that reading gets beyond the ZIP archive. Half the first byte is the number of
// the report at which the host ends the work.

#include <algorithm>
#include <cstdint>
#include <iterator>
#include <string>
#include <vector>

#include <boost/filesystem.hpp>

#include "fuzz/checks.h"
#include "fuzz/input.h"
#include "fuzz/opening.h"
#include "testkit/package_builder.h"
#include "testkit/workspace.h"
#include "testkit/zip_writer.h"

namespace {

using fuzz::Input;
using fuzz::require;

constexpr const char* kNames[] = {"xl/workbook.xml",
                                  "xl/_rels/workbook.xml.rels",
                                  "xl/sharedStrings.xml",
                                  "xl/styles.xml",
                                  "xl/worksheets/sheet1.xml",
                                  "xl/worksheets/sheet2.xml",
                                  "[Content_Types].xml",
                                  "xl/",
                                  "xl/worksheets",
                                  "xl/styles.xml/x",
                                  "../escaped",
                                  "/escaped",
                                  "C:escaped",
                                  "book.xlsx",
                                  "./xl//./workbook.xml",
                                  "xl\\styles.xml",
                                  "XL/STYLES.XML",
                                  ""};

// Bits of the byte before an entry's content.
enum EntryBit : unsigned { kStored = 1, kWrongSum = 2, kClaimed = 4, kRepeated = 8, kMany = 16 };

std::string nameOf(Input& input) {
    const unsigned which = input.byte();
    return which < std::size(kNames) ? kNames[which] : input.text();
}

std::string repeated(const std::string& text, unsigned times) {
    constexpr std::size_t kLargest = 1 << 20;  // bytes
    std::string all;
    for (; times > 0 && all.size() + text.size() <= kLargest; --times) all += text;
    return all;
}

// Adds the entries that the input describes, in their order; with kMany up to 1,023 more copies of
// an entry, each with a name of its own.
void addEntries(Input& input, testkit::ZipWriter& archive, std::vector<std::string>& names) {
    for (unsigned left = 1 + input.byte() % 16; left > 0 && !input.empty(); --left) {
        testkit::ZipWriter::Entry entry;
        entry.name = nameOf(input);
        const unsigned bits = input.byte();
        entry.deflated = (bits & kStored) == 0;
        entry.wrongSum = (bits & kWrongSum) != 0;
        if (bits & kClaimed) entry.claimedSize = input.index();
        const unsigned times = bits & kRepeated ? input.word() : 1;
        entry.content = repeated(input.take(input.word()), times);
        archive.add(entry);
        names.push_back(entry.name);
        entry.content.clear();
        const std::string stem = entry.name;
        for (unsigned more = bits & kMany ? input.word() / 64 : 0; more > 0; --more) {
            entry.name = stem + std::to_string(more);
            archive.add(entry);
        }
    }
}

void overwrite(std::string& bytes, Input& input) {
    for (unsigned left = input.byte() % 8; left > 0 && !bytes.empty(); --left) {
        const std::size_t at = (input.word() | input.byte() << 16) % bytes.size();
        bytes[at] = static_cast<char>(input.byte());
    }
    if (input.flag())
        bytes.resize(bytes.size() - std::min<std::size_t>(bytes.size(), input.word()));
}

std::string packageOf(Input input) {
    if (input.flag()) return input.rest();
    testkit::ZipWriter archive;
    std::vector<std::string> names;
    addEntries(input, archive, names);
    for (const auto& [name, content] : testkit::PackageBuilder::small().parts)
        if (std::find(names.begin(), names.end(), name) == names.end())
            archive.add({name, content});
    std::string bytes = archive.finished();
    overwrite(bytes, input);
    return bytes + input.rest();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static const std::string path = fuzz::ownFiles() + "/book.xlsx";
    testkit::writeFile(path, packageOf(Input(data, size)));
    const unsigned last = Input(data, size).byte() / 2;
    fuzz::leavingNothing([last] { fuzz::openAsHost(path, last); });
    const boost::filesystem::directory_iterator files(fuzz::ownFiles());
    require(std::distance(begin(files), end(files)) == 1, "a file beside the workbook");
    return 0;
}
