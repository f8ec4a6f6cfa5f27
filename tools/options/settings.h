#pragma once

#include <map>
#include <set>
#include <string>
#include <vector>

#include <dpxlsx/model/host/i_data_provider.h>

#include "tools/host/exit_code.h"
#include "tools/options/options.h"

namespace dp::tool {

// The library's default for the number that marks a missing value.
constexpr double kDefaultMissing = 1.23456e30;
// The library's default range of numbers is from minus this to plus this.
constexpr double kDefaultRange = 1.001e18;

// The library's default limit of texts and names, in bytes.
constexpr int kDefaultLongestText = 80;

struct SheetEntry {
    int key;
    std::string title;
};

// Thrown when the user named a worksheet that is not among those with values. The text lists these.
class UnknownWorksheet : public Failure {
  public:
    UnknownWorksheet(std::string name, const std::string& text)
        : Failure(kUsage, text), name_(std::move(name)) {}

    const std::string& name() const { return name_; }

  private:
    std::string name_;
};

// "it has", followed by the first few worksheets with their keys.
std::string worksheetsText(const std::vector<SheetEntry>& sheets);

// The worksheets that are not excluded, in workbook order.
std::vector<SheetEntry> listSheets(IDataProvider& provider);

// Makes the settings that must be in place when the workbook is opened.
void applySettings(IDataProvider& provider, const ReadSettings& settings);

// Makes only those settings that turn numbers into missing ones: the range and the number that
// marks a missing one. Settings that the user did not give are not changed.
void applyNumbers(IDataProvider& provider, const ReadSettings& settings);

// What the options of worksheets and columns mean in the open workbook.
struct ReadPlan {
    std::map<int, unsigned> nameRows;  // by worksheet key: 1-based, 0 for none
    // The 1-based number of a column in its worksheet, by column key; filled only when there are
    // options of columns. The position at the host may differ, by an option.
    std::map<int, unsigned> columnNumbers;
    std::set<std::string> leftOut;   // titles of worksheets
    std::vector<std::string> notes;  // messages about options without effect
};

// Passes the options that name worksheets and columns of the open workbook to the provider. Throws
// UnknownWorksheet when there is no such worksheet, a Failure when it has no such column.
ReadPlan applyReadOptions(IDataProvider& provider, const Options& options);

}  // namespace dp::tool
