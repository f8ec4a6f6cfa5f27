// One part of an otherwise valid package, in the directory of an unpacked package. The first byte
// selects the part, the others are its content.

#include <cstdint>
#include <iterator>
#include <memory>
#include <string>
#include <vector>

#include "dpxlsx/formats/format_codes.h"
#include "dpxlsx/model/host/reference.h"
#include "dpxlsx/provider/package.h"
#include "dpxlsx/readers/standard/standard_reader.h"
#include "dpxlsx/readers/xlsx/excel_xlsx_reader.h"
#include "fuzz/checks.h"
#include "fuzz/host.h"
#include "fuzz/input.h"
#include "testkit/package_builder.h"
#include "testkit/providers.h"
#include "testkit/workspace.h"

namespace {

using dp::ReadingRules;

constexpr const char* kParts[] = {"xl/workbook.xml", "xl/_rels/workbook.xml.rels",
                                  "xl/sharedStrings.xml", "xl/styles.xml",
                                  "xl/worksheets/sheet1.xml"};

// The directory of the package. Before a part is replaced, the one replaced before is restored.
class Package {
  public:
    Package() { testkit::PackageBuilder::small().unpackTo(directory_); }
    void set(const std::string& name, const std::string& content) {
        for (const auto& [sound, soundContent] : testkit::PackageBuilder::small().parts)
            if (sound == different_) testkit::writeFile(directory_ + "/" + sound, soundContent);
        different_ = name;
        testkit::writeFile(directory_ + "/" + name, content);
    }
    const std::string& directory() const { return directory_; }

  private:
    std::string directory_ = fuzz::ownFiles();
    std::string different_;
};

std::unique_ptr<dp::ExcelXLSXReader> readerOf(const std::string& directory, ReadingRules rules,
                                              testkit::ReadingProvider& provider) {
    const double missing = provider.GetMissingVxlValue();
    dp::IDateTimeVariableFormat* const helper = provider.GetDateTimeVariableFormatHelper();
    if (rules == ReadingRules::Standard)
        return std::make_unique<dp::StandardReader>(directory, dp::GetShortDateMask(), missing,
                                                    &provider, helper);
    return std::make_unique<dp::ExcelXLSXReader>(directory, true, dp::GetShortDateMask(), missing,
                                                 &provider, helper);
}

void list(const std::string& directory, ReadingRules rules) {
    std::vector<std::string> names;
    if (rules == ReadingRules::Standard)
        dp::standard::listWorksheets(directory, names);
    else
        dp::excel_xlsx::GetWorksheets(directory, names);
}

void readPackage(const std::string& directory, ReadingRules rules) {
    dp::checkWorkbook(directory, rules);
    const dp::Reference provider(new testkit::ReadingProvider);
    provider->SetDateTimeVariableFormatHelper(new fuzz::Helper);
    try {
        provider->read(readerOf(directory, rules, *provider));
    } catch (const CmXmlException& e) {
        fuzz::require(e.code() == kXmlError, "another code");
    }
    fuzz::takeEverything(*provider);
    provider->CloseFile();
    try {
        list(directory, rules);
    } catch (const CmXmlException& e) {
        fuzz::require(e.code() == kXmlError, "another code");
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static Package package;
    fuzz::Input input(data, size);
    const char* part = kParts[input.byte() % std::size(kParts)];
    package.set(part, input.rest());
    for (const ReadingRules rules : {ReadingRules::Default, ReadingRules::Standard})
        fuzz::leavingNothing([rules] { readPackage(package.directory(), rules); });
    return 0;
}
