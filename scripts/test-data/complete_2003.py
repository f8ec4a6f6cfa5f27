"""Gives every table of an XML Spreadsheet 2003 document its size and takes the prefix "ss:" off the
element names: complete_2003.py DOCUMENT RESULT"""
import re
import sys
from xml.etree import ElementTree

NAMESPACE = "{urn:schemas-microsoft-com:office:spreadsheet}"


def number(element, name, default):
    return int(element.get(NAMESPACE + name, default))


def size(table):
    rows = columns = 0
    for row in table.iter(NAMESPACE + "Row"):
        rows = number(row, "Index", rows + 1)
        column = 0
        for cell in row.iter(NAMESPACE + "Cell"):
            column = number(cell, "Index", column + 1) + number(cell, "MergeAcross", 0)
            columns = max(columns, column)
    return rows, columns


source, result = sys.argv[1:]
with open(source, encoding="utf-8", newline="") as document:
    text = document.read()
sizes = iter([size(table) for table in ElementTree.fromstring(text.encode()).iter(
    NAMESPACE + "Table")])


def sized(match):
    return '<Table ss:ExpandedColumnCount="%d" ss:ExpandedRowCount="%d"' % next(sizes)[::-1]


text = re.sub(r"<(/?)(?:ss|x):", r"<\1", text)
text = re.sub(r"<Table\b", sized, text)
with open(result, "w", encoding="utf-8", newline="") as document:
    document.write(text)
