#include "fuzz/both_ways.h"

#include <algorithm>
#include <memory>
#include <string>
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
#include "testkit/package_builder.h"
#include "testkit/recording_provider.h"

namespace fuzz {

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
        const std::string directory = ownFiles() + "/package";
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
            require(e.code() == kXmlError, "another code");
        }
        return {end, provider_->takenCalls()};
    }

  private:
    dp::Reference<testkit::RecordingProvider> provider_;
    std::unique_ptr<dp::ExcelXLSXReader> reader_;
};

Package& package() {
    static Package package;
    return package;
}

template <class Read>
Outcome readSharedStrings(const Read& read) {
    End end = End::Error;
    dp::SharedStringTable table;
    try {
        end = read(table) ? End::Whole : End::NotPlain;
    } catch (const CmXmlException& e) {
        require(e.code() == kXmlError, "another code");
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
    if (plain.end == End::Whole) require(any.end == End::Whole, "plain, but an error");
    if (plain.end == End::Error) require(any.end == End::Error, "an error, but sound");
    if (plain.end == End::Whole) return require(plain.records == any.records, "other records");
    // libxml2 finds errors before it hands out what stands before them.
    require(beginsWith(any.records, plain.records) ||
                (any.end == End::Error && beginsWith(plain.records, any.records)),
            "another beginning");
}

Outcome readPlain(bool strings, const std::string& path, dp::ReadingWindow window) {
    if (strings)
        return readSharedStrings(
            [&](auto& table) { return dp::readPlainSharedStrings(path, table, window); });
    return package().readWorksheet(
        [&](auto& cells) { return dp::readPlainWorksheet(path, cells, window); });
}

Outcome readAny(bool strings, const std::string& path) {
    if (strings)
        return readSharedStrings([&](auto& table) {
            dp::readAnySharedStrings(path, table);
            return true;
        });
    return package().readWorksheet([&](auto& cells) {
        dp::readAnyWorksheet(path, cells);
        return true;
    });
}

}  // namespace

bool readBothWays(bool strings, const std::string& path, dp::ReadingWindow window) {
    const Outcome plain = readPlain(strings, path, window);
    compare(plain, readAny(strings, path));
    return plain.end == End::Whole;
}

dp::ReadingWindow windowOf(std::size_t step, std::size_t partSize) {
    dp::ReadingWindow window;
    if (step > 0) window.step = std::max(step, partSize / 256);
    return window;
}

}  // namespace fuzz
