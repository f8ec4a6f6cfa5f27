#include <cstdio>

#include <nlohmann/json.hpp>

#include "dpxlsx/model/host/entry_points.h"
#include "dpxlsx/readers/xml/xml_reader.h"
#include "testkit/recording_provider.h"

// Prints what an import by the standard makes of a workbook, for the comparison with other readers: the
// result of opening it and the calls that a provider receives, as RecordingProvider words them.
int main(int count, char** arguments) {
    if (count != 2) return 2;
    testkit::RecordingProvider provider;
    constexpr int kStandard = 1;
    if (dp::SetReadingRules(&provider, kStandard) != 0) return 1;
    long result = 0;
    try {
        result = provider.OpenFile(arguments[1], dp::IDataProvider::FileAccess::Read);
    } catch (const CmXmlException& error) {
        result = error.code();
    }
    provider.CloseFile();
    const nlohmann::json printed = {{"result", result}, {"calls", provider.takenCalls()}};
    std::puts(printed.dump(-1, ' ', false, nlohmann::json::error_handler_t::replace).c_str());
    return 0;
}
