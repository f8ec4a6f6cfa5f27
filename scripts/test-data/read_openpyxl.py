"""Prints the cells of a package as openpyxl reads them: read_openpyxl.py FILE

One list a worksheet: {"name", "cells": [[row, column, type, value, numFmtId], ...]} with 0-based
rows and columns, the types of read_sheetjs.js, the number format's id of the cell's style (null without a
style), and whether the text is a shared one; beside them "codes", the package's own format codes by
id, "count", how many it declares (null for none), and "counts texts", whether the table of shared
texts says how many it holds. Below openpyxl's worksheets, since those turn numbers into dates.
"""
import json
import sys

from openpyxl.cell.text import Text
from openpyxl.reader.excel import ExcelReader
from openpyxl.worksheet._reader import WorkSheetParser
from openpyxl.xml.constants import SHEET_MAIN_NS
from openpyxl.xml.functions import fromstring


class Parser(WorkSheetParser):
    def parse_cell(self, element):
        cell = super().parse_cell(element)
        if element.get("s") is None:
            cell["style_id"] = None
        cell["shared"] = element.get("t") == "s"
        return cell


def plain(value):
    return value if isinstance(value, (bool, int, float, str)) else value.isoformat()


reader = ExcelReader(sys.argv[1], data_only=True)
reader.read_manifest()
reader.read_workbook()
part = next((each.PartName[1:] for each in reader.package.Override
             if each.PartName.endswith("/sharedStrings.xml")), None)
shared = None if part is None else fromstring(reader.archive.read(part))
texts = [] if part is None else [  # as they stand; openpyxl's own table takes parts of escapes out
    Text.from_tree(each).content for each in shared.iter(f"{{{SHEET_MAIN_NS}}}si")]
styles = fromstring(reader.archive.read("xl/styles.xml"))
own = styles.find(f"{{{SHEET_MAIN_NS}}}numFmts")
formats = [int(style.get("numFmtId", -1))
           for style in styles.find(f"{{{SHEET_MAIN_NS}}}cellXfs")]
sheets = []
for sheet, relation in reader.parser.find_sheets():
    if not relation.Type.endswith("/worksheet"):
        continue
    cells = []
    with reader.archive.open(relation.target) as part:
        for _, row in Parser(part, texts, data_only=True).parse():
            for cell in row:
                if cell["value"] is None:
                    continue
                style = cell["style_id"]
                number_format = None if style is None else formats[style]
                cells.append([cell["row"] - 1, cell["column"] - 1, cell["data_type"],
                              plain(cell["value"]), number_format, cell["shared"]])
    sheets.append({"name": sheet.name, "cells": cells})
codes = {} if own is None else {each.get("numFmtId"): each.get("formatCode") for each in own}
print(json.dumps({"sheets": sheets, "codes": codes,
                  "counts texts": shared is not None and "uniqueCount" in shared.attrib,
                  "count": None if own is None else int(own.get("count", 0))}))
