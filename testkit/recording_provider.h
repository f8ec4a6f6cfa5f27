#pragma once

#include <array>
#include <charconv>
#include <string>
#include <utility>
#include <vector>

#include "dpxlsx/provider/xlsx_data_provider.h"

namespace testkit {

// A provider that records the calls of a reader, one word each: "+Name" adds a worksheet, "@0"
// selects one, "-1" removes one, and a record is its row, column and content.
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
        note(std::to_string(record.row) + "," + std::to_string(record.column) + "=" +
             contentOf(record.cell));
        dp::xlsxDataProvider::AddExternalDataRecord(record);
    }

    // What was recorded since the last call of one of these.
    std::vector<std::string> takenCalls() { return std::exchange(calls_, {}); }
    std::string taken() {
        std::string text;
        for (const std::string& call : takenCalls()) text += (text.empty() ? "" : " ") + call;
        return text;
    }

  private:
    // Numbers have as many digits as tell them from all others.
    static std::string contentOf(const dp::ExternalDataRecordCell& cell) {
        if (cell.type == dp::CELL_EMPTY) return "error";
        if (cell.type == dp::kUnreadableContent) return "unreadable";
        std::string text = cell.type == dp::CELL_NUMBER     ? ""
                           : cell.type == dp::CELL_DATETIME ? "d"
                           : cell.type == dp::CELL_TEXT     ? "'" + cell.textValue + "'"
                                                            : "type " + std::to_string(cell.type);
        if (cell.type != dp::CELL_TEXT) {
            std::array<char, 32> digits;
            text.append(digits.data(),
                        std::to_chars(digits.begin(), digits.end(), cell.numValue).ptr);
        }
        return cell.formatIndex == -1 ? text : text + "#" + std::to_string(cell.formatIndex);
    }
    void note(std::string call) { calls_.push_back(std::move(call)); }

    std::vector<std::string> calls_;
};

}  // namespace testkit
