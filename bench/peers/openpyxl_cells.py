"""The whole workbook, as the library's own cells: openpyxl_cells.py BOOK WORKSHEETS ROWS COLUMNS LAST_CELL"""
import sys

import openpyxl

book = openpyxl.load_workbook(sys.argv[1], data_only=True)
assert book.worksheets[int(sys.argv[2]) - 1][sys.argv[5]].value is not None
