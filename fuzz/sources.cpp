// A worksheet or shared-string part read both ways: by the reader of plain parts and by libxml2's.
// The first byte chooses the part and the second how many bytes are read at a time.

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <iterator>
#include <memory>
#include <random>
#include <string>
#include <string_view>
#include <vector>

#include "dpxlsx/formats/format_codes.h"
#include "dpxlsx/model/host/reference.h"
#include "dpxlsx/readers/xlsx/any_shared_strings.h"
#include "dpxlsx/readers/xlsx/any_worksheet.h"
#include "dpxlsx/readers/xlsx/cell_assembler.h"
#include "dpxlsx/readers/xlsx/excel_xlsx_reader.h"
#include "dpxlsx/readers/xlsx/plain_shared_strings.h"
#include "dpxlsx/readers/xlsx/plain_worksheet.h"
#include "fuzz/checks.h"
#include "fuzz/input.h"
#include "testkit/package_builder.h"
#include "testkit/recording_provider.h"
#include "testkit/workspace.h"

namespace {

enum class End { Whole, NotPlain, Error };

struct Outcome {
    End end;
    std::vector<std::string> records;
};

// The reader of a sound package, whose shared strings and styles the cells of any worksheet part
// refer to.
class Package {
  public:
    Package() : provider_(new testkit::RecordingProvider) {
        const std::string directory = fuzz::ownFiles() + "/package";
        testkit::PackageBuilder::small().unpackTo(directory);
        reader_ = std::make_unique<dp::ExcelXLSXReader>(directory, true, dp::GetShortDateMask(),
                                                        0.0, provider_.get(), nullptr);
        reader_->mReadExcelWorkbook();
    }

    template <class Read>
    Outcome readWorksheet(const Read& read) {
        provider_->ClearWorksheets();
        provider_->AddWorksheet("S");
        provider_->SetWorksheetIndex(0);
        provider_->takenCalls();
        End end = End::Error;
        try {
            dp::CellAssembler cells(*reader_);
            end = cells.take([&] { return read(cells); }) ? End::Whole : End::NotPlain;
        } catch (const CmXmlException& e) {
            fuzz::require(e.code() == kXmlError, "another code");
        }
        return {end, provider_->takenCalls()};
    }

  private:
    dp::Reference<testkit::RecordingProvider> provider_;
    std::unique_ptr<dp::ExcelXLSXReader> reader_;
};

template <class Read>
Outcome readSharedStrings(const Read& read) {
    End end = End::Error;
    dp::SharedStringTable table;
    try {
        end = read(table) ? End::Whole : End::NotPlain;
    } catch (const CmXmlException& e) {
        fuzz::require(e.code() == kXmlError, "another code");
    }
    Outcome outcome{end, {}};
    for (std::size_t i = 0; i < table.size(); ++i) outcome.records.emplace_back(table[i]);
    return outcome;
}

bool beginsWith(const std::vector<std::string>& longer, const std::vector<std::string>& shorter) {
    return longer.size() >= shorter.size() &&
           std::equal(shorter.begin(), shorter.end(), longer.begin());
}

void compare(const Outcome& plain, const Outcome& any) {
    if (plain.end == End::Whole) fuzz::require(any.end == End::Whole, "plain, but an error");
    if (plain.end == End::Error) fuzz::require(any.end == End::Error, "an error, but sound");
    if (plain.end == End::Whole)
        return fuzz::require(plain.records == any.records, "other records");
    // libxml2 finds errors before it hands out what stands before them.
    fuzz::require(beginsWith(any.records, plain.records) ||
                      (any.end == End::Error && beginsWith(plain.records, any.records)),
                  "another beginning");
}

void readBothWays(bool strings, std::size_t chunk, const std::string& path) {
    static Package package;
    if (strings)
        compare(readSharedStrings(
                    [&](auto& table) { return dp::readPlainSharedStrings(path, table, chunk); }),
                readSharedStrings([&](auto& table) {
                    dp::readAnySharedStrings(path, table);
                    return true;
                }));
    else
        compare(package.readWorksheet(
                    [&](auto& cells) { return dp::readPlainWorksheet(path, cells, chunk); }),
                package.readWorksheet([&](auto& cells) {
                    dp::readAnyWorksheet(path, cells);
                    return true;
                }));
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static const std::string path = fuzz::ownFiles() + "/part.xml";
    fuzz::Input input(data, size);
    const bool strings = input.flag();
    const std::size_t step = input.byte();
    testkit::writeFile(path, input.rest());
    readBothWays(strings, step == 0 ? dp::PlainXml::kWindow : step, path);
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
    if (random() % 4 == 0) data[1] = static_cast<std::uint8_t>(random() % 16);
    part.resize(std::min(part.size(), largest - kHead));
    std::memcpy(data + kHead, part.data(), part.size());
    return kHead + part.size();
}
