#!/usr/bin/env python3
"""Runs the built dpxlsx as a user would. Usage: tool_test.py DPXLSX SOURCE_FOLDER [TEST...]"""

import csv
import fcntl
import html
import io
import json
import os
import pathlib
import pty
import re
import resource
import signal
import shlex
import shutil
import string
import struct
import subprocess
import sys
import tempfile
import termios
import unittest
import zipfile

import jsonschema

TOOL = os.path.abspath(sys.argv.pop(1))
SOURCE = pathlib.Path(sys.argv.pop(1)).absolute()
SAMPLE = SOURCE / "samples" / "sample.xlsx"


SCHEMA = jsonschema.Draft202012Validator(
    json.loads((SOURCE / "docs" / "tool.schema.json").read_text()))
SPREADSHEET = "http://schemas.openxmlformats.org/spreadsheetml/2006/main"
RELATIONSHIPS = "http://schemas.openxmlformats.org/officeDocument/2006/relationships"
WORKBOOK, LINKS, STYLES, STRINGS, SHEET = (
    "xl/workbook.xml", "xl/_rels/workbook.xml.rels", "xl/styles.xml", "xl/sharedStrings.xml",
    "xl/worksheets/sheet1.xml")
# A small workbook without a surprise: a name and a text, a name and a date.
PARTS = {
    WORKBOOK: f'<workbook xmlns="{SPREADSHEET}" xmlns:r="{RELATIONSHIPS}"><workbookPr/><sheets>'
              '<sheet name="My Data" sheetId="1" r:id="a"/></sheets></workbook>',
    LINKS: '<Relationships xmlns="http://schemas.openxmlformats.org/package/2006/relationships">'
           f'<Relationship Id="a" Type="{RELATIONSHIPS}/worksheet" Target="worksheets/sheet1.xml"/>'
           '</Relationships>',
    STYLES: f'<styleSheet xmlns="{SPREADSHEET}"><numFmts count="1">'
            '<numFmt numFmtId="164" formatCode="m/d/yyyy"/></numFmts>'
            '<cellXfs count="2"><xf numFmtId="0"/><xf numFmtId="164"/></cellXfs></styleSheet>',
    STRINGS: f'<sst xmlns="{SPREADSHEET}" uniqueCount="2"><si><t>Name</t></si>'
             '<si><t>Oslo</t></si></sst>',
    SHEET: f'<worksheet xmlns="{SPREADSHEET}"><sheetData>'
           '<row r="1"><c r="A1" t="s"><v>0</v></c><c r="B1" t="s"><v>0</v></c></row>'
           '<row r="2"><c r="A2" t="s"><v>1</v></c><c r="B2" s="1"><v>45296</v></c></row>'
           '</sheetData></worksheet>',
}
CELL = '<c r="B2" s="1"><v>45296</v></c>'


def packed(target, parts, packing=zipfile.ZIP_STORED):
    """Writes a package of these parts, those that are None left out."""
    with zipfile.ZipFile(target, "w", packing) as made:
        for name, content in parts.items():
            if content is not None:
                made.writestr(name, content)
    return target


def prefixed(*names):
    """The small workbook with a prefix on all elements of some parts."""
    return {**PARTS, **{name: re.sub("<(/?)(?=[A-Za-z])", r"<\1x:", PARTS[name]).replace(
        "xmlns=", "xmlns:x=") for name in names}}


def changed(name, old, new):
    assert old in PARTS[name]
    return {**PARTS, name: PARTS[name].replace(old, new)}


def renamed(old, new, **more):
    return {**PARTS, old: None, new: PARTS[old], **more}


def with_format(code):
    return changed(STYLES, "m/d/yyyy", html.escape(code))


def styled(number, code, first=0):
    """The small workbook with a code under this number for its date, and a number for the first style."""
    return {**PARTS, STYLES: with_format(code)[STYLES].replace("164", str(number)).replace(
        '<xf numFmtId="0"/>', f'<xf numFmtId="{first}"/>')}


SHEET_OF = f'<worksheet xmlns="{SPREADSHEET}"><sheetData>{{}}</sheetData></worksheet>'


def rows(*cells):
    """The small workbook with a name and these cells, one in a row."""
    return {**PARTS, SHEET: SHEET_OF.format('<row r="1"><c r="A1" t="s"><v>0</v></c></row>' + "".join(
        f'<row r="{r}">{cell}</row>' for r, cell in enumerate(cells, start=2)))}


def compound(stream):
    """As much of a compound file as its stream's name needs."""
    name = (stream + "\0").encode("utf-16-le")
    entry = name.ljust(64, b"\0") + bytes([len(name), 0, 2])
    return b"\xd0\xcf\x11\xe0\xa1\xb1\x1a\xe1".ljust(1024, b"\0") + entry.ljust(128, b"\0")


# The traits of a book, the book, what the line about it says, and how a plain import ends.
TRAITS = [
    ("", PARTS, "nothing to explain", 0),
    ("namespace-prefix", prefixed(WORKBOOK), r"elements have a.* <x:sheets> \(in xl/workbook.xml\)", 13),
    ("namespace-prefix", prefixed(LINKS), "<x:Relationships>.*the import fails", 13),
    ("namespace-prefix", changed(WORKBOOK, "r:", "q:") | {
        WORKBOOK: PARTS[WORKBOOK].replace("xmlns:r", "xmlns:q").replace("r:id", "q:id")},
     "r:id has another prefix", 13),
    ("namespace-prefix", prefixed(SHEET), 'worksheet "My Data" comes out empty', 0),
    ("namespace-prefix", prefixed(STRINGS, STYLES),
     "shared texts are missing, dates arrive as day numbers", 0),
    ("shared-strings-without-count", changed(STRINGS, ' uniqueCount="2"', ""),
     r"missing \(3 cells\)", 0),
    ("shared-strings-missing", {**PARTS, STRINGS: None}, r"3 cells \(first: My Data!A1\)", 0),
    ("shared-strings-missing", changed(SHEET, "<v>1</v>", "<v>2</v>"), r"1 cell \(My Data!A2\)", 0),
    ("cdata-texts", changed(STRINGS, "Oslo", "<![CDATA[Oslo]]>"), r"1 cell \(My Data!A2\) with .* CDATA", 0),
    ("lost-on-conversion", changed(SHEET, "</sheetData>", '<row r="3"><c r="B3" t="s"><v>1</v></c>'
     '</row></sheetData>'), r"1 in My Data!B \(Name\): a missing .* --type 'My Data!B=text'", 0),
    ("long-texts", changed(STRINGS, "Oslo", "é" * 41), "1 text longer than 80 bytes: 1 in My Data!A"
     r" \(Name\).*--max-text 82", 0),
    ("long-texts", changed(STRINGS, "Name", "n" * 79 + " long"), "2 texts .*1 in My Data!B .* 84", 0),
    ("shown-in-texts", rows('<c r="A2" t="s"><v>1</v></c>', '<c r="A3" s="1"><v>45296.5</v></c>',
                            '<c r="A4"><v>0.1234567891234</v></c>', '<c r="A5"><v>7</v></c>'),
     r"1 number or date in columns of texts: 1 in My Data!A \(Name\)", 0),
    ("formulas-without-values", rows('<c r="A2"><f>1+1</f></c>', '<c r="A3"><f>B2</f><v>5</v></c>',
                                     '<c r="A4" t="str"><f>B2</f><v></v></c>'),
     r"1 formula \(My Data!A2\)", 0),
    ("numbers-as-names", {**PARTS, SHEET: SHEET_OF.format(
        '<row r="1"><c r="A1"><v>1</v></c></row><row r="2"><c r="A2"><v>2</v></c></row>')},
     r"1 number \(My Data!A1\).*--names none", 0),
    ("mixed-dates", rows('<c r="A2" s="1"><v>45296</v></c>', '<c r="A3" t="b"><v>1</v></c>',
                         '<c r="A4"><v>7.5</v></c>'), "one column: 2 in My Data!A: ", 0),
    ("mixed-dates", rows('<c r="A2"><v>7</v></c>', '<c r="A3" s="1"><v>45296</v></c>'),
     "1 in My Data!A: the first value", 0),
    ("worksheet-without-part", changed(WORKBOOK, "</sheets>", '<sheet name="Lost" r:id="b"/></sheets>'),
     'worksheet "Lost" for which .*: it is not imported', 0),
    ("worksheet-without-part", {**changed(LINKS, "</R", '<Relationship Id="b" Type="/worksheet" Target=""/>'
     "</R"), WORKBOOK: PARTS[WORKBOOK].replace("</sheets>", '<sheet name="L" r:id="c"/><sheet name="M" r:id="b"/>'
                                               "</sheets>")}, 'worksheets "L", "M" .*they are', 0),
    ("iso-dates", changed(SHEET, CELL, '<c r="B2" t = \'d\'><v>2024-01-05</v></c>'),
     r"1 date \(My Data!B2\).*the year of a date", 0),
    ("date-system-1904", changed(WORKBOOK, "<workbookPr", '<workbookPr date1904="true"'),
     "1,462 days early; use --standard, or add 1462", 0),
    ("password-protected", compound("EncryptedPackage"), "protected with a password", 22),
    ("old-workbook", compound("Workbook"), "old binary format", 22),
    ("old-workbook", compound("Book"), "old binary format", 22),
    ("not-a-package", compound("WordDocument"), "old office program", 22),
    ("spreadsheet-2003", '<?xml version="1.0"?><Workbook xmlns="urn:schemas-microsoft-com:office:'
     'spreadsheet"/>', "XML Spreadsheet 2003", 22),
    ("web-page", "<HTML><body><table/>", "web page", 22),
    ("plain-text", "a;b\n1;2\n", "plain text", 22),
    ("not-a-package", "\0\1\2", "no workbook of any known kind", 22),
    ("empty-file", "", "file is empty", 22),
    ("cut-package", "PK\3\4...", "cut off", 22),
    ("open-document", {"mimetype": "x", "content.xml": "<x/>"}, r"\.ods", 25),
    ("text-document", {"word/document.xml": "<x/>"}, r"\.docx", 25),
    ("presentation", {"ppt/presentation.xml": "<x/>"}, r"\.pptx", 25),
    ("binary-workbook", {"xl/workbook.bin": "x"}, r"\.xlsb", 25),
    ("other-archive", {"photo.jpg": "x"}, "ZIP archive without a workbook", 25),
    ("no-style-sheet", {**PARTS, STYLES: None}, "no style sheet", 25),
    ("part-names", renamed(STRINGS, "xl/SharedStrings.xml"), "shared texts are missing", 0),
    ("part-names", renamed(SHEET, "XL\\worksheets\\Sheet1.xml"), "the import fails", 13),
    ("part-names", renamed(WORKBOOK, "book/main.xml", **{
        LINKS: None, "book/_rels/main.xml.rels": PARTS[LINKS], "book/worksheets/sheet1.xml":
        PARTS[SHEET], "_rels/.rels": PARTS[LINKS].replace(
            "worksheets/sheet1", "/book/main").replace("worksheet", "officeDocument")}),
     'has "book/main.xml" where "xl/workbook.xml" belongs', 25),
    ("taken-for-dates", with_format("[Red]0.00"), "--type 'My Data!B=numeric'", 0),
    ("taken-for-dates", with_format('0" days"'), '"0" days""', 0),
    ("not-taken-for-dates", with_format("DD/MM/YYYY"), "--type 'My Data!B=datetime'", 0),
    ("not-taken-for-dates", changed(STYLES, '<xf numFmtId="164"/>', '<xf numFmtId="31"/>'),
     "built-in 31", 0),
    ("number-format-count", changed(STYLES, ' count="1"', ""),
     r"1 date \(My Data!B2\).*\(the count of numFmts\).*'My Data!B=datetime'", 0),
    ("number-format-count", changed(STYLES, "<numFmt ", '<numFmt numFmtId="170" formatCode="0.0"/>'
     "<numFmt "), '"m/d/yyyy": day numbers arrive', 0),
    ("long-format-codes", with_format("d" * 1025), "1,024 bytes.*day numbers arrive; read .*'My Data!B=datetime'"
     ", or use a shorter code", 0),
    ("built-in-format-ids", styled(14, "0.00"), 'own under .*: "0.00": date-times arrive; .*B=numeric', 0),
    ("built-in-format-ids", styled(2, "m/d/yyyy"), "own under .*: day numbers arrive; .*B=datetime", 0),
    ("unlisted-formats", {**PARTS, STYLES: PARTS[STYLES].replace('"164" f', '"165" f').replace('t="1"', 't="2"').replace(
        "</styleSheet>", '<dxfs><dxf><numFmt numFmtId="164" formatCode="d/m"/></dxf></dxfs></styleSheet>')},
     'outside the list .*: "d/m": date-times arrive', 0),
    ("cells-without-style", {**styled(164, "m/d/yyyy", first=164), SHEET: PARTS[SHEET].replace(' s="1"', "")},
     r'1 date \(My Data!B2\) in cells without a style number, .*: "m/d/yyyy": day numbers arrive', 0),
    ("default-date-style", with_format("dd\\.mm\\.yyyy"), '"dd.mm.yyyy".*default date style', 0),
    ("default-date-style", with_format("[HH]:mm"), "values are right", 0),
    ("taken-for-dates", with_format('0.0_h"dmy"\\s*y[>5]'), "0.0_h", 0),
    ("merged-cells", changed(SHEET, "</sheetData>", '</sheetData><mergeCells>'
     '<mergeCell ref="A1:B1"/><mergeCell ref="A2:B2"/></mergeCells>'),
     r"2 merged ranges \(first: My Data!A1:B1\)", 0),
    ("phonetic-texts", changed(STRINGS, "Oslo</t>", "Oslo</t><rPh><t>o</t></rPh>"
     "<rPh><t>s</t></rPh>"), r"1 cell \(My Data!A2\) with .*appended", 0),
    ("phonetic-texts", changed(SHEET, CELL, '<c r="B2" t="inlineStr"><is><t>a</t><rPh><t>b</t>'
     '</rPh></is></c>'), "1 inline text .*replace", 0),
    ("error-cells", changed(SHEET, CELL, '<c r="B2" t="e"><v>#N/A</v></c>'), "1 cell ", 0),
    ("hidden-worksheets", changed(WORKBOOK, "<sheet ", '<sheet state="veryHidden" '),
     "--exclude-sheet 'My Data'", 0),
    ("inline-runs", changed(SHEET, CELL, '<c r="B2" t="inlineStr"><is><r><t>a</t></r><r><t>b</t>'
     '</r></is></c>'), "only the last piece", 0),
    ("inline-values", changed(SHEET, CELL, '<c r="B2" t="inlineStr"><v>1.0</v><is><t>1.</t></is></c>'),
     r"1 cell \(My Data!B2\) with an inline text and a value", 0),
    ("values-in-pieces", rows('<c r="A2"><v>1<![CDATA[5]]></v></c>', '<c r="A3"><v>1<!-- . -->5</v></c>'),
     r"2 cells \(first: My Data!A2\) with .* divided by .*: only the first piece", 0),
    ("values-in-pieces", rows('<c r="A2" t="inlineStr"><is><t>a<![CDATA[b]]></t></is></c>'), r"1 cell \(My Data!A2\)", 0),
    ("booleans-as-words", rows('<c r="A2" t="b"><v> true </v></c>', '<c r="A3" t="b"><v>false</v></c>',
                               '<c r="A4" t="b"><v>TRUE</v></c>'), r"2 Booleans \(first: My Data!A2\)", 0),
    ("booleans-as-words", rows('<c r="A2" t="b"><v>on</v></c>', '<c r="A3" t="b"><v>off</v></c>'), "1 Boolean ", 0),
    ("not-a-boolean", rows('<c r="A2" t="b"><v>1</v></c>', '<c r="A3" t="b"><v>yes</v></c>'),
     r'1 cell \(My Data!A3\) of type Boolean with "yes": .* or 0; let the .* write 0 or 1', 0),
    ("not-a-number", rows('<c r="A2"><v>1,5</v></c>', '<c r="A3" t="n"><v>abc</v></c>', '<c r="A4"><v> </v></c>'),
     r'3 cells \(first: My Data!A2\) .* such as "1,5": the number at the beginning .* or 0', 0),
    ("not-a-number", rows('<c r="A2"><v>0x10</v></c>'), '1 cell .* with "0x10": .* arrives .0x10 is 16', 0),
    ("lower-case-references", rows('<c r="a2"><v>1</v></c>', '<c r="Ab3"><v>2</v></c>'),
     r"2 cells \(first: My Data!a2\).* in column AG, the others", 0),
    ("lower-case-references", rows('<c r="aaa2"><v>1</v></c>'), r"1 cell \(My Data!aaa2\).*the import fails", 13),
    ("unreadable", changed(SHEET, "</sheetData>", ""), '"xl/worksheets/sheet1.xml" is .*damaged', 13),
    ("unreadable", {**PARTS, SHEET: None}, "is missing or damaged", 13),
]
CURED_BY_STANDARD = {
    "namespace-prefix", "shared-strings-without-count", "iso-dates", "date-system-1904", "no-style-sheet",
    "part-names", "taken-for-dates", "not-taken-for-dates", "number-format-count", "default-date-style",
    "built-in-format-ids", "unlisted-formats", "cells-without-style",
    "phonetic-texts", "inline-runs", "inline-values", "cdata-texts", "values-in-pieces", "booleans-as-words",
    "lower-case-references"}
# The traits that a plain import mentions when it succeeds.
WORST = ("namespace-prefix", "shared-strings-without-count", "iso-dates", "date-system-1904",
         "shared-strings-missing", "worksheet-without-part")


def repacked(target, change, packing=zipfile.ZIP_STORED):
    """Writes the sample to `target`, its parts passed through change(name, bytes) first."""
    with zipfile.ZipFile(SAMPLE) as source, zipfile.ZipFile(target, "w", packing) as made:
        for name in source.namelist():
            content = change(name, source.read(name))
            if content is not None:
                made.writestr(name, content)
    return target


class ToolTest(unittest.TestCase):
    def setUp(self):
        self.folder = pathlib.Path(tempfile.mkdtemp())
        self.addCleanup(shutil.rmtree, self.folder)
        self.temporary = self.folder / "temporary"
        self.temporary.mkdir()

    def tearDown(self):
        self.assertEqual(list(self.temporary.iterdir()), [], "left in the temporary directory")

    def environment(self, **more):
        kept = {k: v for k, v in os.environ.items() if k not in ("COLUMNS", "DPXLSX_LIBRARY")}
        return {**kept, "TMPDIR": str(self.temporary), **more}

    def run_tool(self, *arguments, expected=0, **more):
        """What the tool prints, on standard error when it is to fail; notes go to self.notes."""
        done = subprocess.run([TOOL, *map(str, arguments)], capture_output=True, timeout=120,
                              cwd=self.folder, env=self.environment(**more), check=False)
        errors = done.stderr.decode()
        self.assertEqual(done.returncode, expected, f"{arguments}: {errors}")
        self.notes = errors.splitlines()
        for line in self.notes:
            self.assertRegex(line, "^dpxlsx: ")
        if expected != 0:
            self.assertEqual(len(self.notes), 1, errors)
        return done.stdout.decode() if expected == 0 else errors

    def book(self, content, name="book.xlsx"):
        path = self.folder / name
        if isinstance(content, dict):
            return packed(path, content)
        path.write_bytes(content if isinstance(content, bytes) else content.encode())
        return path

    def read(self, *arguments):
        book = json.loads(self.run_tool(SAMPLE, "--json", *arguments))
        SCHEMA.validate(book)
        return book["worksheets"]

    def columns(self, *arguments):
        return {c["name"]: c for c in self.read(*arguments)[0]["columns"]}

    def test_tables_show_layout_columns_and_values(self):
        text = self.run_tool(SAMPLE)
        for line in ("Worksheet 1: Measurements",
                     "14 columns, 12 rows of data; variable names in row 1, data from row 2",
                     "  9         9  Taken       datetime    12        2          0  "
                     "date-time, M/d/yy H:mm",
                     "and 2 more rows", "Worksheet 2: Readings 2024"):
            self.assertIn(line, text)
        city = [line for line in text.splitlines() if "東京" in line or "Zürich" in line]
        # 東京 takes as many cells as four letters.
        self.assertEqual(city[0].index("Zürich"), city[1].index("東京"))
        self.assertEqual(city[0].index("first"), city[1].index("two") + 2)
        self.assertIn("two␊lines", city[1])

    def test_lines_are_cut_to_the_width(self):
        for line in self.run_tool(SAMPLE, COLUMNS="50").splitlines():
            self.assertLessEqual(len(line), 50)

    def on_terminal(self, *arguments, size=(30, 60)):
        """All that a terminal of this size would show, and the exit code."""
        master, terminal = pty.openpty()
        fcntl.ioctl(terminal, termios.TIOCSWINSZ, struct.pack("HHHH", *size, 0, 0))
        child = subprocess.Popen([TOOL, *map(str, arguments)], stdout=terminal, stderr=terminal,
                                 env=self.environment())
        os.close(terminal)
        shown = b""
        try:
            while block := os.read(master, 4096):
                shown += block
        except OSError:
            pass
        os.close(master)
        return shown.decode(), child.wait()

    def test_a_terminal_sees_progress_and_fitting_lines(self):
        shown, code = self.on_terminal(SAMPLE)
        self.assertEqual(code, 0)
        self.assertTrue(shown.startswith("\r\x1b[KOpening "))
        self.assertIn(": 0 %\r", shown)
        self.assertIn(": 100 %\r", shown)
        lines = re.sub("(\r\x1b\\[K[^\r\n]*)*\r\x1b\\[K", "", shown).replace("\r", "").splitlines()
        self.assertIn("Worksheet 1: Measurements", lines)
        self.assertEqual([line for line in lines if line.startswith("dpxlsx: ")], lines[-2:])
        del lines[-2:]  # notes go whole
        plain = [line for line in lines if line.isascii() or line.endswith("…")]
        self.assertLessEqual(max(map(len, plain)), 60)

    def test_list(self):
        self.assertEqual(self.run_tool(SAMPLE, "--list"), "Measurements\nReadings 2024\nEmpty\n")

    def test_json_holds_values_in_full(self):
        first, second = self.read()
        self.assertEqual(first["layout"],
                         {"nameRow": 1, "firstDataRow": 2, "rows": 12, "lastUsedRow": 13})
        columns = {c["name"]: c for c in first["columns"]}
        self.assertEqual(columns["General"]["values"][:4], 
                         [0.1428571428571428, 0.2857142857142857, 0.4285714285714285, None])
        self.assertEqual(columns["Percent"]["shown"][2], "12.5%")
        self.assertEqual(columns["Taken"]["values"][0], 45348.28125)
        self.assertEqual(columns["Taken"]["iso"][0], "2024-02-26T06:45:00")
        self.assertEqual(columns["Taken"]["shown"][:2], ["2/26/24 6:45", None])
        self.assertEqual(columns["City"]["values"][3:6], ["東京", "서울", "القاهرة"])
        self.assertEqual(columns["Count"]["convertedMissing"], 1)
        self.assertEqual(second["key"], 2)
        for column in first["columns"] + second["columns"]:
            self.assertEqual(column["values"].count(None), column["missing"], column["name"])

    def test_csv(self):
        rows = list(csv.reader(io.StringIO(self.run_tool("--csv", SAMPLE, "--sheet", "1"))))
        self.assertEqual(len(rows), 13)
        columns = self.columns()
        self.assertEqual(rows[0], list(columns))
        for name, column in columns.items():
            texts = [row[rows[0].index(name)] for row in rows[1:]]
            wanted = column.get("iso", column["values"])
            for text, value in zip(texts, wanted):
                same = float(text) == value if isinstance(value, (int, float)) else text == (
                    value or "")
                self.assertTrue(same, (name, text, value))
        shown = self.run_tool(SAMPLE, "--csv", "--as-shown", "--sheet", "1", "--head", 1)
        self.assertEqual(shown.splitlines()[1].split(",")[2:6],
                         ["-3.00", "0.0%", "1.25E-04", "19.99"])
        self.run_tool(SAMPLE, "--csv", "out/")
        self.assertEqual(sorted(p.name for p in (self.folder / "out").iterdir()),
                         ["Measurements.csv", "Readings 2024.csv"])
        self.assertRegex(self.run_tool(SAMPLE, "--csv", "one.csv", expected=2),
                         r'"Measurements" \(1\), "Readings 2024" \(2\); add --sheet')

    def test_worksheet_titles_make_safe_file_names(self):
        title = b"../../up"
        book = repacked(self.folder / "evil.xlsx", lambda name, content: content.replace(
            b"Measurements", title) if name == "xl/workbook.xml" else content)
        self.run_tool(book, "--csv", "out/", "--sheet", "../../up")
        self.assertEqual([p.name for p in (self.folder / "out").iterdir()], ["_.._.._up.csv"])

    def test_options_change_results(self):
        cases = [
            (["--names", "none"], lambda c: c[""]["kind"] == "text"),
            (["--name-row", "2", "--rows", "2"],
             lambda c: c["Zürich"]["values"] == ["Αθήνα", "Київ"]),
            (["--first-row", "5"], lambda c: c["Id"]["values"][0] == 4),
            (["--head", "2"], lambda c: c["Id"]["values"] == [1, 2]),
            (["--sheet", "Readings 2024", "--skip-blank-rows"],
             lambda c: c[""]["rows"] == 5),
            (["--pad"], lambda c: c["Sum"]["rows"] == 12),
            (["--clean-text"], lambda c: c["Comment"]["values"][4] == "spaces around"),
            (["--dates-as-text"], lambda c: c["Taken"]["values"][0] == "2/26/24 6:45"),
            (["--decimal", ","], lambda c: c["Fixed"]["shown"][1] == "-0,50"),
            (["--missing", "-3"], lambda c: c["Count"]["values"][4] is None),
            (["--missing-number", "12=missing"], lambda c: c["Count"]["values"][0] is None),
            (["--missing-word", "n/a=-1"], lambda c: c["Count"]["values"][2] == -1),
            (["--missing-text", "NA=none"], lambda c: c["Comment"]["values"][6] == "none"),
            (["--max-text", "3"], lambda c: c["Com"]["values"][0] == "fir"),
            (["--max-name", "2"], lambda c: "Co" in c),
            (["--range", "-1:10"], lambda c: c["Count"]["values"][:2] == [None, 7]),
            (["--type", "A=text"], lambda c: c["Id"]["values"][0] == "1"),
            (["--type", "1!2=datetime"], lambda c: c["General"]["iso"][6] == "1900-01-01"),
            (["--exclude", "b"], lambda c: "General" not in c),
            (["--exclude", "Measurements!B"], lambda c: "General" not in c),
            (["--exclude-sheet", "1"], lambda c: len(c) == 1),
            (["--rename", "Measurements!B=a=b!"], lambda c: "a=b!" in c),
            (["--position", "C=40"], lambda c: c["Fixed"]["position"] == 40),
        ]
        def is_so(holds, arguments):
            try:
                return holds(self.columns(*arguments))
            except (KeyError, IndexError):
                return False
        for arguments, holds in cases:
            with self.subTest(arguments):
                self.assertTrue(holds(self.columns(*arguments)))
                options = [i for i, word in enumerate(arguments) if re.match("--[a-z]", word)] + [len(arguments)]
                for begin, end in zip(options, options[1:]):
                    left = arguments[:begin] + arguments[end:]
                    self.assertFalse(is_so(holds, left), f"the same with {left}")
        self.assertEqual([sheet["layout"]["nameRow"] for sheet in self.read("--names", "infer")], [1, None])

    def test_booleans_take_the_texts_of_the_options(self):
        library = pathlib.Path(TOOL).parent.parent / "lib" / "libboolean_library.so"
        for options, wanted in (([], ["TRUE", "FALSE"]), (["--true", "ja", "--false", "no"], ["ja", "no"])):
            column = self.columns("--library", library, "--type", "K=text", *options)["Passed"]
            self.assertEqual(column["values"][:2], wanted)

    def test_books_are_read_by_the_standard_on_demand(self):
        book = self.book(prefixed(WORKBOOK, LINKS, SHEET))
        self.run_tool(book, expected=13)
        self.assertIn("My Data", self.run_tool(book, "--list", "--standard"))
        self.assertEqual(self.run_tool(book, "--csv", "--standard"),
                         self.run_tool(self.book(PARTS), "--csv"))

    def test_older_library_does_not_read_by_the_standard(self):
        library = (pathlib.Path(TOOL).parent.parent / "lib" / "libdpxlsx.so.1").read_bytes()
        older = self.folder / "older.so"
        older.write_bytes(library.replace(b"\0SetReadingRules\0", b"\0SetReadingRulez\0"))
        self.run_tool(SAMPLE, "--library", older)
        self.assertIn("cannot read by the standard",
                      self.run_tool(SAMPLE, "--standard", "--library", older, expected=4))

    def test_errors_are_not_lost_by_the_standard(self):
        book = self.book(rows("<c r='A2'><v>1</v></c>", "<c r='A3' t='e'><v>#N/A</v></c>"))
        column = json.loads(self.run_tool(book, "--json", "--standard"))["worksheets"][0]["columns"][0]
        self.assertEqual((column["values"], column["convertedMissing"], self.notes), ([1, None], 0, []))

    def test_what_no_option_keeps_is_to_be_corrected(self):
        book = self.book(rows("<c r='A2'><v>1</v></c>", "<c r='A3'><v>1x</v></c>",
                              "<c r='A4' t='b'><v>yes</v></c>", "<c r='A5' t='d'><v>2024-02-30</v></c>",
                              "<c r='A6' t='str'><v>n/a</v></c>"))
        unreadable = r": 3 cells are missing because .*: 3 in My Data!A \(.*\); to keep it, correct them in the workbook$"
        kept = ": 1 cell became missing on conversion: .*--type 'My Data!A=text'$"
        for options, wanted in (([], [kept]), (["--standard"], [kept, unreadable]),
                                (["--standard", "--type", "A=text"], [])):
            with self.subTest(options):
                self.run_tool(book, *options)
                notes = [note for note in self.notes if "to keep" in note]
                self.assertEqual(len(notes), len(wanted), notes)
                for note, text in zip(notes, wanted):
                    self.assertRegex(note, text)
        traits = json.loads(self.run_tool(book, "--explain", "--json", "--standard"))["traits"]
        advice = {t["trait"]: t["advice"] for t in traits}
        self.assertEqual(advice["unreadable-cells"], "to keep the content, correct it in the workbook")
        self.assertIn("My Data!A=text", advice["lost-on-conversion"])

    def test_worksheet_names_are_cleaned_on_demand(self):
        book = self.book(changed(WORKBOOK, "My Data", "a?b:c"))
        for options, wanted in (([], "a?b:c"), (["--clean-sheet-names"], "a_b_c")):
            sheet = json.loads(self.run_tool(book, "--json", *options))["worksheets"][0]
            self.assertEqual(sheet["title"], wanted)

    def test_a_preview_reads_101_rows(self):
        book = json.loads(self.run_tool(self.many_rows(), "--json", "--preview"))
        column = book["worksheets"][0]["columns"][0]
        self.assertEqual((column["values"][0], len(column["values"]), column["rows"]),
                         (2.5, 101, 59999))

    def test_missing_values_show_as_wished(self):
        text = self.run_tool(SAMPLE, "--missing-display", "n.a.", "--sheet", "2", "--head", 1)
        self.assertIn("n.a.", text)

    def test_blank_rows_are_found_without_the_excluded_columns(self):
        sheet = self.read("--sheet", "2", "--names", "none", "--skip-blank-rows",
                          "--exclude", "B", "--exclude", "C")[0]
        self.assertEqual(sheet["columnsLeftOut"], 2)
        self.assertEqual(sheet["columns"][0]["values"], ["sensor 0", "sensor 2", "sensor 4"])

    def test_wrong_usage(self):
        link = self.folder / "link.json"
        kept = shutil.copy(SAMPLE, self.folder / "kept.xlsx")
        link.symlink_to(kept)
        cases = [["--list"], ["--no-such"], [SAMPLE, "--head", "x"], [SAMPLE, "--sheet", "Nowhere"],
                 [SAMPLE, "--names", "none", "--name-row", "3"], [SAMPLE, "--type", "A=colour"],
                 [SAMPLE, "--exclude", "XFE"], [SAMPLE, "--rename", "A"], [SAMPLE, "--range", "5"],
                 [SAMPLE, "--range", "2:1"], [SAMPLE, "--decimal", "1"], [SAMPLE, "--list", "--csv"],
                 [SAMPLE, "--csv", "--json"], [SAMPLE, "--list", "--sheet", "1"],
                 [SAMPLE, "--explain", "--csv"], [SAMPLE, "--explain", "--list"], [SAMPLE, "--rows", "0"], [SAMPLE, "--missing", "nan"],
                 [SAMPLE, "--exclude", "Nowhere!A"], [SAMPLE, "--as-shown"],
                 [SAMPLE, "--missing-word", "a=1", "--missing-number", "1=2"],
                 [kept, "--json", link], ["none", kept, "--json", link], [SAMPLE, "--max-text", "0"], [SAMPLE, "--list=no"],
                 [SAMPLE, "--type", "Measurements!Q=text"], [SAMPLE, "--position", "2!K=1"]]
        for arguments in cases:
            with self.subTest(arguments):
                self.run_tool(*arguments, expected=2)
        messages = [(["--sheet", "Empty"], '"Empty" has no values and is not imported'),
                    (["--sheet", "3"], 'no worksheet "3" with values; it has "Measurements" .1.'),
                    (["--head"], "--head: its value is missing; see"),
                    (["--csv", "a", "--csv", "b"], "--csv: give it once, with one value; see"),
                    (["--bogus"], "--bogus: there is no such option; see"),
                    (["--sheets", "1"], "--sheets: there is no such option; perhaps --sheet; see"),
                    (["--skip"], "perhaps --skip-blank-rows; see"),
                    ([link.with_suffix(".xlsx"), "--csv", "x.csv"], "need a folder for their CSV files: --csv FOLDER/"),
                    ([SAMPLE.with_suffix(".XLSX"), "--csv", "no/"],
                     "sample.xlsx and .*sample.XLSX would both be written to no/sample/; nothing was written"),
                    (["--pad=no"], "--pad: it takes no value; see"),
                    ([SAMPLE, "--page", "x.html"], "--page shows one workbook"),
                    (["--csv", "--explain"], "or --explain with --json"),
                    (["--exclude", "Measurements!Q"], 'the worksheet "Measurements" has no column Q')]
        for arguments, text in messages:
            self.assertRegex(self.run_tool(SAMPLE, *arguments, expected=2), text)
        self.assertEqual(self.run_tool(SAMPLE, "--exclude-sheet", "1", "--exclude-sheet", "2"),
                         "All worksheets are left out\n")
        self.run_tool(SAMPLE, "--exclude-sheet", "1", "--exclude-sheet", "2", "--csv")
        self.assertIn("no worksheet with values is left", self.notes[0])

    def damaged(self, name):
        """A workbook for the row `name` of the table of failures."""
        book = self.folder / f"{name}.xlsx"
        drop = {"no styles": "xl/styles.xml", "no sheet": "xl/worksheets/sheet1.xml"}.get(name)
        sheet = "xl/worksheets/sheet1.xml"
        if name == "text":
            book.write_text("no package")
        elif name == "folder":
            book.mkdir()
        elif name == "checksum":
            content = bytearray(repacked(book, lambda _, part: part).read_bytes())
            content[content.index(b"<sheetData>") + 1] ^= 1
            book.write_bytes(content)
        elif name in ("cut part", "cell"):
            change = (lambda part: part[:200]) if name == "cut part" else (
                lambda part: part.replace(b'r="A2"', b'r="A"'))
            repacked(book, lambda part, content: change(content) if part == sheet else content)
        elif drop:
            repacked(book, lambda part, content: None if part == drop else content)
        return book

    def test_failures_have_one_line_and_their_own_code(self):
        cases = [("missing", 17), ("folder", 17), ("text", 22), ("no styles", 25),
                 ("no sheet", 13), ("cut part", 13), ("cell", 13), ("checksum", 1)]
        for name, code in cases:
            with self.subTest(name):
                book = self.damaged(name)
                self.assertIn(f"{book}: ", self.run_tool(book, expected=code))
        self.assertIn("is a folder; name the workbooks in it", self.run_tool(self.folder, expected=17))
        other = shutil.copy(SAMPLE, self.folder / "book.xlsm")
        self.run_tool(other, expected=22)
        for view in ("--list", "--explain", "--json"):
            self.run_tool(SAMPLE, view, expected=18, TMPDIR=str(self.folder / "none"))

    def test_unreachable_library_and_output(self):
        self.run_tool(SAMPLE, "--library", "none.so", expected=4)
        self.run_tool(SAMPLE, expected=4, DPXLSX_LIBRARY=str(SAMPLE))
        self.run_tool(SAMPLE, "--json", "/dev/full", expected=3)
        self.run_tool(SAMPLE, "--json", "none/x.json", expected=3)
        self.run_tool(SAMPLE, "--csv", f"{SAMPLE}/x/", expected=3)

    def test_output_is_written_whole_or_not_at_all(self):
        letters = [a + b for a in "ABCDEFGH" for b in string.ascii_uppercase]
        book = self.book({**PARTS, SHEET: SHEET_OF.format('<row r="2">' + "".join(
            f'<c r="{letter}2"><v>1</v></c>' for letter in letters) + "</row>")})
        target = self.folder / "out.json"
        target.write_text("before")
        target.chmod(0o640)
        (self.folder / "link").symlink_to(target)
        for limit, code in ((60000, 3), (resource.RLIM_INFINITY, 0)):
            done = subprocess.run(
                [TOOL, book, "--json", self.folder / "link"], env=self.environment(), check=False,
                stderr=subprocess.PIPE, restore_signals=False,  # the limit is an error, not a signal
                preexec_fn=lambda: resource.setrlimit(resource.RLIMIT_FSIZE, (limit, limit)))
            self.assertEqual(done.returncode, code, done.stderr)
            self.assertEqual(target.read_text() == "before", code != 0)
            self.assertEqual(target.stat().st_mode & 0o777, 0o640)
            self.assertEqual(sorted(os.listdir(self.folder)), ["book.xlsx", "link", "out.json", "temporary"])

    def outcome(self, *arguments, **more):
        done = subprocess.run([TOOL, *map(str, arguments)], capture_output=True, cwd=self.folder, check=False,
                              env=self.environment(), text=True, **more)
        return done.returncode, done.stdout, done.stderr.splitlines()

    def test_several_workbooks_have_outcomes_of_their_own(self):
        small, bad = self.book(PARTS, "small.xlsx"), self.book("no package", "bad.xlsx")
        books = [small, "none.xlsx", bad, SAMPLE]
        for view in ([], ["--list"], ["--json"]):
            with self.subTest(view):
                alone = [self.run_tool(book, *view) for book in (small, SAMPLE)]
                code, text, errors = self.outcome(*view, *books)
                self.assertEqual((code, errors[-1]), (22, "dpxlsx: 4 workbooks: 2 done, 2 failed "
                                                          "(exit code 17: 1, 22: 1)"))
                self.assertRegex("\n".join(errors), f"dpxlsx: none.xlsx: there is no(.*\n)+dpxlsx: {bad}: the file is")
                if view != ["--json"]:
                    self.assertEqual(text, f"{small}:\n{alone[0]}\n{SAMPLE}:\n{alone[1]}")
                    continue
                lines = text.splitlines(keepends=True)
                self.assertEqual([lines[0], lines[3]], alone)
                failures = [json.loads(line) for line in lines[1:3]]
                for line in failures:
                    SCHEMA.validate(line)
                self.assertEqual([(line["file"], line["failure"]["exitCode"]) for line in failures],
                                 [("none.xlsx", 17), (str(bad), 22)])
        explained = "\n".join(f"{book}:\n{self.run_tool(book, '--explain')}" for book in (bad, SAMPLE))
        self.assertEqual(self.outcome("--explain", bad, "none.xlsx", SAMPLE)[:2], (17, explained))
        self.assertEqual(self.outcome("--csv", "out/", *books)[0], 22)
        self.run_tool("--csv", "one/", SAMPLE)
        made = {str(p.relative_to(self.folder / "out")): p.read_text() for p in (self.folder / "out").glob("*/*")}
        self.assertEqual(sorted(made), ["sample/Measurements.csv", "sample/Readings 2024.csv", "small/My Data.csv"])
        self.assertEqual(made["sample/Measurements.csv"], (self.folder / "one" / "Measurements.csv").read_text())
        ranked = [(small, 0), (SAMPLE, 2), ("none.xlsx", 17), (bad, 22), (self.damaged("no styles"), 25),
                  (self.damaged("no sheet"), 13), (self.damaged("checksum"), 1)]
        for (better, _), (worse, code) in zip(ranked, ranked[1:]):
            for pair in ([better, worse], [worse, better]):
                self.assertEqual(self.outcome(*pair, "--sheet", "My Data")[0], code, pair)

    def test_csv_files_of_a_workbook_take_their_places_together(self):
        second = rows(*(f'<c r="A{r}" t="s"><v>1</v></c>' for r in range(2, 9000)))[SHEET]
        big = self.book({**PARTS, STRINGS: PARTS[STRINGS].replace("Oslo", "o" * 80),
                         WORKBOOK: PARTS[WORKBOOK].replace("</s", '<sheet name="Big" sheetId="2" r:id="b"/></s', 1),
                         LINKS: PARTS[LINKS].replace("sheet1", "sheet2").replace('"a"', '"b"').replace(
                             "</R", re.search("<Rel[^>]*/>", PARTS[LINKS])[0] + "</R"),
                         "xl/worksheets/sheet2.xml": second}, "big.xlsx")
        small = self.book(PARTS, "small.xlsx")

        def limited():
            resource.setrlimit(resource.RLIMIT_FSIZE, (600000, 600000))
        self.assertEqual(self.outcome("--list", big)[1], "My Data\nBig\n")
        code, _, errors = self.outcome("--csv", "out/", big, small, preexec_fn=limited, restore_signals=False)
        self.assertEqual((code, errors[-1]), (3, "dpxlsx: 2 workbooks: 1 done, 1 failed (exit code 3: 1)"))
        self.assertEqual([p.name for p in (self.folder / "out").glob("*/*")], ["My Data.csv"])

    def test_an_interrupt_ends_a_call_between_workbooks(self):
        book = self.many_rows()
        child = subprocess.Popen([TOOL, "--json", book, book, book], stdout=subprocess.PIPE, stderr=subprocess.PIPE,
                                 env=self.environment(), text=True)
        child.stdout.read(1)
        child.send_signal(signal.SIGTERM)
        text, errors = child.communicate()
        self.assertEqual((text.count("\n"), child.returncode), (1, 128 + signal.SIGTERM))
        self.assertTrue(errors.endswith("dpxlsx: 1 of 3 workbooks: 1 done, 0 failed\n"), errors)

    def test_bash_completes_options_values_and_workbooks(self):
        for name in ("a b.xlsx", "B.XLSX", "c.txt"):
            (self.folder / name).touch()
        everything = ["a b.xlsx", "B.XLSX", "c.txt", "temporary"]
        cases = [(["--na"], ["--name-row", "--names"]), (["--names", ""], ["given", "infer", "none"]),
                 (["--names", "=", "i"], ["infer"]), (["--names", "="], ["given", "infer", "none"]),
                 (["--head", ""], []), (["--library", ""], everything), (["--vers"], ["--version"]),
                 ([""], ["a b.xlsx", "B.XLSX", "temporary"]), (["--csv", "a"], ["a b.xlsx"]),
                 (["a b.xlsx", "--list", "t"], ["temporary"])]
        for words, wanted in cases:
            line = shlex.join(["dpxlsx", *words])
            done = subprocess.run(["bash", "-c", f'. "$0"; COMP_WORDS=({line}) COMP_CWORD={len(words)}; _dpxlsx; '
                                   'printf "%s\\n" "${COMPREPLY[@]}"', SOURCE / "tools/completions/dpxlsx.bash"],
                                  cwd=self.folder, capture_output=True, text=True, check=False)
            self.assertEqual((sorted(filter(None, done.stdout.split("\n")), key=str.lower), done.stderr),
                             (wanted, ""), words)

    def test_a_relative_name_and_any_letter_case_open(self):
        shutil.copy(SAMPLE, self.folder / "BOOK.XLSX")
        self.assertIn("Empty", self.run_tool("BOOK.XLSX", "--list"))
        self.assertIn("Measurements", self.run_tool("BOOK.XLSX"))

    def test_a_closed_pipe_is_no_error(self):
        reader, writer = os.pipe()
        os.close(reader)
        done = subprocess.run([TOOL, str(SAMPLE)], stdout=writer, stderr=subprocess.PIPE,
                              env=self.environment(), check=False)
        os.close(writer)
        self.assertEqual((done.returncode, done.stderr), (0, b""))
        child = subprocess.Popen([TOOL, str(self.many_rows()), "--csv"], stdout=subprocess.PIPE,
                                 stderr=subprocess.PIPE, env=self.environment())
        self.assertEqual(child.stdout.readline(), b"1.5\n")
        child.stdout.close()
        self.assertEqual((child.stderr.read(), child.wait()), (b"", 0))
        child.stderr.close()

    def test_an_interrupt_leaves_nothing_behind(self):
        # The pipe is never read: the program waits in the middle of its output.
        child = subprocess.Popen([TOOL, str(self.many_rows()), "--csv"], stdout=subprocess.PIPE,
                                 env=self.environment())
        child.stdout.read(1)
        child.send_signal(signal.SIGTERM)
        child.stdout.read()
        child.stdout.close()
        self.assertEqual(child.wait(), 128 + signal.SIGTERM)

    def test_an_interrupt_ends_an_open(self):
        # A comment leaves the sheet to libxml2, which takes its time. Its end is damaged: whoever
        # comes there ends with 13.
        sheet = b"<worksheet><!----><sheetData>" + b"<row><c><v>1</v></c></row>" * 1000000
        book = repacked(self.folder / "long.xlsx", lambda name, content:
                        sheet if name.endswith("sheet1.xml") else content, zipfile.ZIP_DEFLATED)
        master, terminal = pty.openpty()
        child = subprocess.Popen([TOOL, str(book)], stdout=subprocess.DEVNULL, stderr=terminal,
                                 env=self.environment())
        os.close(terminal)
        self.assertIn(b"Opening", os.read(master, 4096))
        child.send_signal(signal.SIGTERM)
        self.assertEqual(child.wait(), 128 + signal.SIGTERM)
        os.close(master)

    def book_of(self, cells):
        """A workbook whose first worksheet has these cells (attributes and content) in column A."""
        rows = "".join(f'<row r="{r}"><c r="A{r}" {cell}</c></row>'
                       for r, cell in enumerate(cells, start=1)).encode()
        return repacked(self.folder / "made.xlsx", lambda name, content: re.sub(
            b"<sheetData>.*</sheetData>", b"<sheetData>" + (
                rows if name.endswith("sheet1.xml") else b"") + b"</sheetData>", content,
            flags=re.S) if "worksheets/sheet" in name else content,
            zipfile.ZIP_DEFLATED)

    def many_rows(self):
        return self.book_of(f"><v>{r}.5</v>" for r in range(1, 60001))

    def test_date_times_are_read_and_shown_by_the_host(self):
        cases = [("2024-01-05", "2024-01-05"), ("1/5/2024 13:45", "2024-01-05T13:45:00"),
                 (" 5 Jan 2024 ", "2024-01-05"), ("13:45", "13:45:00"),
                 ("2024-02-30", None), ("2024-01-05 or so", None), ("1/5/1820", None),
                 (59, "1900-02-28"), (60, "1900-02-29"), (61, "1900-03-01"), (0.5, "12:00:00"),
                 (2958465.5, "9999-12-31T12:00:00"), (2958466, None), (-1, None),
                 ("1/1/1900", "1900-01-01"), ("2/28/1900", "1900-02-28"),
                 ("12/31/9999", "9999-12-31")]
        cells = [f't="inlineStr"><is><t xml:space="preserve">{given}</t></is>'
                 if isinstance(given, str) else f"><v>{given}</v>" for given, _ in cases]
        text = self.run_tool(self.book_of(cells), "--json", "--names", "none", "--type",
                             "A=datetime")
        column = json.loads(text)["worksheets"][0]["columns"][0]
        self.assertEqual(column["iso"], [wanted for _, wanted in cases])

    def test_a_full_disk_fails_and_leaves_nothing(self):
        def limit(size):
            signal.signal(signal.SIGXFSZ, signal.SIG_IGN)
            resource.setrlimit(resource.RLIMIT_FSIZE, (size, size))
        book = self.many_rows()
        for size, wanted in ((book.stat().st_size // 2, 18), (book.stat().st_size, 1)):
            done = subprocess.run([TOOL, book], capture_output=True, env=self.environment(),
                                  preexec_fn=lambda: limit(size), check=False)
            self.assertEqual(done.returncode, wanted, done.stderr)
            self.assertEqual(list(self.temporary.iterdir()), [])

    def test_workbooks_of_other_programs_come_in(self):
        books = sorted((SOURCE / "tests" / "data").glob("*.xlsx"))
        self.assertGreaterEqual(len(books), 16)
        for book in books:
            with self.subTest(book.name):
                expected = json.loads(book.with_suffix(".expected.json").read_text())["sheets"]
                sheets = json.loads(self.run_tool(book, "--json"))["worksheets"]
                self.assertEqual([sheet["title"] for sheet in sheets],
                                 [sheet["name"] for sheet in expected])
                for sheet, wanted in zip(sheets, expected):
                    self.assertEqual([column["name"] for column in sheet["columns"]],
                                     [column["name"] for column in wanted["columns"]])
                    self.assertEqual([column["values"] for column in sheet["columns"]],
                                     [column["values"] for column in wanted["columns"]])
                tables = self.run_tool(book)
                for sheet in expected:
                    self.assertIn(sheet["name"], tables)

    def test_the_help_fits_a_screen_and_the_pages_have_its_options(self):
        text = self.run_tool("--help")
        self.assertLessEqual(text.count("\n"), 48)
        self.assertLessEqual(max(map(len, text.splitlines())), 80)
        short = subprocess.run([TOOL], capture_output=True, check=False)
        self.assertEqual((short.returncode, short.stdout), (2, b""))
        first_group, pointer = re.fullmatch(r"(Usage: .*\n)(.*\n)", short.stderr.decode(), re.S).groups()
        self.assertTrue(text.startswith(first_group + "Rows:\n"), first_group)
        self.assertIn("dpxlsx --help", pointer)
        pages = subprocess.run([SOURCE / "scripts" / "make-option-pages", "--check", TOOL],
                               capture_output=True, check=False, text=True)
        self.assertEqual((pages.returncode, pages.stderr), (0, ""))
        number = r"\d[\d.]*"
        self.assertRegex(self.run_tool("--version"), rf"^dpxlsx {number}\nImport library: /.*/libdpxlsx\.so\.{number}\n"
                         rf"Loaded: libxml2 {number}, ICU {number}, zlib {number}, "
                         rf"xxHash {number}, .*libboost_filesystem\.so\.{number}.*\nCompiled in: CLI11 {number}, "
                         rf"nlohmann-json {number}\n$")
        self.assertIn("none.so: the import library cannot be loaded", self.run_tool("--library", "none.so", "--version"))

    def test_traits_are_explained(self):
        for key, content, text, code in TRAITS:
            with self.subTest(key=key, text=text):
                book = self.book(content)
                self.assertRegex(self.run_tool(book, "--explain"), f"(?i){text}")
                explained = json.loads(self.run_tool(book, "--explain", "--json"))
                SCHEMA.validate(explained)
                self.assertEqual([t["trait"] for t in explained["traits"]], [key] if key else [])
                fails = [t["importFails"] for t in explained["traits"]]
                self.assertEqual(fails, [code != 0] if key else [])
                cured = key in CURED_BY_STANDARD
                self.assertEqual(["--standard" in t["advice"] for t in explained["traits"]], [cured] if key else [])
                left = json.loads(self.run_tool(book, "--explain", "--json", "--standard"))["traits"]
                self.assertEqual({t["trait"] for t in left} & {key, "unreadable", *CURED_BY_STANDARD},
                                 {key} if key and not cured else set())
                if cured:
                    by_standard = self.run_tool(book, "--json", "--standard")
                    self.assertEqual([n for n in self.notes if "dpxlsx --explain" in n], [])
                    self.assertNotEqual(by_standard, self.run_tool(book, "--json", expected=code))
                self.run_tool(book, expected=code)
                noted = [note for note in self.notes if "dpxlsx --explain" in note]
                told = code != 0 or (key in WORST and text != r"1 cell \(My Data!A2\)")
                self.assertEqual(len(noted), told, self.notes)
                lost = [note for note in self.notes if "; to keep" in note]
                self.assertEqual(len(lost), key in ("lost-on-conversion", "long-texts"))

    def test_what_no_cell_bears_out_is_not_told(self):
        dated, lost = '<c r="A2"><v>1</v></c>', '<c r="A3" s="1"><v>45000</v></c>'
        cases = [
            ("a text of the longest length", changed(STRINGS, "Oslo", "o" * 80), []),
            ("a name with spaces behind", changed(STRINGS, "Name", "n" * 78 + "    "), []),
            ("no dates", {**rows(dated), WORKBOOK: PARTS[WORKBOOK].replace(
                "<workbookPr", '<workbookPr date1904="1"')}, []),
            ("texts that nobody uses", {**PARTS, SHEET: SHEET_OF.format(
                '<row r="1"><c r="A1" t="str"><v>n</v></c></row>'), STRINGS: changed(
                    STRINGS, ' uniqueCount="2"', "")[STRINGS].replace("Oslo", "<![CDATA[x]]>")}, []),
            ("a merged range without values", {**PARTS, SHEET: SHEET_OF.format("").replace(
                "</worksheet>", '<mergeCells><mergeCell ref="A1:B2"/></mergeCells></worksheet>')}, []),
            ("a merged range of one cell", changed(SHEET, "</worksheet>", '<mergeCells><mergeCell '
             'ref="A1"/></mergeCells></worksheet>'), []),
            ("a reference to another row than its own", {**PARTS, SHEET: SHEET_OF.format(
                '<row r="2"><c r="A1"><v>1</v></c></row>')}, []),
            ("a hidden sheet without values", {**PARTS, SHEET: SHEET_OF.format(
                '<row r="1"><c r="A1"><v></v></c></row>'), WORKBOOK: PARTS[WORKBOOK].replace(
                    "<sheet ", '<sheet state="hidden" ')}, []),
            ("a colour in a column of numbers", {**rows(dated, lost), STYLES: with_format(
                "[Red]0.00")[STYLES]}, []),
            ("a date of the default style among numbers", {**rows(dated, lost), STYLES: with_format(
                "dd.mm.yyyy")[STYLES]}, ["mixed-dates"]),
            ("a sheet of macros", {**changed(LINKS, "</R", '<Relationship Id="b" Target="m.xml" Type="/xlMacrosheet"/>'
             "</R"), WORKBOOK: PARTS[WORKBOOK].replace("</sheets>", '<sheet name="M" r:id="b"/></sheets>')}, []),
            ("numbers in unusual forms", rows(
                '<c r="A2"><v> +7.5\n</v></c>', '<c r="A3"><v><![CDATA[5]]></v></c>', '<c r="A4"><v><!-- x -->1E5</v></c>',
                '<c r="A5" t="b"><v>False</v></c>', '<c r="b6" t="n"><v></v> </c>'), []),
            ("more formats declared than there are", changed(STYLES, 'count="1"', 'count="2"'), []),
            ("a text of several reads", rows('<c r="A2" t="inlineStr"><is> <t>' + "x" * 100000 + "</t> </is></c>"),
             ["--max-text", "none"]),
            ("a last name that is a text", {**PARTS, SHEET: SHEET_OF.format(
                '<row r="1"><c r="A1"><v>1</v></c><c r="B1" t="inlineStr"><is><t>n</t></is></c></row>'
                '<row r="2"><c r="A2"><v>1</v></c></row>')}, []),
            ("inline texts in a column that is left out", rows(
                '<c r="A2"><v>1</v></c><c r="B2" t="inlineStr"><is><t>a<!-- -->b</t><t>c</t><rPh><t>d</t></rPh></is></c>',
                '<c r="B3"><f>1+1</f></c>', '<c r="b4"><v>abc</v></c>', '<c r="A5"><v>1</v></c>'),
             ["--exclude", "B", "--exclude", "AH"]),
            ("a column that is left out", rows(dated, lost), ["--exclude", "A"]),
            ("a worksheet that is left out", rows(dated, lost), ["--exclude-sheet", "1"]),
            ("a kind that the user chose", rows(dated, lost), ["--type", "A=datetime"])]
        for name, content, more in cases:
            with self.subTest(name):
                book = self.book(content)
                wanted = more if more[:1] == ["mixed-dates"] else []
                arguments = [] if wanted else more
                explained = json.loads(self.run_tool(book, "--explain", "--json", *arguments))
                self.assertEqual([t["trait"] for t in explained["traits"]], wanted)
                self.run_tool(book, *arguments)
                self.assertEqual([n for n in self.notes if "if there are any" not in n], [])

    def test_dates_among_numbers_are_judged_by_the_rules_chosen(self):
        book = self.book({**rows('<c r="A2"><v>7</v></c>', '<c r="A3" s="1"><v>45296</v></c>'),
                          STYLES: with_format("DD/MM/YYYY")[STYLES]})
        for rules, key in (([], "not-taken-for-dates"), (["--standard"], "mixed-dates")):
            traits = json.loads(self.run_tool(book, "--explain", "--json", *rules))["traits"]
            self.assertEqual([trait["trait"] for trait in traits], [key])

    def test_the_advice_about_every_column_helps(self):
        cells = ('<row r="2"><c r="A2" s="1"><v>45296</v></c><c r="B2" s="1"><v>45297</v></c></row>'
                 '<row r="3"><c r="A3" s="1"><v>45000</v></c></row>')
        for code, type_, title, more, place in (
                ("DD/MM/YYYY", "datetime", 'name="a=b"', [], "1"), ("[Red]0", "numeric", 'name="a=b"', [], "1"),
                ("[Red]0", "numeric", 'name=" a:b? "', ["--clean-sheet-names"], "a_b_")):
            with self.subTest((code, title)):
                book = self.book({**PARTS, SHEET: SHEET_OF.format(cells), STYLES: with_format(
                    code)[STYLES], WORKBOOK: PARTS[WORKBOOK].replace('name="My Data"', title)})
                line = self.run_tool(book, "--explain", *more)
                advice = re.findall("--type .*", line)[0]
                self.assertEqual(advice, f"--type '{place}!A={type_}' --type '{place}!B={type_}'")
                self.assertIn("nothing to", self.run_tool(book, "--explain", *more, *shlex.split(advice)))
                traits = json.loads(self.run_tool(book, "--explain", "--json", *more))["traits"]
                self.assertEqual([(t["cures"][-1], [p["cells"] for p in t["places"]]) for t in traits], [(advice, [2, 1])])
        unread = self.book({**prefixed(LINKS), STYLES: with_format("[Red]0")[STYLES]})  # its columns are not known
        dates = json.loads(self.run_tool(unread, "--explain", "--json"))["traits"][-1]
        self.assertIn("--type COLUMN=numeric", dates["advice"])
        self.assertEqual((dates["cures"], dates["places"]), (["--standard"], []))

    def test_traits_come_in_order_and_each_says_where(self):
        book = self.book(renamed(WORKBOOK, "x.xml") | {WORKBOOK: PARTS[WORKBOOK].replace(
            "<workbookPr", '<workbookPr date1904="1"'), STRINGS: changed(
                STRINGS, ' uniqueCount="2"', "")[STRINGS], SHEET: PARTS[SHEET].replace(
                    CELL, CELL + '<c t="e"><v>#REF!</v></c>')})
        self.assertEqual([line.split(":")[0] for line in
                          self.run_tool(book, "--explain").splitlines()],
                         ["The table of shared texts does not say how many there are (uniqueCount)",
                          "The book counts its dates from 1904",
                          "1 cell (My Data) with an error such as #DIV/0!"])
        self.run_tool(book)
        self.assertIn("texts are missing (--standard cures it); dates, if there are any, arrive 1,462 days early (--standard", self.notes[0])
        self.run_tool(self.folder / "none.xlsx", "--explain", expected=17)
        self.assertIn("does not end in .xlsx",
                      self.run_tool(book.rename(self.folder / "a.xlsm"), "--explain"))

    def test_cells_lost_on_conversion_are_counted(self):
        lost = r": 1 cell became missing on conversion: 1 in Measurements!L \(Count\); to keep " \
               "the content as displayed: --type 'Measurements!L=text'$"
        cases = [([], lost), (["--sheet", "1", "--position", "L=30"], lost),
                 (["--type", "L=text"], ""), (["--missing-word", "n/a=-1"], ""),
                 (["--missing-word", "n/a=missing"], ""), (["--missing-number", "5=missing"], lost),
                 (["--type", "L=numeric", "--missing-number", "5=0"], lost),
                 (["--missing-number", "missing=0"], ""), (["--range", "-1:8"], lost),
                 (["--exclude", "L"], ""), (["--preview"], lost), (["--list"], ""),
                 (["--type", "A=datetime", "--type", "J=numeric", "--type", "M=numeric"],
                  r"11 in Measurements!J \(City\), 1 in"),
                 (["--names", "none", "--first-row", "2", "--type", "1!J=numeric", "--type",
                   "1!M=numeric", "--type", "2!E=numeric"],
                  ": 25 cells .*!M and 3 in 1 more column; to.*--explain names all")]
        for arguments, text in cases:
            with self.subTest(arguments):
                self.run_tool(SAMPLE, *arguments, "--max-text", "93")
                self.assertEqual(len(self.notes), text != "", self.notes)
                self.assertRegex("".join(self.notes), text or "^$")
        self.assertRegex(self.run_tool(SAMPLE, "--explain", *cases[-1][0]),
                         "25 cells do not fit.* 3 in Readings 2024!E:.*--type 'Readings 2024!E=text'")

    def test_cut_texts_are_counted(self):
        cut = ": 1 text was cut at 80 bytes: 1 in Measurements!M .Comment.; to keep all of it: " \
              "--max-text 93$"
        cases = [([], cut), (["--position", "M=3", "--position", "C=13"], cut),
                 (["--max-text", "93"], ""), (["--max-text", "none"], ""),
                 (["--exclude", "M"], ""), (["--preview"], cut), (["--rows", "3"], ""),
                 (["--type", "M=numeric"], ""), (["--max-text", "92"], "cut at 92 bytes: 1 in")]
        for arguments, text in cases:
            with self.subTest(arguments):
                whole = self.columns("--sheet", "1", *arguments)
                notes = [note for note in self.notes if "cut at" in note]
                self.assertEqual(len(notes), text != "", self.notes)
                self.assertRegex("".join(notes), text or "^$")
                texts = [v for v in whole.get("Comment", {"values": []})["values"] if v]
                if arguments[:1] == ["--max-text"]:
                    self.assertEqual(max(len(str(v).encode()) for v in texts),
                                     min(93, int(arguments[1].replace("none", "93"))))

    def test_options_that_do_nothing_are_told(self):
        cases = [(["--type", "Q=text"], "no worksheet has a column Q with values: --type does nothing"),
                 (["--exclude", "Q", "--sheet", "2"], "column Q .*--exclude"),
                 (["--sheet", "1", "--rename", "2!Q=x"], ""),
                 (["--rename", "C=x"], ""), (["--position", "A=3", "--position", "C=1"], ""),
                 (["--position", "A=3"], 'columns A and C of "Measurements" are both at position 3')]
        for arguments, text in cases:
            with self.subTest(arguments):
                self.run_tool(SAMPLE, "--max-text", "none", "--type", "L=text", *arguments)
                told = [note for note in self.notes if "to keep" not in note]
                self.assertEqual(len(told) > 0, text != "", self.notes)
                self.assertRegex("".join(told), text or "^$")

    def cell(self, place, text, codes):
        """A cell as the examples write it; its number format goes to `codes`."""
        number = re.fullmatch(r"(-?[\d.]+)(?: as (.*))?", text)
        if number:
            codes += [number[2]] if number[2] else []
            style = f' s="{len(codes)}"' if number[2] else ""
            return f'<c r="{place}"{style}><v>{number[1]}</v></c>'
        if text in ("TRUE", "FALSE"):
            return f'<c r="{place}" t="b"><v>{text == "TRUE":d}</v></c>'
        if text.startswith("#"):
            return f'<c r="{place}" t="e"><v>{text}</v></c>'
        text = html.escape(re.sub('^"(.*)"$', r"\1", text))
        return f'<c r="{place}" t="inlineStr"><is><t>{text}</t></is></c>' if text else ""

    def example_book(self, rows):
        codes = []
        cells = "".join(f'<row r="{row[0]}">' + "".join(
            self.cell(f"{letter}{row[0]}", text, codes)
            for letter, text in zip("ABCDEFGH", row[1:])) + "</row>" for row in rows[2:])
        formats = "".join(f'<numFmt numFmtId="{164 + i}" formatCode="{html.escape(code)}"/>'
                          for i, code in enumerate(codes))
        styles = "".join(f'<xf numFmtId="{164 + i}"/>' for i in range(len(codes)))
        return self.book({**PARTS, STYLES: f'<styleSheet xmlns="{SPREADSHEET}">'
                          f'<numFmts count="{len(codes)}">{formats}</numFmts><cellXfs count="1">'
                          f'<xf numFmtId="0"/>{styles}</cellXfs></styleSheet>',
                          SHEET: f'<worksheet xmlns="{SPREADSHEET}"><sheetData>{cells}</sheetData>'
                          '</worksheet>'})

    def test_the_examples_of_the_import_rules_hold(self):
        def table(text):
            return [[field.strip() for field in line.split("|")[1:-1]]
                    for line in text.splitlines()]
        def listed(values):
            return ", ".join("*missing*" if value is None else str(value) for value in values)
        page = (SOURCE / "docs" / "import-rules.md").read_text()
        examples = re.findall(r"<!-- example(?:: (.*?))? -->\n((?:\|.*\n)+)\n((?:\|.*\n)+)", page)
        self.assertEqual(len(examples), page.count("<!-- example"))
        for options, given, wanted in examples:
            wanted = table(wanted)
            with self.subTest(wanted):
                book = self.example_book(table(given))
                columns = json.loads(self.run_tool(book, "--json", *shlex.split(options)))
                rows = [{"name": c["name"], "kind": c["kind"], "missing": str(c["missing"]),
                         "values": listed(c.get("iso", c["values"])),
                         "shown": listed(c.get("shown", [])), "format": c["format"]["words"]}
                        for c in columns["worksheets"][0]["columns"]]
                self.assertEqual([[row[head] for head in wanted[0]] for row in rows], wanted[2:])

    def test_the_commands_of_the_pages_run(self):
        scripts = self.folder / "scripts"
        (self.folder / "build" / "release" / "bin").mkdir(parents=True)
        scripts.mkdir()
        shutil.copy(SOURCE / "scripts" / "import", scripts)
        shutil.copytree(SOURCE / "samples", self.folder / "samples")
        for name in ("BOOK.xlsx", "OTHER.xlsx"):
            shutil.copy(SAMPLE, self.folder / name)
        tool = self.folder / "build" / "release" / "bin" / "dpxlsx"
        tool.symlink_to(TOOL)
        for name in ("setup", "build"):  # this build stands in for what they would make
            (scripts / name).write_text("#!/bin/sh\n")
            (scripts / name).chmod(0o755)
        commands = []
        for page in ("README.md", "docs/tool.md", "docs/import-rules.md", "docs/many-workbooks.md"):
            commands += re.findall(r"^    ((?:dpxlsx|scripts/import)\b.*?)(?:  .*)?$",
                                   re.sub("```.*?```", "", (SOURCE / page).read_text(), flags=re.S), re.M)
        self.assertGreater(len(commands), 8)
        for command in commands:
            with self.subTest(command):
                done = subprocess.run(command.replace(" [WORKBOOK]", ""), shell=True, check=False,
                                      env=self.environment(PATH=f"{tool.parent}:/usr/bin:/bin"),
                                      cwd=self.folder, capture_output=True)
                self.assertEqual(done.returncode, 0, done.stderr.decode())


if __name__ == "__main__":
    unittest.main()
