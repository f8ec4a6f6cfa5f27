#pragma once

#include <memory>
#include <string>
#include <vector>

#include "dpxlsx/formats/date_time_variable_format.h"
#include "dpxlsx/model/host/i_finders.h"
#include "dpxlsx/provider/excel_data_provider_base.h"
#include "dpxlsx/readers/xml2003/excel_xml_reader.h"

// What hosts do with a provider.
namespace fuzz {

// Deletes by Release.
struct Releasing {
    void operator()(dp::IResource* object) const { object->Release(); }
};
template <class T>
using Reference = std::unique_ptr<T, Releasing>;

// Takes the first reference of a new object.
template <class T>
Reference<T> referenceTo(T* object) {
    if (object) object->AddRef();
    return Reference<T>(object);
}

// A host's date-time helper, which reads texts that begin with a number.
class Helper : public dp::DateTimeVariableFormat {
  public:
    bool ConvertToDatetime(const dp::IString* format, dp::IString* text,
                           double& value) const override;
    double GenerateTime(int year, int month, int day, int hour, int minute, int second,
                        int millisecond) const override;
    bool ValidVextralTime(double value) const override;
    dp::IString* CovertVextralDateTimeToString(double value) const override;
};

// Reads the whole column and shows some of its values. Returns the number of its rows.
unsigned long read(dp::IColumn& column);

// Loads every worksheet, and every column in every kind, reads them and releases them; stops after
// some ten thousand rows.
void takeEverything(dp::IDataProvider& provider);

// A provider that reads by a given reader, without a package around the parts.
class ReadingProvider : public dp::ExcelDataProviderBase {
  public:
    // Takes the reader, which borrows this provider and is therefore destroyed first.
    void read(std::unique_ptr<dp::ExcelXmlReader> reader);

    long GetWorksheets(const char* fileName, std::vector<std::string>& names) override;
    long OpenFile(const char* fileName, FileAccess access) override;
    long CloseFile() override;
    dp::IVariableFormat* CreateVextralNumericFormat(
        const dp::ExternalDataRecordCell& cell) const override;
    bool IsDateTimeFormatType(const dp::ExternalDataRecordCell& cell) const override;

  private:
    std::unique_ptr<dp::ExcelXmlReader> reader_;
};

}  // namespace fuzz
