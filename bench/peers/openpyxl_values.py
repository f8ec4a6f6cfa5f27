"""All values of all worksheets, as lists of rows; the library's streaming mode forgets the rest.

openpyxl_values.py BOOK WORKSHEETS ROWS COLUMNS LAST_CELL
"""
import sys

import openpyxl

sheets, rows, columns = map(int, sys.argv[2:5])
book = openpyxl.load_workbook(sys.argv[1], read_only=True, data_only=True)
values = [list(sheet.values) for sheet in book.worksheets]
last = values[sheets - 1]
assert len(last) == rows and len(last[-1]) == columns and last[-1][-1] is not None
