#pragma once

#include <string>

#include <unicode/uversion.h>

#include "dpxlsx/model/host/export.h"
#include "dpxlsx/model/host/i_variable_format.h"
#include "dpxlsx/model/string.h"

U_NAMESPACE_BEGIN
class DateFormat;
U_NAMESPACE_END

namespace dp {

// Display of serial day numbers by an ICU date pattern, in US English and without time zone. All
// instances share the buffers in which they render: calls must not run at the same time.
class DPXLSX_API DateTimeVariableFormat : public IDateTimeVariableFormat {
  public:
    // ICU's medium date style.
    DateTimeVariableFormat();
    // `pattern` is UTF-8; the empty pattern stands for ICU's medium date style.
    explicit DateTimeVariableFormat(const std::string& pattern);
    DateTimeVariableFormat(const DateTimeVariableFormat&) = delete;
    DateTimeVariableFormat& operator=(const DateTimeVariableFormat&) = delete;
    ~DateTimeVariableFormat() override;

    FormatType GetType() const override;
    bool GetAuto() const override;
    // A new string. Day 60, the 29 February 1900 that never existed, shows as 1 March 1900, as day
    // 61 does.
    IString* FormatValue(double value, bool fullPrecision) const override;
    void GetDateTimeParameters(unsigned* p1, unsigned* p2, unsigned* p3,
                               unsigned* p4) const override;
    void SetDateTimeParameters(const IDateTimeVariableFormat* other) override;
    const IString* GetFormatString() const override;

    // These do nothing and return neutral values: converting is left to the host's own
    // implementation.
    bool ConvertToDatetime(const IString* format, IString* text, double& value) const override;
    double GenerateTime(int year, int month, int day, int hour, int minute, int second,
                        int millisecond) const override;
    void SetGlobalDateTimeFormat(IString* format) override;
    IString* CovertVextralDateTimeToString(double value) const override;
    bool ValidVextralTime(double value) const override;
    double GetCurrentVextralTime() const override;

    bool autoFormat = true;
    unsigned dateTimeParameters[4] = {};  // the host's
    const String pattern;
    // Made from the pattern when the first value is rendered, hence mutable; owned, null until
    // then. It makes that value cost as much as some twenty others, and most formats never render
    // any.
    mutable icu::DateFormat* formatter = nullptr;
};

}  // namespace dp
