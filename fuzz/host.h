#pragma once

#include <utility>

#include "dpxlsx/formats/date_time_variable_format.h"
#include "dpxlsx/model/host/i_data_provider.h"
#include "dpxlsx/model/host/i_finders.h"

// What hosts do with a provider.
namespace fuzz {

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

// Is told of every step of a provider's opens and listings, and ends them at one of the reports.
class ProgressWatch {
  public:
    // Ends the work at the report with this number, from 1 on; 0 for none.
    explicit ProgressWatch(unsigned end = 0) : left_(end) {}
    // The provider must not be used longer than this object.
    void watch(dp::IDataProvider& provider);
    // The result that this object has caused may come once.
    bool hasEnded() { return std::exchange(ended_, false); }

  private:
    static int report(double done, void* watch);

    unsigned left_;
    bool ended_ = false;
    double done_ = 0;
};

// Reads the whole column and shows some of its values. Returns the number of its rows.
unsigned long read(dp::IColumn& column);

// Loads every worksheet, and every column in every kind, reads them and releases them; stops after
// some ten thousand rows.
void takeEverything(dp::IDataProvider& provider);

}  // namespace fuzz
