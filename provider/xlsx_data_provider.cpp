#include "dpxlsx/provider/xlsx_data_provider.h"

#include <new>
#include <utility>

#include <boost/filesystem.hpp>

#include "dpxlsx/formats/automatic_format.h"
#include "dpxlsx/formats/format_codes.h"
#include "dpxlsx/model/string.h"
#include "dpxlsx/provider/file_type.h"
#include "dpxlsx/provider/package.h"
#include "dpxlsx/provider/progress_reports.h"
#include "dpxlsx/provider/temporary_directory.h"
#include "dpxlsx/provider/unpacking.h"
#include "dpxlsx/readers/standard/standard_reader.h"
#include "dpxlsx/readers/xlsx/excel_xlsx_reader.h"
#include "dpxlsx/readers/xml/file_copy.h"
#include "dpxlsx/readers/xml/progress.h"

namespace dp {

namespace fs = boost::filesystem;

namespace {

std::shared_ptr<ExcelXLSXReader> makeReader(const std::string& directory, ReadingRules rules,
                                            ExcelDataProviderBase& provider) {
    const std::string shortDate = GetShortDateMask();
    const double missing = ExcelDataProviderBase::GetMissingValue();
    IDateTimeVariableFormat* const helper = provider.GetDateTimeVariableFormatHelper();
    if (rules == ReadingRules::Standard)
        return std::make_shared<StandardReader>(directory, shortDate, missing, &provider, helper);
    const bool hasSharedStrings = fs::exists(directory + "/xl/sharedStrings.xml");
    return std::make_shared<ExcelXLSXReader>(directory, hasSharedStrings, shortDate, missing,
                                             &provider, helper);
}

void listWorksheets(const std::string& directory, ReadingRules rules,
                    std::vector<std::string>& names) {
    if (rules == ReadingRules::Standard)
        standard::listWorksheets(directory, names);
    else
        excel_xlsx::GetWorksheets(directory, names);
}

// The result of `work`, which opens or lists. When the host stops it, `cleanUp` removes what it has
// left.
template <class Work, class CleanUp>
long resultOf(Progress& progress, const Work& work, const CleanUp& cleanUp) {
    try {
        const PackageStatus status = work();
        if (status == PackageStatus::Success) progress.finish();
        return resultCode(status);
    } catch (const Progress::Cancelled&) {
        cleanUp();
        return resultCode(PackageStatus::Cancelled);
    } catch (...) {
        if (progress.isStopped()) cleanUp();
        throw;
    }
}

}  // namespace

xlsxDataProvider::xlsxDataProvider() = default;

xlsxDataProvider::~xlsxDataProvider() {
    _reader.reset();
    removeUnpackedFile();
    setProgressReport(*this, {});
}

PackageStatus xlsxDataProvider::unzipFile(const char* fileName) {
    removeDirectoryAndContents(_tempDirectory);
    fs::path source(textOrEmpty(fileName));
    // Two slashes in front begin an absolute path too, though to Boost they may name a machine.
    if (!source.native().starts_with('/')) source = fs::current_path() / source;
    if (!fs::is_regular_file(source)) return PackageStatus::SourceMissing;
    if (!hasXlsxExtension(source.string())) return PackageStatus::NotAPackage;
    Progress::tell();

    std::string directory = makePrivateDirectory();
    if (directory.empty()) return PackageStatus::DirectoryUnusable;
    _tempDirectory = std::move(directory);
    const fs::path copy = fs::path(_tempDirectory) / source.filename();
    // Checked before copying, because a sparse file may have any size and its copy would fill the
    // disk.
    boost::system::error_code unknown;
    const bool fits = fs::file_size(source, unknown) <= freeSpace(_tempDirectory) || unknown;
    if (!fits || !copyFile(source.string(), copy.string())) {
        removeDirectoryAndContents(_tempDirectory);
        return PackageStatus::DirectoryUnusable;
    }
    const PackageStatus status = unpackArchive(copy.string(), _tempDirectory);
    if (status == PackageStatus::TooLarge) removeDirectoryAndContents(_tempDirectory);
    return status == PackageStatus::Success ? checkWorkbook(_tempDirectory, _readingRules) : status;
}

void xlsxDataProvider::removeUnpackedFile() try {
    removeDirectoryAndContents(_tempDirectory);
    _tempDirectory.clear();
} catch (const std::bad_alloc&) {
    // Closing never throws. The next open or close, or the last Release, removes the directory.
}

long xlsxDataProvider::OpenFile(const char* fileName, FileAccess access) {
    if (access != FileAccess::Read) return -1;
    Progress progress(progressReportOf(*this), Progress::Reading::Worksheets);
    const ExcelXLSXReader* const readerBefore = _reader.get();
    return resultOf(
        progress,
        [&] {
            const PackageStatus status = unzipFile(fileName);
            if (status != PackageStatus::Success) return status;
            _rulesOfCells = _readingRules;
            _reader = makeReader(_tempDirectory, _readingRules, *this);
            _reader->startAtWorksheet(static_cast<int>(_worksheetNames.size()));
            _reader->mReadExcelWorkbook();
            return status;
        },
        [&] {
            // The new one keeps a part open; one before still knows the styles of its cells.
            if (_reader.get() != readerBefore) _reader.reset();
            removeUnpackedFile();
        });
}

long xlsxDataProvider::GetWorksheets(const char* fileName, std::vector<std::string>& names) {
    Progress progress(progressReportOf(*this), Progress::Reading::Names);
    return resultOf(
        progress,
        [&] {
            PackageStatus status = unzipFile(fileName);
            if (status != PackageStatus::Success) return status;
            try {
                listWorksheets(_tempDirectory, _readingRules, names);
            } catch (const CmXmlException&) {
                if (progress.isStopped()) throw;  // it is the host's own
                status = PackageStatus::NotAWorkbook;
            }
            removeUnpackedFile();
            return status;
        },
        [this] { removeUnpackedFile(); });
}

long xlsxDataProvider::CloseFile() {
    _reader.reset();
    removeUnpackedFile();
    return 0;
}

std::string xlsxDataProvider::GetTempDirectoryPath() const { return _tempDirectory; }

IVariableFormat* xlsxDataProvider::CreateVextralNumericFormat(
    const ExternalDataRecordCell& cell) const {
    if (_reader) return _reader->createVextralNumericFormat(cell.formatIndex);
    return createAutomaticFormat().release();
}

bool xlsxDataProvider::IsDateTimeFormatType(const ExternalDataRecordCell& cell) const {
    return _reader && _reader->IsDateTimeFormatType(_reader->GetExcelFormatType(cell.formatIndex));
}

}  // namespace dp
