#pragma once

#include <memory>
#include <string>
#include <vector>

#include "dpxlsx/provider/excel_data_provider_base.h"
#include "dpxlsx/readers/xml2003/excel_xml_reader.h"

namespace testkit {

// A provider whose worksheets are filed cell by cell, without a file.
class FilingProvider : public dp::ExcelDataProviderBase {
  public:
    long GetWorksheets(const char*, std::vector<std::string>&) override { return -1; }
    long OpenFile(const char*, FileAccess) override { return -1; }
    long CloseFile() override { return 0; }

    void file(unsigned row, unsigned column, const dp::ExternalDataRecordCell& cell);

  private:
    dp::ExternalDataRecord record_{0, 0, 0, 0};
};

// A provider that reads by a given reader, without a package around the parts.
class ReadingProvider : public FilingProvider {
  public:
    // Takes the reader, which borrows this provider and is therefore destroyed first.
    void read(std::unique_ptr<dp::ExcelXmlReader> reader);

    long CloseFile() override;
    dp::IVariableFormat* CreateVextralNumericFormat(
        const dp::ExternalDataRecordCell& cell) const override;
    bool IsDateTimeFormatType(const dp::ExternalDataRecordCell& cell) const override;

  private:
    std::unique_ptr<dp::ExcelXmlReader> reader_;
};

}  // namespace testkit
