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
#include "dpxlsx/readers/xlsx/excel_xlsx_reader.h"
#include "fuzz/checks.h"
#include "fuzz/host.h"
#include "fuzz/input.h"
#include "testkit/package_builder.h"
#include "testkit/providers.h"
#include "testkit/workspace.h"

namespace {

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

void readPackage(const std::string& directory) {
    dp::checkWorkbook(directory);
    const dp::Reference provider(new testkit::ReadingProvider);
    provider->SetDateTimeVariableFormatHelper(new fuzz::Helper);
    try {
        provider->read(std::make_unique<dp::ExcelXLSXReader>(
            directory, true, dp::GetShortDateMask(), provider->GetMissingVxlValue(), provider.get(),
            provider->GetDateTimeVariableFormatHelper()));
    } catch (const CmXmlException& e) {
        fuzz::require(e.code() == kXmlError, "another code");
    }
    fuzz::takeEverything(*provider);
    provider->CloseFile();
    std::vector<std::string> names;
    try {
        dp::excel_xlsx::GetWorksheets(directory, names);
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
    fuzz::leavingNothing([] { readPackage(package.directory()); });
    return 0;
}
