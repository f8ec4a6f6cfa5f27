// An import library for the tests of the tool: the numbers of a workbook arrive as Booleans, which
// no .xlsx file delivers.
#include "dpxlsx/model/host/entry_points.h"
#include "dpxlsx/provider/xlsx_data_provider.h"

namespace dp {
namespace {

class BooleanProvider : public xlsxDataProvider {
  public:
    void AddExternalDataRecord(const ExternalDataRecord& record) override {
        ExternalDataRecord changed = record;
        ExternalDataRecordCell& cell = changed.cell;
        if (cell.type == CELL_NUMBER) {
            cell.type = CELL_BOOLEAN;
            cell.boolValue = cell.numValue != 0 ? 1 : 0;
            cell.numValue = 0;
        }
        xlsxDataProvider::AddExternalDataRecord(changed);
    }
};

}  // namespace

const char* GetDataProviderFiletype(const char*) { return "xlsx"; }

long CreateDataProvider(const char*, IDataProvider** provider) {
    *provider = new BooleanProvider;
    return 0;
}

}  // namespace dp
