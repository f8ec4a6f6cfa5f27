#include "fuzz/opening.h"

#include <algorithm>
#include <iterator>
#include <vector>

#include "dpxlsx/model/host/entry_points.h"
#include "dpxlsx/model/host/reference.h"
#include "dpxlsx/readers/xml/xml_reader.h"
#include "fuzz/checks.h"
#include "fuzz/host.h"

namespace fuzz {

namespace {

bool isResultOfOpening(long result) {
    constexpr long kResults[] = {0, -1, -22, -25};  // the results that a file's content can cause
    return std::find(std::begin(kResults), std::end(kResults), result) != std::end(kResults);
}

long open(const std::string& path, int rules, unsigned end) {
    ProgressWatch progress(end);
    dp::IDataProvider* created = nullptr;
    require(dp::CreateDataProvider("xlsx", &created) == 0, "no provider");
    const dp::Reference provider(created);
    require(dp::SetReadingRules(created, rules) == 0, "no rules");
    progress.watch(*created);
    const auto isAllowed = [&](long result) {
        if (result != dp::kCancelled) return isResultOfOpening(result);
        return progress.hasEnded() && provider->GetTempDirectoryPath().empty();
    };
    provider->SetDateTimeVariableFormatHelper(new Helper);
    std::vector<std::string> names;
    require(isAllowed(provider->GetWorksheets(path.c_str(), names)), "another result");
    long result = 0;
    try {
        result = provider->OpenFile(path.c_str(), dp::IDataProvider::FileAccess::Read);
        require(isAllowed(result), "another result");
    } catch (const CmXmlException& e) {
        require(e.code() == kXmlError, "another code");
        result = e.code();
    }
    takeEverything(*provider);
    provider->CloseFile();
    takeEverything(*provider);
    return result;
}

}  // namespace

long openAsHost(const std::string& path, unsigned end) {
    constexpr int kDefault = 0;
    constexpr int kByStandard = 1;
    open(path, kByStandard, end);
    return open(path, kDefault, end);
}

}  // namespace fuzz
