// Passes texts of cells, names of entries and references of cells to all functions that check or
// change them.

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <string>

#include "dpxlsx/provider/entry_name.h"
#include "dpxlsx/readers/worksheet_size.h"
#include "dpxlsx/readers/xlsx/cell_reference.h"
#include "dpxlsx/readers/xlsx/excel_xlsx_reader.h"
#include "dpxlsx/readers/xlsx/relationships.h"
#include "dpxlsx/readers/xml/cm_xml_cast.h"
#include "dpxlsx/store/conversion.h"
#include "dpxlsx/store/number_recognition.h"
#include "dpxlsx/store/text_cleaning.h"
#include "fuzz/checks.h"
#include "fuzz/input.h"

namespace {

using fuzz::require;

void recogniseNumbers(const std::string& text, char decimal) {
    constexpr double kMissing = 1.23456e30;
    double value = 0;
    const bool number = dp::recogniseNumber(text, decimal, kMissing, &value);
    require(number || value == kMissing, "no number and not the missing value");
    require(dp::IsNumber(text, decimal, nullptr) == number, "two opinions of a number");
    const auto& cast = CmXmlCast::instance();
    int whole = 0;
    unsigned natural = 0;
    cast.mCast(value, text.c_str());
    require(cast.mCast(whole, text.c_str()) == cast.mCast(natural, text.c_str()),
            "two opinions of an integer");
}

void cleanTexts(const std::string& text, unsigned short length) {
    using Cleaning = void (*)(std::string&);
    for (const Cleaning clean :
         {Cleaning{dp::trim}, Cleaning{dp::ltrim}, Cleaning{dp::CleanText},
          Cleaning{dp::CleanWorksheetName}, Cleaning{dp::ExcelXLSXReader::mParseCharString}}) {
        std::string cleaned = text;
        clean(cleaned);
        require(cleaned.size() <= text.size(), "cleaned to a longer text");
    }
    std::string cut = text;
    dp::truncateToCharLength(cut, length);
    require(text.starts_with(cut), "cut to another text");
    dp::cutToBytes(cut, length);
    require(text.starts_with(cut), "cut to another text");
    std::string name = text;
    dp::cleanVariableName(name, length);
    require(name.size() <= text.size(), "a name longer than its text");
    const auto spaces = static_cast<std::size_t>(std::count(text.begin(), text.end(), ' '));
    require(dp::isAllSpaces(text) == (spaces == text.size()), "two opinions of spaces");
}

bool climbs(const std::string& path) { return ("/" + path + "/").find("/../") != path.npos; }

void findPlaces(const std::string& text) {
    dp::EntryName entry;
    if (dp::parseEntryName(text, entry))
        require(!climbs(entry.directory) && !entry.directory.starts_with('/') &&
                    entry.file.find('/') == entry.file.npos && entry.file != "..",
                "an entry outside");
    try {
        const std::string path = dp::resolveTarget("/dir", text);
        require(path.starts_with("/dir") && !climbs(path), "a target outside");
    } catch (const CmXmlException&) {
    }
    dp::CellPlace place;
    try {
        int row = 0;
        if (CmXmlCast::instance().mCast(row, text.c_str())) place.beginRow(&row);
        place.beginCell(text.c_str());
        place.beginCell(nullptr);
    } catch (const CmXmlException& e) {
        require(e.code() == kXmlError, "another code");
    }
    require(place.row() <= dp::kWorksheetRows && place.column() <= dp::kWorksheetColumns,
            "a cell far outside");
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    fuzz::Input input(data, size);
    const char decimal = input.flag() ? ',' : '.';
    const auto length = static_cast<unsigned short>(input.byte());
    const std::string text = input.rest();
    fuzz::leavingNothing([&] {
        recogniseNumbers(text, decimal);
        cleanTexts(text, length);
        findPlaces(text);
    });
    return 0;
}
