#!/usr/bin/python3
"""make_seeds.py FOLDER: makes the first inputs of the fuzz targets, one folder a target, of the
sample, the workbooks of the tests and the tables of test cases. The same on every run."""

import pathlib
import re
import struct
import sys
import zipfile

ROOT = pathlib.Path(__file__).resolve().parent.parent
LARGEST = 64 * 1024  # bytes of one input

# As the target numbers them.
PARTS = ["xl/workbook.xml", "xl/_rels/workbook.xml.rels", "xl/sharedStrings.xml", "xl/styles.xml",
         "xl/worksheets/sheet1.xml"]
STORED, WRONG_SUM, CLAIMED, REPEATED, MANY = 1, 2, 4, 8, 16


def cases(name):
    """The rows of a table of test cases: see tests/case_table.h."""
    def plain(cell):
        known = {"n": b"\n", "r": b"\r", "t": b"\t", "0": b"\0"}
        return re.sub(rb"\\(x..|.)", lambda m: bytes([int(m[1][1:], 16)]) if m[1][:1] == b"x" and
                      len(m[1]) == 3 else known.get(m[1].decode(), m[1]), cell)
    rows = []
    for line in (ROOT / "tests/cases" / name).read_bytes().split(b"\n"):
        if line and not line.startswith(b"#"):
            rows.append([plain(cell) for cell in (line + b" ").split(b" | ")])
    return rows


def worksheet(rows):
    return b"<worksheet><sheetData>" + rows + b"</sheetData></worksheet>"


def part(name, content):
    return bytes([PARTS.index(name)]) + content


def sources(stem, name, content):
    """A part that is read both ways, in windows and a few bytes at a time. The first byte with its
    lowest bit is the size of a small window."""
    if name in (PARTS[2], PARTS[4]):
        strings = int(name == PARTS[2])
        yield "sources", stem, bytes([strings, 0]) + content
        for step in (1, 2, 3, 7):
            yield "sources", f"{stem}-by-{step}", bytes([strings, step]) + content
        yield "sources", stem + "-small-window", bytes([strings + 14, 0]) + content


def entry(name, content, bits=0, extra=b""):
    """An entry of the package target: a number of its table of names, or a name."""
    which = bytes([name]) if isinstance(name, int) else bytes([255, len(name)]) + name.encode()
    return which + bytes([bits]) + extra + struct.pack("<H", len(content)) + content


def package(*entries, behind=b"", end=0):
    return bytes([2 * end, len(entries) - 1]) + b"".join(entries) + b"\0\0" + behind


def edge(position):
    """A byte that stands for one of the numbers at the edges."""
    return bytes([256 - 13 + position])


def seeds():
    workbooks = sorted((ROOT / "tests/data").glob("*.xlsx")) + [ROOT / "samples/sample.xlsx"]
    for path in workbooks:
        if path.stat().st_size < LARGEST:
            yield "package", path.stem, b"\1" + path.read_bytes()
        with zipfile.ZipFile(path) as book:
            for name in book.namelist():
                known = "xl/worksheets/sheet1.xml" if "worksheets/sheet" in name else name
                if known in PARTS and book.getinfo(name).file_size < LARGEST:
                    stem = f"{path.stem}-{pathlib.PurePath(name).stem}"
                    yield "part", stem, part(known, book.read(name))
                    yield from sources(stem, known, book.read(name))
    for path in sorted((ROOT / "tests/data").glob("*.xml")):
        if path.stat().st_size < LARGEST:
            yield "spreadsheet_2003", path.stem, path.read_bytes()
    yield from seeds_of_cases()
    yield from seeds_of_packages()
    yield from seeds_of_calls()


def seeds_of_cases():
    for i, row in enumerate(cases("worksheet_cells.txt")):
        yield "part", f"cells-{i}", part(PARTS[4], worksheet(row[1]))
        yield from sources(f"cells-{i}", PARTS[4], worksheet(row[1]))
    for i, row in enumerate(cases("shared_strings.txt")):
        yield "part", f"strings-{i}", part(PARTS[2], row[1])
        yield from sources(f"strings-{i}", PARTS[2], row[1])
    for i, row in enumerate(cases("styles.txt")):
        sheet = row[1].replace(b">F<", b"><numFmt numFmtId='164' formatCode='h:mm'/><")
        sheet = sheet.replace(b">X<", b"><xf numFmtId='14'/><xf numFmtId='164'/><")
        yield "part", f"styles-{i}", part(PARTS[3], b"<styleSheet>" + sheet + b"</styleSheet>")
    yield from seeds_of_the_standard()
    table = (b"<Workbook xmlns:ss='urn:s'><Styles><Style ss:ID='f'><NumberFormat "
             b"ss:Format='0.00'/></Style><Style ss:ID='d'><NumberFormat ss:Format='Short Date'/>"
             b"</Style></Styles><Worksheet ss:Name='S'><Table ss:ExpandedColumnCount='9' "
             b"ss:ExpandedRowCount='20'>%s</Table><WorksheetOptions/></Worksheet></Workbook>")
    for i, row in enumerate(cases("spreadsheet_2003_cells.txt")):
        cells = re.sub(rb"@([^ @]+) ?([^@]*)@",
                       rb"<Cell \2><Data ss:Type='Number'>\1</Data></Cell>", row[1])
        yield "spreadsheet_2003", f"cells-{i}", table % cells
    codes = [row[1] for row in cases("format_codes.txt")] + \
            [row[0] for row in cases("descriptive_names.txt")]
    for i, code in enumerate(codes):
        yield "format_code", f"code-{i}", bytes([i % 19]) + code
        yield "format_code", f"any-{i}", bytes([99]) + struct.pack("<d", 12345.678) + code
    texts = ["escapes.txt", "entries.txt", "text_cleaning.txt", "integer_attributes.txt"]
    for name in texts:
        for i, row in enumerate(cases(name)):
            for cell in row[1:2]:
                yield "text", f"{name[:-4]}-{i}", bytes([i % 2, 3]) + cell
    for i, text in enumerate([b"1.5", b" -1,5e+10 ", b"(12.5)", b"1d5", b"XFD1048576", b"A1", b".",
                              b"0x1p3", b"1" * 40, b"1e999", b"/xl/../../x"]):
        yield "text", f"number-{i}", bytes([i % 2, 5]) + text


    broken = b"<worksheet>\x80\xff\xfd" + b"\x81" * 5000 + b"</worksheet>"
    for encoding in (b"Shift_JIS", b"UTF-7", b"UTF-16", b"windows-1252", b"nonsense"):
        head = b"<?xml version='1.0' encoding='" + encoding + b"'?>"
        for name in PARTS:
            stem = f"{encoding.decode()}-{pathlib.PurePath(name).stem}"
            yield "part", stem, part(name, head + broken)
        yield "spreadsheet_2003", encoding.decode(), head + broken


def seeds_of_the_standard():
    """The parts of the cases that are read by either rules."""
    schemas = b"http://schemas.openxmlformats.org/"
    for i, row in enumerate(cases("standard.txt")):
        yield "part", f"standard-{i}", part(PARTS[4], worksheet(row[1]))
        for name, content in re.findall(rb"@([^:]+):(.*?)(?= @|$)", row[2].strip(), re.S):
            for mark, space in ((b"{m}", b"spreadsheetml/2006/main"), (b"{p}", b"package/2006/relationships"),
                                (b"{r}", b"officeDocument/2006/relationships")):
                content = content.replace(mark, schemas + space)
            if name.decode() in PARTS:
                yield "part", f"standard-{i}-{pathlib.PurePath(name.decode()).stem}", part(name.decode(), content)


def seeds_of_packages():
    rows = b"<row><c><v>1</v></c><c t='s'><v>0</v></c></row>"
    yield "package", "described-sound", package(entry(4, worksheet(rows)))
    yield "package", "described-stored", package(entry(4, worksheet(rows), STORED))
    yield "package", "described-wrong-sum", package(entry(3, b"<styleSheet/>", WRONG_SUM))
    yield "package", "described-claim", package(entry(2, b"<sst/>", CLAIMED, edge(9)))
    yield "package", "described-bomb", package(
        entry("bomb", b"\0" * 1000, REPEATED, struct.pack("<H", 4000)))
    yield "package", "described-many", package(
        entry("many", b"x", MANY) + struct.pack("<H", 8000))
    for i in range(6, 18):
        yield "package", f"described-name-{i}", package(entry(i, b"x"), behind=b"tail")
    strings = b"<sst uniqueCount='1'><si><t>" + b"a" * 2000 + b"</t></si></sst>"
    cells = b"<row>" + b"<c t='s'><v>0</v></c>" * 200 + b"</row>"
    yield "package", "described-strings", package(entry(2, strings), entry(4, worksheet(cells)))
    for end in (1, 7, 12, 30):
        yield "package", f"described-ended-{end}", package(entry(4, b"x"), end=end)
    gzip = bytes.fromhex("1f8b08000000000000ff4b04008300000000")
    yield "package", "described-gzip", package(entry(4, gzip))


def seeds_of_calls():
    def change(call, *arguments):
        return bytes([3 * call, *arguments])

    def option(call, *arguments):
        return bytes([3 * call + 1, *arguments])

    def ask(call, *arguments):
        return bytes([3 * call + 2, *arguments])

    book = change(8, 1, 1)
    sheet = change(5, 1, ord("S")) + change(6, 0, 1)
    records = change(0, 2, 1, 0, 0, 0, *([0, 0, 1, 0, 0] * 3)) + \
        change(0, 2, 1, 0, 0, 1, *([1, 0, 2, 65, 66, 0, 0] * 3))
    columns = b"".join(ask(0, kind, 0, key, 1, 1) for key in range(1, 5) for kind in (0, 1))
    plain = {
        "open": book + ask(4) + columns + change(9) + columns,
        "records": sheet + records + ask(4) + columns + ask(6, 0, 0) + change(10) + ask(6, 1, 1),
        "options": book + option(17, 0, 1, 1) + option(18, 0, 1, 1) + option(22, 0, 1, 1, 2, 3) +
        columns + option(25, 0, 1, 2) + columns + ask(6, 1, 1),
        "settings": b"".join(option(call, 3, 2, 65, 66, 1) for call in range(17)) + book + columns,
        "again": book + book + columns + change(7, 0, 1) + ask(4) + change(10) + book + columns,
        "list": change(11) + book + ask(7, 0) + ask(5),
        "ended": book + change(13, 9) + book + columns + change(13, 3) + change(11) + book + columns,
    }
    for name, calls in plain.items():
        yield "provider_calls", name, calls


def main():
    folder = pathlib.Path(sys.argv[1])
    for target, name, content in seeds():
        (folder / target).mkdir(parents=True, exist_ok=True)
        (folder / target / name).write_bytes(content)


if __name__ == "__main__":
    main()
