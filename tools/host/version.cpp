#include "tools/host/version.h"

#include <link.h>

#include <cstdlib>
#include <filesystem>
#include <string_view>

#include <CLI/Version.hpp>
#include <libxml/parser.h>
#include <libxml/xmlversion.h>
#include <nlohmann/json.hpp>
#include <unicode/uversion.h>

#include "tools/host/exit_code.h"
#include "tools/host/library.h"

namespace dp::tool {

namespace {

namespace fs = std::filesystem;

constexpr std::string_view kFromBoost = "libboost_", kIsal = "libisal.", kMinizip = "libminizip.";

// A number such as 20914 for 2.9.14.
std::string dotted(unsigned number) {
    return std::to_string(number / 10000) + "." + std::to_string(number / 100 % 100) + "." +
           std::to_string(number % 100);
}

std::string icuVersion() {
    UVersionInfo version;
    char text[U_MAX_VERSION_STRING_LENGTH];
    u_getVersion(version);
    u_versionToString(version, text);
    return text;
}

std::string filesOf(const Library& library) {
    std::string names;
    for (const std::string& file : library.loadedFiles()) {
        const std::string name = fs::path(file).filename().string();
        const bool silent =
            name.starts_with(kFromBoost) || name.starts_with(kIsal) || name.starts_with(kMinizip);
        if (silent) names += ", " + name;
    }
    return names;
}

std::string ofLibrary(const std::string& path) try {
    const Library library(path);
    const auto zlib = library.function<const char*()>("zlibVersion");
    const auto xxHash = library.function<unsigned()>("XXH_versionNumber");
    return "Import library: " + library.file() + "\nLoaded: libxml2 " +
           dotted(static_cast<unsigned>(std::atoi(xmlParserVersion))) + ", ICU " + icuVersion() +
           (zlib == nullptr ? "" : std::string(", zlib ") + zlib()) +
           (xxHash == nullptr ? "" : ", xxHash " + dotted(xxHash())) + filesOf(library) + "\n";
} catch (const Failure& failure) {
    return std::string("Import library: ") + failure.what() + "\n";
}

std::string compiledIn() {
    return "Compiled in: CLI11 " CLI11_VERSION ", nlohmann-json " +
           std::to_string(NLOHMANN_JSON_VERSION_MAJOR) + "." +
           std::to_string(NLOHMANN_JSON_VERSION_MINOR) + "." +
           std::to_string(NLOHMANN_JSON_VERSION_PATCH) + "\n";
}

}  // namespace

std::string versionText(const std::string& library) {
    return "dpxlsx " DPXLSX_VERSION "\n" + ofLibrary(library) + compiledIn();
}

}  // namespace dp::tool
