#include "dpxlsx/provider/package.h"

#include <exception>

#include <boost/filesystem.hpp>

#include "dpxlsx/model/host/entry_points.h"
#include "dpxlsx/readers/standard/standard_reader.h"
#include "dpxlsx/readers/xml/progress.h"
#include "dpxlsx/readers/xml/silence.h"
#include "dpxlsx/readers/xml/xml_reader.h"

namespace dp {

namespace {

// Whether libxml2 can read the workbook part up to its sheet list. The elements up to there may be
// missing: only an error counts.
bool isReadable(const std::string& workbookPart) {
    try {
        const SilentLibxml2 silent;
        XmlReader reader;
        reader.mInitialize(workbookPart);
        for (const char* element : {"workbook", "bookViews", "sheets"})
            if (!reader.mGotoElement(element)) break;
        return true;
    } catch (const CmXmlException&) {
        return false;
    } catch (const std::exception&) {
        return false;
    }
}

bool hasUsualParts(const std::string& directory) {
    const std::string workbook = directory + "/xl/workbook.xml";
    return boost::filesystem::exists(directory + "/xl/styles.xml") &&
           boost::filesystem::exists(workbook) && isReadable(workbook);
}

}  // namespace

long resultCode(PackageStatus status) {
    switch (status) {
        case PackageStatus::Success:
            return 0;
        case PackageStatus::SourceMissing:
            return -17;
        case PackageStatus::DirectoryUnusable:
            return -18;
        case PackageStatus::NotAPackage:
            return -22;
        case PackageStatus::NotAWorkbook:
            return -25;
        case PackageStatus::Cancelled:
            return kCancelled;
        case PackageStatus::EntryError:
        case PackageStatus::TooLarge:
        case PackageStatus::ArchiveNotClosed:
            return -1;
    }
    return -1;
}

PackageStatus checkWorkbook(const std::string& directory, ReadingRules rules) {
    // Exceptions become a result here, which those of the host must not.
    const Progress::Current nobodyIsTold(nullptr);
    const bool isWorkbook = rules == ReadingRules::Standard ? standard::isWorkbook(directory)
                                                            : hasUsualParts(directory);
    return isWorkbook ? PackageStatus::Success : PackageStatus::NotAWorkbook;
}

}  // namespace dp
