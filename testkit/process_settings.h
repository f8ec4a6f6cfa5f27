#pragma once

#include <cstdlib>
#include <optional>
#include <string>
#include <tuple>

#include "dpxlsx/provider/excel_data_provider_base.h"

// State that all of a process shares, put back by who changes it.
namespace testkit {

// The settings that a setter on one provider changes for all.
inline auto processSettings() {
    using Settings = dp::ExcelDataProviderBase;
    return std::tie(Settings::_missingValue, Settings::_minNumericValue, Settings::_maxNumericValue,
                    Settings::_maxTextLength, Settings::_inputDecimal, Settings::_outputDecimal,
                    Settings::_outputGroupingSymbol, Settings::_missingValueText,
                    Settings::_trueValue, Settings::_falseValue);
}

// Restores the settings of the process when it is destroyed.
struct KeptSettings {
    ~KeptSettings() { processSettings() = before; }

    std::tuple<double, double, double, int, char, char, char, std::string, std::string, std::string>
        before{processSettings()};
};

// Sets a variable of the environment until it is destroyed.
class EnvironmentVariable {
  public:
    EnvironmentVariable(const char* name, const std::string& value) : name_(name) {
        if (const char* before = std::getenv(name)) before_ = before;
        ::setenv(name, value.c_str(), 1);
    }
    ~EnvironmentVariable() { before_ ? ::setenv(name_, before_->c_str(), 1) : ::unsetenv(name_); }
    EnvironmentVariable(const EnvironmentVariable&) = delete;
    EnvironmentVariable& operator=(const EnvironmentVariable&) = delete;

  private:
    const char* name_;
    std::optional<std::string> before_;
};

}  // namespace testkit
