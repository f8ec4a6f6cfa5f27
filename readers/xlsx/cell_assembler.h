#pragma once

#include <array>
#include <cstddef>
#include <optional>
#include <string_view>

#include "dpxlsx/readers/worksheet_size.h"
#include "dpxlsx/readers/xlsx/cell_reference.h"
#include "dpxlsx/readers/xlsx/excel_xlsx_reader.h"
#include "dpxlsx/readers/xlsx/opened_package.h"
#include "dpxlsx/store/external_data_record.h"

namespace dp {

// What the elements of a worksheet part mean: takes them in the order of the document and delivers
// a record for each cell that holds something. Every text that it is given has a zero behind it.
class CellAssembler {
  public:
    // `passedOver` records were delivered when the part was read before, and are not again.
    explicit CellAssembler(ExcelXLSXReader& owner, std::size_t passedOver = 0);

    // A `row`; `number` is its `r`. It may be beyond the worksheet: values there are the error.
    void beginRow(std::optional<std::string_view> number);
    // A `c` with its `r`, and its `t` and `s` or nothing. Throws CmXmlException.
    void beginCell(std::optional<std::string_view> reference, std::string_view type,
                   std::string_view style);
    // A `v` and the text that it begins with, empty when it begins with none. Throws
    // CmXmlException, and what the provider throws.
    void value(std::string_view text);
    // The same for a `t`, which counts in cells of inline texts alone.
    bool takesInlineText() const { return kind_ == Kind::InlineText; }
    void inlineText(std::string_view text);

    // Runs `read`, which gives this object a part, and answers what it answers. What was given is
    // delivered in the end, also when `read` throws, unless the provider threw.
    template <class Read>
    bool take(const Read& read) {
        try {
            const bool result = read();
            deliverWaiting();
            return result;
        } catch (...) {
            if (!delivering_) deliverWaiting();
            throw;
        }
    }
    // How many records have been delivered, those passed over included.
    std::size_t delivered() const { return delivered_; }

  private:
    enum class Kind { Number, SharedString, Text, InlineText, Error };
    // A cell on its way to the provider.
    struct WaitingCell {
        unsigned row;
        unsigned column;
        long sharedString;  // its index, or -1 for a number
        double number;
        NumberKind kind;
    };

    static Kind kindOf(std::string_view type);
    void deliverNumber(std::string_view text);
    void deliverSharedString(long index);
    void deliverText(std::string_view text);
    void wait(const WaitingCell& cell);
    void deliverWaiting();
    void deliverOldest();
    void deliver(const WaitingCell& cell);
    void deliverTextAt(unsigned row, unsigned column);
    void deliverAt(unsigned row, unsigned column, ExternalDataRecord& record);

    static constexpr std::size_t kWaiting = 16;

    ExcelXLSXReader& owner_;
    ExcelXLSXReader::OpenedPackage& package_;
    const std::size_t passedOver_;
    std::size_t delivered_ = 0;
    CellPlace place_;
    Kind kind_ = Kind::Number;
    int style_ = -1;
    std::array<WaitingCell, kWaiting> waiting_;
    std::size_t oldest_ = 0;
    std::size_t waitingCount_ = 0;
    bool delivering_ = false;
    ExternalDataRecord number_{0, 0, 0, 0};
    ExternalDataRecord text_{0, 0, 0, 0};
};

}  // namespace dp
