#pragma once

#include <map>
#include <memory>
#include <string>
#include <utility>

#include <dpxlsx/model/host/i_string.h>
#include <dpxlsx/model/host/i_variable_format.h>
#include <unicode/datefmt.h>

namespace dp::tool {

// A text handed to the library.
class HostString : public IString {
  public:
    explicit HostString(std::string text = {}) : text_(std::move(text)) {}

    const char* database_str() const override { return text_.c_str(); }
    const char* application_str() const override { return text_.c_str(); }
    std::string& operator=(const std::string& text) override { return text_ = text; }

  private:
    std::string text_;
};

// The host's part in handling date-times: the provider asks it to check, read and write them. The
// four parameters are not used; the pattern of the format passed last is.
class DateTimeHelper : public IDateTimeVariableFormat {
  public:
    FormatType GetType() const override { return FormatType::DateTime; }
    bool GetAuto() const override { return true; }
    // Renders by the pattern passed last, or in ISO form when there is none.
    IString* FormatValue(double value, bool fullPrecision) const override;
    void GetDateTimeParameters(unsigned* p1, unsigned* p2, unsigned* p3,
                               unsigned* p4) const override;
    void SetDateTimeParameters(const IDateTimeVariableFormat* other) override;
    const IString* GetFormatString() const override { return &pattern_; }
    // Reads the text, trimmed, by the pattern, or by common patterns when none is known. The whole
    // text must match. A text without a year is refused unless it is only a time.
    bool ConvertToDatetime(const IString* format, IString* text, double& value) const override;
    double GenerateTime(int year, int month, int day, int hour, int minute, int second,
                        int millisecond) const override;
    void SetGlobalDateTimeFormat(IString* format) override;
    IString* CovertVextralDateTimeToString(double value) const override;
    bool ValidVextralTime(double value) const override;
    double GetCurrentVextralTime() const override;

  private:
    const icu::DateFormat* formatter(const std::string& pattern) const;
    bool read(const std::string& pattern, const std::string& text, double& value) const;

    unsigned parameters_[4] = {0, 0, 0, 0};
    HostString pattern_;
    mutable std::map<std::string, std::unique_ptr<icu::DateFormat>> formatters_;
};

}  // namespace dp::tool
