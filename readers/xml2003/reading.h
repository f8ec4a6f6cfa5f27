#pragma once

#include <iterator>
#include <string>

#include "dpxlsx/formats/style.h"
#include "dpxlsx/readers/xml/known_names.h"
#include "dpxlsx/readers/xml2003/excel_xml_reader.h"
#include "dpxlsx/readers/xml2003/first_entry_index.h"
#include "dpxlsx/store/external_data_record.h"

// What an ExcelXmlReader knows beyond the fields that hosts see: known names, and indexes of its
// lists.
namespace dp {

// The elements of a row's cells, in the order of ExcelXmlReader::elementNames.
enum CellElement { kCell, kData, kWorksheetOptions, kRow, kPrefixedData, kComment };
inline constexpr const char* kCellElements[] = {"Cell", "Data",    "WorksheetOptions",
                                                "Row",  "ss:Data", "Comment"};

// The attributes of cells and their data, behind the prefix "ss:".
enum CellAttribute { kStyleId, kIndex, kMergeAcross, kType };
inline constexpr const char* kCellAttributes[] = {"StyleID", "Index", "MergeAcross", "Type"};

struct ExcelXmlReader::Reading {
    explicit Reading(XmlReader& reader)
        : cellNames(reader, {std::begin(kCellElements), std::end(kCellElements)}),
          rowNames(reader, {"Row", "WorksheetOptions"}),
          attributeNames(reader, {std::begin(kCellAttributes), std::end(kCellAttributes)}) {}

    ExternalDataRecord record{0, 0, 0, 0};  // the one being read
    const xml::KnownNames cellNames;        // CellElement
    const xml::KnownNames rowNames;
    const xml::KnownNames attributeNames;  // CellAttribute
    FirstEntryIndex<xStyle, std::string> styleById{&xStyle::styleId};
    FirstEntryIndex<xStyleRange, unsigned> styleByColumn{&xStyleRange::column};
    FirstEntryIndex<xStyleRange, unsigned> styleByRow{&xStyleRange::row};
};

}  // namespace dp
