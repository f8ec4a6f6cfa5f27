#pragma once

#include <memory>
#include <string>
#include <vector>

#include "dpxlsx/provider/excel_data_provider_base.h"

namespace dp {

class ExcelXLSXReader;
enum class PackageStatus : int;

// The provider of .xlsx files. Opening copies the workbook into a private temporary directory,
// unpacks it there and reads it whole; closing removes the directory. Unpacking leaves the
// process's working directory alone.
class DPXLSX_API xlsxDataProvider : public ExcelDataProviderBase {
  public:
    xlsxDataProvider();
    ~xlsxDataProvider() override;

    // --- 4-6 ---
    long GetWorksheets(const char* fileName, std::vector<std::string>& names) override;
    long OpenFile(const char* fileName, FileAccess access) override;
    long CloseFile() override;

    // --- 68 ---
    std::string GetTempDirectoryPath() const override;

    // --- 107-108; without an open file: the automatic numeric format, and false ---
    IVariableFormat* CreateVextralNumericFormat(const ExternalDataRecordCell& cell) const override;
    bool IsDateTimeFormatType(const ExternalDataRecordCell& cell) const override;

  private:
    // Copies and unpacks the file into a new directory, which replaces the one before.
    PackageStatus unzipFile(const char* fileName);
    void removeUnpackedFile();

    std::string _tempDirectory;  // absolute; empty when there is none
    // Kept while the file is open: it knows the styles by which columns are shown.
    std::shared_ptr<ExcelXLSXReader> _reader;
};

}  // namespace dp
