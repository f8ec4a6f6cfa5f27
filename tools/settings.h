#pragma once

#include <map>
#include <set>
#include <string>
#include <vector>

#include "model/host/i_data_provider.h"
#include "tools/exit_code.h"
#include "tools/options.h"

namespace dp::tool {

// The library's own mark of a missing number, until a host sets another one.
constexpr double kDefaultMissing = 1.23456e30;
// The library's own limit of numbers on both sides.
constexpr double kDefaultRange = 1.001e18;

// The library's own limit of texts and names, in bytes.
constexpr int kDefaultLongestText = 80;

struct SheetEntry {
    int key;
    std::string title;
};

// A worksheet that the user named is none of those with cells. The text says which there are.
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

// Settings that must stand when the workbook is opened.
void applySettings(IDataProvider& provider, const ReadSettings& settings);

// Those of them that turn numbers into missing ones: the range and the number that marks one. What
// is not set stays as it is.
void applyNumbers(IDataProvider& provider, const ReadSettings& settings);

// What the options of worksheets and columns turned out to mean in the open workbook.
struct ReadPlan {
    std::map<int, unsigned> nameRows;  // by worksheet key: 1-based, 0 for none
    // By column key, where options of columns are given: the 1-based number in the worksheet. An
    // option may give the column another position at the host.
    std::map<int, unsigned> columnNumbers;
    std::set<std::string> leftOut;   // titles of worksheets
    std::vector<std::string> notes;  // options that do nothing
};

// Hands over the options that name worksheets and columns of the open workbook. Throws
// UnknownWorksheet when there is no such worksheet, a Failure when it has no such column.
ReadPlan applyReadOptions(IDataProvider& provider, const Options& options);

}  // namespace dp::tool
