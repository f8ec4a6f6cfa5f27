"""Compares values of workbooks: compare.py PRINT_CELLS MODULES_FOLDER TABLE BOOK...

What an import by the standard makes of each book, as the program PRINT_CELLS says, beside what
openpyxl and SheetJS read in it. Prints the differences that have no row in TABLE, as such rows, and the
rows of these books that no difference needs; then the exit code is 1. A "*" in a row stands for any
text.
"""
import collections
import datetime
import json
import pathlib
import re
import subprocess
import sys
import warnings

import openpyxl
from openpyxl.utils.cell import get_column_letter
from openpyxl.utils.datetime import to_excel

PROGRAM, MODULES, TABLE = map(pathlib.Path, sys.argv[1:4])
DAYS_TO_1904 = 1462
HALF_MILLISECOND = 0.5 / 86400000
ROUNDING = 1e-10  # of the day numbers themselves
WHOLE_BOOK, VALUES = "the book", "values"
MISSING = ("missing", None)

warnings.simplefilter("ignore")


def ours(book):
    """{worksheet: {(row, column): (kind, value)}}; None for a book that is refused."""
    printed = subprocess.run([PROGRAM, book], check=True, capture_output=True).stdout
    answer = json.loads(printed)
    if answer["result"] != 0:
        return None
    sheets = {}
    for call in answer["calls"]:
        if call.startswith("+"):
            cells = sheets.setdefault(call[1:], {})
        elif call[0].isdigit():
            place, content = call.split("=", 1)
            cells[tuple(map(int, place.split(",")))] = our_value(content)
    return sheets


def our_value(content):
    if content.startswith("'"):
        return ("text", content[1:content.rindex("'")])
    if content in ("error", "unreadable"):
        return MISSING
    number = content.split("#")[0]
    return ("date", float(number[1:])) if number[0] == "d" else ("number", float(number))


def of_openpyxl(book):
    sheets = {}
    for sheet in openpyxl.load_workbook(book, data_only=True).worksheets:
        cells = sheets[sheet.title] = {}
        for row in sheet.iter_rows():
            for cell in row:
                if cell.value is not None:
                    cells[cell.row - 1, cell.column - 1] = openpyxl_value(cell)
    return sheets


def openpyxl_value(cell):
    if cell.data_type == "e":
        return MISSING
    if isinstance(cell.value, (datetime.date, datetime.time, datetime.timedelta)):
        return ("date", to_excel(cell.value))
    return ("text", cell.value) if isinstance(cell.value, str) else ("number", float(cell.value))


def of_sheetjs(book):
    script = pathlib.Path(__file__).with_name("sheetjs_cells.js")
    run = subprocess.run(["node", script, MODULES, book], check=True, capture_output=True)
    answer = json.loads(run.stdout)
    return {name: {(row, column): sheetjs_value(type_, value, code, answer["date1904"])
                   for row, column, type_, value, code in cells}
            for name, cells in answer["sheets"].items()}


def sheetjs_value(type_, value, code, date1904):
    if type_ == "e":
        return MISSING
    if type_ == "s":
        return ("text", value)
    if not code:
        return ("number", float(value))
    # It keeps the numbers of the 1904 system and adds the days where it shows them. Times have none.
    is_time = re.search(r"\[[hms]+\]", code, re.IGNORECASE) or (
        0 <= value < 1 and not re.search("[yd]", code, re.IGNORECASE))
    return ("date", float(value + (DAYS_TO_1904 if date1904 and not is_time else 0)))


READERS = {"openpyxl": of_openpyxl, "SheetJS": of_sheetjs}


def is_same(mine, theirs):
    if theirs is None:
        return mine is None or mine == MISSING
    if mine is None:  # texts of spaces alone are no values in an import
        return theirs[0] == "text" and not theirs[1].strip(" ")
    if mine[0] == theirs[0] == "date":
        return abs(mine[1] - theirs[1]) <= HALF_MILLISECOND + ROUNDING
    return mine == theirs


def extent(sheets):
    """What is read of a book as a whole."""
    if sheets is None:
        return "not read"
    return VALUES if any(sheets.values()) else "no value"


def differences(book, mine, reader):
    """Yields (place, our value, the reader's); counts the values compared."""
    try:
        theirs = READERS[reader](book)
    except Exception:  # whatever the reader raises
        theirs = None
    if extent(mine) != extent(theirs):
        yield WHOLE_BOOK, extent(mine), extent(theirs)
        return
    if extent(mine) != VALUES:
        return
    for sheet in list(mine) + [name for name in theirs if name not in mine]:
        our_cells, their_cells = mine.get(sheet, {}), theirs.get(sheet, {})
        compared[reader] += len(their_cells)
        for row, column in sorted({*our_cells, *their_cells}):
            pair = our_cells.get((row, column)), their_cells.get((row, column))
            if not is_same(*pair):
                yield (f"{sheet}!{get_column_letter(column + 1)}{row + 1}", *map(shown, pair))


def shown(value):
    if value is None or value == MISSING:
        return "-"
    text = json.dumps(value[1], ensure_ascii=False)
    return f"date {text}" if value[0] == "date" else text


def rows_of(names):
    """The rows of the table for these books, without their reasons, and as regular expressions."""
    for line in TABLE.read_text(encoding="utf-8").splitlines():
        if line.startswith("#") or line.split(" | ")[0] not in names:
            continue
        row, _, reason = line.rpartition(" | ")
        if not reason.strip():
            sys.exit(f"{TABLE}: no reason: {line}")
        yield row, re.compile(".*".join(map(re.escape, row.split("*"))))


compared = collections.Counter()
found = set()
books = [pathlib.Path(name) for name in sys.argv[4:]]
for each in books:
    imported = ours(each)
    for name_of_reader in READERS:
        for difference in differences(each, imported, name_of_reader):
            found.add(" | ".join((each.name, name_of_reader, *difference)))
explained = set()
failed = False
for row, pattern in rows_of({each.name for each in books}):
    matches = set(filter(pattern.fullmatch, found))
    explained |= matches
    if not matches:
        print("no longer seen:", row)
        failed = True
for row in sorted(found - explained):
    print("without a reason:", row)
    failed = True
print(f"{len(books)} books, {len(found)} differences; values read by " +
      ", ".join(f"{name}: {count}" for name, count in compared.items()))
sys.exit(failed)
