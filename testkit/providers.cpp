#include "testkit/providers.h"

#include <utility>

namespace testkit {

void FilingProvider::file(unsigned row, unsigned column, const dp::ExternalDataRecordCell& cell) {
    record_.row = row;
    record_.column = column;
    record_.cell = cell;
    AddExternalDataRecord(record_);
}

void ReadingProvider::read(std::unique_ptr<dp::ExcelXmlReader> reader) {
    reader_ = std::move(reader);
    reader_->mReadExcelWorkbook();
}

long ReadingProvider::CloseFile() {
    reader_.reset();
    return 0;
}

dp::IVariableFormat* ReadingProvider::CreateVextralNumericFormat(
    const dp::ExternalDataRecordCell& cell) const {
    return reader_->createVextralNumericFormat(cell.formatIndex);
}

bool ReadingProvider::IsDateTimeFormatType(const dp::ExternalDataRecordCell& cell) const {
    return reader_->IsDateTimeFormatType(reader_->GetExcelFormatType(cell.formatIndex));
}

}  // namespace testkit
