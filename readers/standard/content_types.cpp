#include "dpxlsx/readers/standard/content_types.h"

#include <algorithm>
#include <iterator>
#include <string_view>

#include "dpxlsx/readers/standard/element_walker.h"
#include "dpxlsx/readers/standard/part_name.h"

namespace dp::standard {

namespace {

constexpr const char* kContentTypes = "[Content_Types].xml";

// In lower case, since case does not count.
constexpr std::string_view kWorkbookTypes[] = {
    "application/vnd.openxmlformats-officedocument.spreadsheetml.sheet.main+xml",
    "application/vnd.openxmlformats-officedocument.spreadsheetml.template.main+xml",
    "application/vnd.ms-excel.sheet.macroenabled.main+xml",
    "application/vnd.ms-excel.template.macroenabled.main+xml",
    "application/vnd.ms-excel.addin.macroenabled.main+xml",
    "application/xml",
    "text/xml",
};

std::string extensionOf(const std::string& part) {
    return part.substr(std::min(part.find_last_of("./") + 1, part.size()));
}

// The type of the part, empty for none. A type of its own goes before that of its extension.
std::string contentTypeOf(const PackageParts& parts, const std::string& part) {
    const std::string name = foldPartName(part);
    const std::string extension = extensionOf(name);
    std::string own;
    std::string common;
    ElementWalker walker(parts.pathOf(kContentTypes), Vocabulary::Package);
    walker.children([&](std::string_view element) {
        const auto valueOf = [&walker](const char* attribute) {
            return walker.attribute(attribute).value_or("");
        };
        if (element == "Override" && foldPartName(resolvePartName({}, valueOf("PartName"))) == name)
            own = foldPartName(valueOf("ContentType"));
        else if (element == "Default" && foldPartName(valueOf("Extension")) == extension)
            common = foldPartName(valueOf("ContentType"));
    });
    walker.finish();
    return own.empty() ? common : own;
}

}  // namespace

bool mayBeWorkbook(const PackageParts& parts, const std::string& part) {
    if (parts.pathOf(kContentTypes).empty()) return true;
    try {
        const std::string type = contentTypeOf(parts, part);
        const auto* const end = std::end(kWorkbookTypes);
        return type.empty() || std::find(std::begin(kWorkbookTypes), end, type) != end;
    } catch (const CmXmlException&) {
        return true;
    }
}

}  // namespace dp::standard
