#include "dpxlsx/store/external_data_record.h"

namespace dp {

ExternalDataRecordCell::ExternalDataRecordCell() = default;
ExternalDataRecordCell::ExternalDataRecordCell(const ExternalDataRecordCell& other) = default;
ExternalDataRecordCell& ExternalDataRecordCell::operator=(const ExternalDataRecordCell& other) =
    default;
ExternalDataRecordCell::~ExternalDataRecordCell() = default;

void ExternalDataRecordCell::initialize() {
    type = CELL_EMPTY;
    intValue = 0;
    boolValue = 0;
    numValue = 0.0;
    textValue.clear();
    formatIndex = -1;
}

ExternalDataRecord::ExternalDataRecord(unsigned reserved0Value, unsigned reserved1Value,
                                       unsigned rowIndex, unsigned columnIndex)
    : reserved0(reserved0Value), reserved1(reserved1Value), row(rowIndex), column(columnIndex) {}

ExternalDataRecord::ExternalDataRecord(const ExternalDataRecord& other) = default;
ExternalDataRecord& ExternalDataRecord::operator=(const ExternalDataRecord& other) = default;
ExternalDataRecord::~ExternalDataRecord() = default;

void ExternalDataRecord::initialize() {
    reserved0 = 0;
    reserved1 = 0;
    row = 0;
    column = 0;
    cell.initialize();
}

}  // namespace dp
