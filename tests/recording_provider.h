#pragma once

#include <sstream>
#include <string>

#include "dpxlsx/provider/xlsx_data_provider.h"

// A provider that records the calls of a reader, one word each: "+Name" adds a worksheet, "@0" selects one, "-1"
// removes one, and a record is its row, column and content.
class RecordingProvider : public dp::xlsxDataProvider {
  public:
    using dp::xlsxDataProvider::AddWorksheet;

    void AddWorksheet(const char* name) override {
        note(std::string("+") + name);
        dp::xlsxDataProvider::AddWorksheet(name);
    }
    void SetWorksheetIndex(int position) override {
        note("@" + std::to_string(position));
        dp::xlsxDataProvider::SetWorksheetIndex(position);
    }
    void RemoveWorksheet(int position) override {
        note("-" + std::to_string(position));
        dp::xlsxDataProvider::RemoveWorksheet(position);
    }
    void AddExternalDataRecord(const dp::ExternalDataRecord& record) override {
        std::ostringstream text;
        text << record.row << ',' << record.column << '=';
        const dp::ExternalDataRecordCell& cell = record.cell;
        if (cell.type == dp::CELL_TEXT)
            text << '\'' << cell.textValue << '\'';
        else
            text << (cell.type == dp::CELL_DATETIME ? "d" : "") << cell.numValue;
        if (cell.formatIndex != -1) text << '#' << cell.formatIndex;
        note(text.str());
        dp::xlsxDataProvider::AddExternalDataRecord(record);
    }

    // What was recorded since the last call of this.
    std::string taken() { return std::exchange(calls_, {}); }

  private:
    void note(const std::string& call) { calls_ += (calls_.empty() ? "" : " ") + call; }

    std::string calls_;
};
