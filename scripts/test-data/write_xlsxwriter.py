"""Writes workbooks with XlsxWriter: write_xlsxwriter.py DATA_FOLDER"""
import datetime as dt
import sys

import xlsxwriter

data = sys.argv[1]
STAMP = {"created": dt.datetime(2024, 1, 2, 3, 4, 5)}


def new(name, **options):
    book = xlsxwriter.Workbook(f"{data}/{name}", options)
    book.set_properties(STAMP)
    return book


def numbers():
    book = new("xlsxwriter_numbers.xlsx")
    sheet = book.add_worksheet("Styles")
    codes = ["General", "0", "0.00", "#,##0", "#,##0.000", "0%", "0.0%", "0.00E+00", "##0.0E+0",
             '"$"#,##0.00_);[Red]\\("$"#,##0.00\\)', "[$€-407] #,##0.00", "# ?/?", "0.0##",
             "00000", "_(* #,##0.00_);_(* (#,##0.00);_(* \"-\"??_);_(@_)", "0.00;-0.00;zero"]
    values = [1234.5678, -0.5, 0, 0.000125, 98765432.1, 1, -77]
    for column, code in enumerate(codes):
        style = book.add_format({"num_format": code})
        sheet.write_string(0, column, code)
        for row, value in enumerate(values, 1):
            sheet.write_number(row, column, value, style)
    for column, index in enumerate([1, 4, 7, 9, 11, 12, 37, 39, 44, 48, 49]):
        style = book.add_format({"num_format": index})
        sheet.write_string(10, column, f"built-in {index}", style)
        sheet.write_number(11, column, 2.5, style)
    sizes = book.add_worksheet("Magnitudes")
    sizes.write_row(0, 0, ["powers", "edges", "thirds"])
    for row in range(1, 41):
        sizes.write_number(row, 0, float(f"{'-' if row % 2 else ''}1.5e{row - 20}"))
        sizes.write_number(row, 2, row / 3)
    edges = [1.001e18, -1.001e18, 1.0011e18, -2e18, 1e300, 5e-324, 2.2250738585072014e-308, 0.1,
             0.1 + 0.2, 123456789012345678, 9007199254740993, -0.0, 2147483648, 1.23456e30]
    for row, value in enumerate(edges, 1):
        sizes.write_number(row, 1, value)
    book.close()


def texts(name, **options):
    book = new(name, **options)
    bold, red = book.add_format({"bold": True}), book.add_format({"font_color": "red"})
    sheet = book.add_worksheet("Texts")
    rows = [
        ("language", "blanks", "length", "escapes", "mixed", "numbers as text"),
        ("Ελληνικά", " leading", "a" * 79, "one\x01two", "text first", "12"),
        ("العربية", "trailing ", "b" * 80, "_x0041_ stays", 12.5, "-.5"),
        ("日本語テキスト", "two\nlines", "c" * 81, "_x005F_", -3, "1,000"),
        ("हिन्दी", "tab\tinside", "é" * 45, "bell\x07", 1e-7, "(12.5)"),
        ("Zażółć gęślą jaźń", "     ", "x" + "é" * 45, "a_x000D_b", 100, "1e3"),
        ("👩‍👩‍👧 family", "\n", "日" * 30, "<&>\"'", 0.1, "not a number"),
        ("עברית", "  both  ", "y" * 2000, "\x1f", 123456789.125, "")]
    for row, cells in enumerate(rows):
        for column, cell in enumerate(cells):
            sheet.write(row, column, cell)
    if not options:
        rich = book.add_worksheet("Rich")
        rich.write_rich_string(0, 0, bold, "Rich", " name")
        rich.write_rich_string(1, 0, "This is ", bold, "bold", " and ", red, "red")
        rich.write_rich_string(2, 0, red, " blanks ", bold, " kept ")
        rich.write_rich_string(3, 0, bold, "Ж", red, "😀")
    kinds = book.add_worksheet("Formulas")
    kinds.write_row(0, 0, ["number", "text", "truth", "error", "none", "typed truth"])
    for row in range(1, 5):
        kinds.write_formula(row, 0, f"=ROW()/4", None, (row + 1) / 4)
        kinds.write_formula(row, 1, f'="row "&ROW()', None, f"row {row + 1}")
        kinds.write_formula(row, 2, f"=ROW()>3", None, row > 2)
        kinds.write_formula(row, 3, "=1/0", None, "#DIV/0!" if row != 3 else 3)
        kinds.write_formula(row, 4, '=""', None, "")
        kinds.write_boolean(row, 5, row % 2 == 0)
    book.close()


numbers()
texts("xlsxwriter_texts.xlsx")
texts("xlsxwriter_inline.xlsx", constant_memory=True)
