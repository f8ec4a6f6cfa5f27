"""Writes workbooks with openpyxl: write_openpyxl.py DATA_FOLDER WORK_FOLDER"""
import datetime as dt
import sys

from openpyxl import Workbook
from openpyxl.chart import LineChart, Reference
from openpyxl.styles import Font

data, work = sys.argv[1:]
STAMP = dt.datetime(2024, 1, 2, 3, 4, 5)


def save(book, path):
    book.properties.created = book.properties.modified = STAMP
    book.save(path)


def dates():
    book = Workbook()
    sheet = book.active
    sheet.title = "Dates"
    columns = [
        ("default", None), ("m/d/yyyy", "m/d/yyyy"), ("built-in 14", "mm-dd-yy"),
        ("built-in 22", "m/d/yy h:mm"), ("d-mmm-yyyy", "d-mmm-yyyy"),
        ("long", '[$-409]dddd\\,\\ mmmm\\ dd\\,\\ yyyy'), ("month", "mmmm-yy"),
        ("not a date", "0.0")]
    sheet.append([name for name, _ in columns] + ["time", "am pm", "elapsed", "seconds"])
    moments = [dt.datetime(2010, 1, 1), dt.datetime(1900, 2, 28, 12), None,
               dt.datetime(1900, 3, 1), dt.datetime(1999, 12, 31, 23, 59, 59),
               dt.datetime(2024, 2, 29, 6, 30), dt.datetime(9999, 12, 31)]
    times = [dt.time(6, 30), dt.time(0, 0, 1), dt.time(12, 0), None, dt.time(23, 59, 59),
             dt.time(18, 45, 30, 250000), dt.time(1, 2, 3)]
    for row, (moment, time) in enumerate(zip(moments, times), 2):
        for column, (_, code) in enumerate(columns, 1):
            if moment is not None:
                cell = sheet.cell(row, column, moment)
                if code:
                    cell.number_format = code
        for column, code in enumerate(["h:mm:ss", "h:mm AM/PM", "[h]:mm:ss", "mm:ss.0"], 9):
            if time is not None:
                sheet.cell(row, column, time).number_format = code
    sheet["K8"] = dt.timedelta(days=2, hours=3)
    save(book, f"{data}/openpyxl_dates.xlsx")


def iso_dates():
    book = Workbook(iso_dates=True)
    sheet = book.active
    sheet.append(["day", "moment", "number"])
    for year in (1987, 2010, 2031):
        sheet.append([dt.date(year, 5, 6), dt.datetime(year, 5, 6, 7, 8, 9), year / 8])
    save(book, f"{data}/openpyxl_iso_dates.xlsx")


def sheets():
    book = Workbook()
    book.active.title = "Empty first"
    plan = book.create_sheet('Übersicht & "Plan" <1>')
    plan.append(["  padded name ", "#Sales 'Q1'\nnet", "*star", "x*", None, 12.5, "only a name",
                 True, "tab\there"])
    plan.append([1, 2, 3, 4, "no name", 5, None, False, "a"])
    plan.append([10, 20, 30, 40, "still none", 50, None, True, "b"])
    plan.merge_cells("A5:B6")
    plan["A5"] = "merged"
    plan.merge_cells("C5:C6")
    plan["C5"] = 77
    plan.column_dimensions["B"].hidden = True
    plan.row_dimensions[3].hidden = True
    chart = LineChart()
    chart.add_data(Reference(plan, min_col=1, min_row=1, max_row=3), titles_from_data=True)
    book.create_chartsheet("Chart").add_chart(chart)
    book.create_sheet("Empty between")["B2"] = "   "
    gaps = book.create_sheet("Gaps")
    gaps["C1"], gaps["F1"], gaps["H3"] = "third", "sixth", "without name"
    gaps["C4"], gaps["C9"], gaps["F2"], gaps["F12"] = 4, 9, "two", "twelve"
    gaps["C6"].font = Font(bold=True)
    hidden = book.create_sheet("Hidden")
    hidden.sheet_state = "hidden"
    hidden.append(["secret"])
    hidden.append(["yes"])
    save(book, f"{data}/openpyxl_sheets.xlsx")


def survey():
    """A workbook whose formulas nobody has computed yet: for programs that convert it."""
    book = Workbook()
    sheet = book.active
    sheet.title = "Survey"
    sheet.append(["Id", "Name", "Born", "Seen at", "Score", "Share", "Price", "Double", "Label",
                  "Grown up", "Broken", "Weekday"])
    people = [
        ("Ångström", (1987, 3, 4), (2024, 1, 5, 9, 30), 12.25, 0.125, 1999.5),
        ("Дмитрий", (1999, 12, 31), (2024, 1, 5, 17, 45), -3.5, 0.5, 0.25),
        ("山田 太郎", (2010, 1, 1), (2024, 2, 29, 0, 0), 1e-7, 1, 123456789.125),
        ("😀 smile", (1955, 6, 7), (2024, 3, 1, 23, 59), 1 / 3, 0.0025, -12.5),
        ("O'Neil & \"Co\"", (1900, 3, 1), (2025, 7, 8, 12, 0), 6.02e23, -0.75, 5)]
    for row, (name, born, seen, score, share, price) in enumerate(people, 2):
        sheet.append([row - 1, name, dt.datetime(*born), dt.datetime(*seen), score, share, price,
                      f"=G{row}*2", f'=B{row}&"-"&A{row}', f"=E{row}>0",
                      f"=A{row}/(A{row}-3)", f"=C{row}+1"])
        for column, code in (("C", "d-mmm-yy"), ("D", "m/d/yy h:mm"), ("F", "0.00%"),
                             ("G", '"$"#,##0.00'), ("H", "#,##0.00"), ("L", "m/d/yyyy")):
            sheet[f"{column}{row}"].number_format = code
    sheet.merge_cells("A8:C8")
    sheet["A8"] = "=SUM(A2:A6)"
    book.create_sheet("Nothing here")
    more = book.create_sheet("More")
    more["B1"], more["B2"], more["B5"] = "text then numbers", "text", 2.5
    more["D1"], more["D3"], more["D4"] = "numbers then text", 3, "four"
    save(book, f"{work}/survey.xlsx")


dates()
iso_dates()
sheets()
survey()
