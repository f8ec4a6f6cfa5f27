"""Prints what an import of a file must give: expected.py FILE OPENPYXL_JSON SHEETJS_JSON

The two lists of cells come from readers that know nothing of the import and must agree. What is
added here are the import's own rules: which worksheets and columns there are, their names, kinds,
values and how they are shown.
"""
import json
import math
import re
import sys
from xml.etree import ElementTree

import number_formats as formats

NAMESPACE = "{urn:schemas-microsoft-com:office:spreadsheet}"
MISSING, LIMIT, LONGEST_TEXT = 1.23456e30, 1.001e18, 80
NUMBER = re.compile(r"([+-]?\d+(\.\d*)?|-?\.\d+)(e[+-]?\d+)?", re.IGNORECASE | re.ASCII)
ESCAPE = re.compile("_x([0-9A-F]{4})_", re.IGNORECASE)


class Cell:
    """A number or a text, and the format of its style: (code, is date-time) or None."""

    def __init__(self, value, style=None):
        self.value = value
        self.style = style

    def is_text(self):
        return isinstance(self.value, str)

    def is_date(self):
        return not self.is_text() and self.style is not None and self.style[1]

    def text(self):
        if self.is_text():
            return self.value
        return "*" if self.value == MISSING else formats.show(self.value, self.style)

    def number(self):
        """(the number, None when missing; whether a content was lost)"""
        value = self.value
        if self.is_text():
            text = value.strip(" \t\n\v\f\r")
            if text[:1] + text[-1:] == "()":
                text = "-" + text[1:-1]
            value = float(text) if NUMBER.fullmatch(text) else MISSING
        return (value, False) if -LIMIT <= value <= LIMIT else (None, True)


def unescaped(text):
    """Without the escapes of control characters and of the underscore; a digit is upper case."""
    def character(match):
        escape = match[0]
        if escape == "_x005F_":
            return "_"
        if not "_x0001_" <= escape <= "_x001F_":
            return escape
        return chr(16 * (escape[4] == "1") + max("0123456789ABCDEF".find(escape[5]), 0))
    return re.sub(r"_x00.._", character, text)


def fold(kind, value):
    """A cell's type and value in the form in which both readers' cells are compared."""
    if kind == "s":  # one reader takes escapes out, the other does not
        while (plain := ESCAPE.sub(lambda match: chr(int(match[1], 16)), value)) != value:
            value = plain
        return kind, re.sub("\r\n?", "\n", value)
    if kind == "b":
        return "n", float(value)
    return kind, None if kind == "e" else float(value)


def cells_of(sheet):
    return {(cell[0], cell[1]): cell[2:] for cell in sheet["cells"]
            if cell[2] != "s" or cell[3].strip(" ")}


def same(one, other):
    """The readers work out the day numbers of dates written as text, and round differently."""
    return one == other or one[0] == other[0] == "n" and abs(one[1] - other[1]) < 1e-10


def check_agreement(first, second):
    """Dates as text (type d) are numbers to one reader and are left out."""
    assert [s["name"] for s in first] == [s["name"] for s in second], (first, second)
    for one, other in zip(first, second):
        one, other = cells_of(one), cells_of(other)
        for place in sorted(set(one) | set(other)):
            a, b = one.get(place), other.get(place)
            if a and b and a[0] == "d":
                continue
            assert a and b and same(fold(*a[:2]), fold(*b[:2])), (place, a, b)


def package_sheets(book):
    """The worksheets of a package: (name, cells by row and column)."""
    own = dict(list((int(k), v) for k, v in book["codes"].items())[:book["count"] or 0])

    def style(number):
        known = formats.built_in(number) if number is not None else None
        return known or (formats.style(own[number]) if own.get(number) else None)

    for sheet in book["sheets"]:
        cells = {}
        for place, (kind, value, number, shared) in cells_of(sheet).items():
            if kind == "e" or shared and not book["counts texts"]:
                continue  # a table of shared texts that does not count them counts as empty
            if kind == "d":  # the number with which the text begins
                value = re.match(r"\d+", value)[0]
            cells[place] = Cell(unescaped(value) if kind == "s" else float(value), style(number))
        yield sheet["name"], cells


def attribute(element, name, default=None):
    return element.get(NAMESPACE + name, default)


def document_styles(root):
    styles, current = {}, None
    for element in root.iter():
        if element.tag == NAMESPACE + "Style":
            current = attribute(element, "ID")
        elif element.tag == NAMESPACE + "NumberFormat" and attribute(element, "Format"):
            styles.setdefault(current, formats.style(attribute(element, "Format")))
    return styles


def numbered(elements):
    """Elements with their 0-based places, after their own indexes."""
    place = -1
    for element in elements:
        place = int(attribute(element, "Index", place + 2)) - 1
        yield place, element
        place += int(attribute(element, "MergeAcross", 0))


def document_sheets(path, book):
    """The worksheets of an XML Spreadsheet 2003 document. The readers find the values, the document
    itself says which style a cell has: that of its column, else of its row, else its own."""
    root = ElementTree.parse(path).getroot()
    styles = document_styles(root)
    tables = root.iter(NAMESPACE + "Table")
    for sheet, table in zip(book["sheets"], tables):
        found, cells = cells_of(sheet), {}
        columns = {place: attribute(column, "StyleID")
                   for place, column in numbered(table.findall(NAMESPACE + "Column"))}
        if attribute(table, "ExpandedRowCount") is None:
            found = {}  # a table that does not say how long it is gives nothing
        for row_place, row in numbered(table.findall(NAMESPACE + "Row")):
            for place, cell in numbered(row.findall(NAMESPACE + "Cell")):
                kind, value = found.get((row_place, place), ("e", None))[:2]
                if kind == "e":
                    continue
                ids = columns.get(place), attribute(row, "StyleID"), attribute(cell, "StyleID")
                style = next((styles[each] for each in ids if each in styles), None)
                if cell.find(NAMESPACE + "Data").get(NAMESPACE + "Type") == "DateTime":
                    days = math.floor(value)
                    value = days + round((value - days) * 86400000) / 86400000
                elif kind == "n":
                    value = float(cell.find(NAMESPACE + "Data").text)
                cells[row_place, place] = Cell(value if kind == "s" else float(value), style)
        yield sheet["name"], cells


def cut(text):
    """A text as a host gets it, zero-terminated."""
    return text.encode()[:LONGEST_TEXT].split(b"\0")[0].decode(errors="replace")


def variable_name(cell):
    name = cut(cell.text()) if cell else ""
    name = name.replace("\n", " ").strip(" \t\n\v\f\r")
    return re.sub(r"^\*|['#]|[\x00-\x1f\x7f]", "_", name)


def column(cells):
    """A column of a worksheet with names in its first row, from its cells by row."""
    data = {row: cell for row, cell in cells.items() if row > 0}
    rows = max(data, default=0)
    first = data[min(data)] if data else Cell(0.0)
    result = {"name": variable_name(cells.get(0)),
              "kind": "text" if first.is_text() else "date-time" if first.is_date() else "numeric"}
    if result["kind"] == "text":
        values = [cut(data[row].text()) if row in data else "" for row in range(1, rows + 1)]
        values = [value if value.strip(" ") else None for value in values]
    else:
        numbers = {row: cell.number() for row, cell in data.items()}
        values = [numbers.get(row, (None, False))[0] for row in range(1, rows + 1)]
        result["converted"] = sum(lost for _, lost in numbers.values())
        present = [row for row in sorted(data) if numbers[row][0] is not None]
        if present:
            assert first.is_date() == data[present[0]].is_date()  # the kind shows in the column
            result["shown"] = formats.show(numbers[present[0]][0], data[present[0]].style)
    return result | {"missing": values.count(None), "values": values}


def main(path, openpyxl_path, sheetjs_path):
    with open(openpyxl_path) as one, open(sheetjs_path) as other:
        book, second = json.load(one), json.load(other)
    check_agreement(book["sheets"], second)
    if path.endswith(".xml"):
        with open(path, encoding="utf-8") as document:
            if not re.search("<Worksheet[ >]", document.read()):
                print('{"error": 13}')  # only elements without a prefix are worksheets
                return
        sheets = document_sheets(path, book)
    else:
        sheets = package_sheets(book)
    lines = []
    for name, cells in sheets:
        places = sorted({place[1] for place in cells})
        if places:
            columns = [column({row: cell for (row, at), cell in cells.items() if at == place})
                       for place in places]
            body = ",\n  ".join(json.dumps(each, ensure_ascii=False) for each in columns)
            lines.append(f'{{"name": {json.dumps(name, ensure_ascii=False)}, "columns": [\n  {body}\n]}}')
    print('{"sheets": [' + ", ".join(lines) + "]}")


main(*sys.argv[1:])
