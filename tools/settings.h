#pragma once

#include <map>
#include <string>
#include <vector>

#include "model/host/i_data_provider.h"
#include "tools/options.h"

namespace dp::tool {

// The library's own mark of a missing number, until a host sets another one.
constexpr double kDefaultMissing = 1.23456e30;

struct SheetEntry {
    int key;
    std::string title;
};

// The worksheets that are not excluded, in workbook order.
std::vector<SheetEntry> listSheets(IDataProvider& provider);

// Settings that must stand when the workbook is opened.
void applySettings(IDataProvider& provider, const ReadSettings& settings);

// Options that name worksheets and columns of the open workbook. Throws a Failure when there is no
// such worksheet. Answers, by key, the 1-based row of the variable names, 0 for none.
std::map<int, unsigned> applyReadOptions(IDataProvider& provider, const Options& options);

}  // namespace dp::tool
