// XML Spreadsheet 2003 documents.

#include <cstdint>
#include <memory>
#include <stdexcept>
#include <string>

#include <boost/lexical_cast.hpp>

#include "dpxlsx/formats/format_codes.h"
#include "dpxlsx/model/host/reference.h"
#include "fuzz/checks.h"
#include "fuzz/host.h"
#include "testkit/providers.h"
#include "testkit/workspace.h"

namespace {

void readDocument(const std::string& path) {
    const dp::Reference provider(new testkit::ReadingProvider);
    provider->SetDateTimeVariableFormatHelper(new fuzz::Helper);
    try {
        provider->read(std::make_unique<dp::ExcelXmlReader>(
            path, dp::GetShortDateMask(), provider->GetMissingVxlValue(), provider.get(),
            provider->GetDateTimeVariableFormatHelper()));
    } catch (const CmXmlException& e) {
        fuzz::require(e.code() == kXmlError, "another code");
    } catch (const std::out_of_range&) {  // both for texts that are not date-times
    } catch (const boost::bad_lexical_cast&) {
    }
    fuzz::takeEverything(*provider);
    provider->CloseFile();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static const std::string path = fuzz::ownFiles() + "/book.xml";
    testkit::writeFile(path, {reinterpret_cast<const char*>(data), size});
    fuzz::leavingNothing([] { readDocument(path); });
    return 0;
}
