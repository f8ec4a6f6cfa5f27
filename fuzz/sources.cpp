// A worksheet or shared-string part read both ways: by the reader of plain parts and by libxml2's.
// The first byte chooses the part and the window, the second how many bytes are read at a time.

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <iterator>
#include <random>
#include <string>
#include <string_view>

#include "fuzz/both_ways.h"
#include "fuzz/checks.h"
#include "fuzz/input.h"
#include "testkit/workspace.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static const std::string path = fuzz::ownFiles() + "/part.xml";
    fuzz::Input input(data, size);
    const unsigned kind = input.byte();
    const unsigned step = input.byte();
    const std::string part = input.rest();
    testkit::writeFile(path, part);
    dp::ReadingWindow window = fuzz::windowOf(step, part.size());
    if (kind > 1) window.size = 8 * std::size_t{kind / 2};
    fuzz::readBothWays((kind & 1) != 0, path, window);
    return 0;
}

// --- Mutations that leave a part nearly plain ---

// Of the fuzzer, where there is one.
extern "C" [[gnu::weak]] std::size_t LLVMFuzzerMutate(std::uint8_t* data, std::size_t size,
                                                      std::size_t largest);

namespace {

constexpr std::size_t kHead = 2;  // the bytes before the part

const char* const kPieces[] = {"&lt;",
                               "&amp;",
                               "&gt;",
                               "&quot;",
                               "&apos;",
                               "&#10;",
                               "&#13;",
                               "&#x9;",
                               "&#32;",
                               "&#65;",
                               "&#x10FFFF;",
                               "&#xFFFE;",
                               "&#0;",
                               "&#xD800;",
                               "&#x110000;",
                               "&#;",
                               "&#x;",
                               "&;",
                               "&amp",
                               "&lt",
                               "&#99999999999;",
                               "&#000000000000065;",
                               "\r\n",
                               "\r",
                               "\n",
                               "\t",
                               " ",
                               "]]>",
                               "]]",
                               "]",
                               "<",
                               ">",
                               "&",
                               "\"",
                               "'",
                               "=",
                               "/>",
                               "<!-- -->",
                               "<![CDATA[x]]>",
                               "<?p i?>",
                               "<!DOCTYPE a>",
                               "\xEF\xBB\xBF",
                               "\xC3\xA9",
                               "\xE2\x82\xAC",
                               "\xF0\x9F\x98\x80",
                               "\xED\xA0\x80",
                               "\xC0\x80",
                               "\xEF\xBF\xBE",
                               "\xF4\x90\x80\x80",
                               "\x80",
                               "\x01",
                               "\x7F",
                               "<v>1</v>",
                               "<v/>",
                               "<v></v>",
                               "<v> </v>",
                               "<v><x/>1</v>",
                               "<t>x</t>",
                               "<t xml:space=\"preserve\"> </t>",
                               " xml:space=\"default\"",
                               " xml:lang=\"x\"",
                               " xml:id=\"1\"",
                               " r=\"B2\"",
                               " r='XFD1048576'",
                               " t=\"s\"",
                               " t=\"str\"",
                               " t=\"inlineStr\"",
                               " t=\"e\"",
                               " t='b'",
                               " s=\"1\"",
                               " s=\" 2\"",
                               " a=\"1\" a=\"2\"",
                               " xmlns:x=\"urn:x\"",
                               " xmlns=\"urn:y\"",
                               " x:r=\"C3\"",
                               " xmlns:x=\"\"",
                               "<x:v>1</x:v>",
                               "<x:c xmlns:x=\"u\">",
                               "<xmlns:t> </xmlns:t>",
                               "<xml:t> </xml:t>",
                               "</x:c>",
                               "<row>",
                               "</row>",
                               "<c>",
                               "</c>",
                               "<row/>",
                               "<c r=\"A1\"><v>1</v></c>",
                               "<c r=\"B2\" s=\"1\" t=\"s\"><v>1</v></c>",
                               "<si><t>x</t></si>",
                               "<si/>",
                               "</sst>",
                               "<rPh><t>y</t></rPh>",
                               "_x000A_",
                               "_x005F_",
                               "1e400",
                               "-0",
                               "0x10",
                               "1 2",
                               "<?xml version=\"1.0\" encoding=\"UTF-8\" standalone=\"yes\"?>",
                               "encoding='latin1'"};

std::size_t insert(std::string& part, std::mt19937& random, std::string_view piece) {
    const std::size_t place = random() % (part.size() + 1);
    part.insert(place, piece);
    return place;
}

// The place of one of `characters` at or behind a random one, or of none.
std::size_t find(const std::string& part, std::mt19937& random, const char* characters) {
    return part.empty() ? part.npos : part.find_first_of(characters, random() % part.size());
}

void change(std::string& part, std::mt19937& random) {
    const std::string_view piece = kPieces[random() % std::size(kPieces)];
    switch (random() % 8) {
        case 0:
            insert(part, random, piece);
            break;
        case 1:  // behind a tag or a name, where markup goes
            if (const std::size_t place = find(part, random, "<> "); place != part.npos)
                part.insert(place + random() % 2, piece);
            break;
        case 2:
            if (const std::size_t place = find(part, random, "\"'"); place != part.npos)
                part[place] = part[place] == '"' ? '\'' : '"';
            break;
        case 3:  // cut
            part.resize(part.size() - random() % (part.size() / 4 + 1));
            break;
        case 4:
            if (!part.empty()) part.erase(random() % part.size(), 1 + random() % 8);
            break;
        case 5:  // repeat a stretch
            if (!part.empty()) {
                const std::size_t from = random() % part.size();
                insert(part, random, std::string(part, from, random() % 64));
            }
            break;
        case 6:
            if (const std::size_t place = find(part, random, "<"); place != part.npos)
                part.insert(place + 1, std::string(1 + random() % 9000, "ax:_-."[random() % 6]));
            break;
        default:  // white space of many lengths, up to beyond a window
            insert(part, random,
                   std::string(std::size_t{1} << random() % 9, " \n\r\t"[random() % 4]));
            break;
    }
}

}  // namespace

extern "C" std::size_t LLVMFuzzerCustomMutator(std::uint8_t* data, std::size_t size,
                                               std::size_t largest, unsigned seed) {
    std::mt19937 random(seed);
    if (size < kHead || random() % 4 == 0) return LLVMFuzzerMutate(data, size, largest);
    std::string part(reinterpret_cast<const char*>(data) + kHead, size - kHead);
    for (unsigned i = 0; i <= random() % 3; ++i) change(part, random);
    if (random() % 8 == 0) data[0] = static_cast<std::uint8_t>(random());
    if (random() % 8 == 0) data[0] &= 1;  // the window that the library has
    if (random() % 4 == 0) data[1] = static_cast<std::uint8_t>(random() % 16);
    part.resize(std::min(part.size(), largest - kHead));
    std::memcpy(data + kHead, part.data(), part.size());
    return kHead + part.size();
}
