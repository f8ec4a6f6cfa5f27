#!/usr/bin/env python3
"""Opens pages of the built dpxlsx in Chromium. Usage: page_test.py DPXLSX SOURCE_FOLDER [TEST...]"""

import collections
import html
import json
import math
import os
import pathlib
import random
import re
import shutil
import statistics
import subprocess
import sys
import tempfile
import unittest
import zipfile

import jsonschema

TOOL = os.path.abspath(sys.argv.pop(1))
SOURCE = pathlib.Path(sys.argv.pop(1)).absolute()
SAMPLE = SOURCE / "samples" / "sample.xlsx"
SCHEMA = json.loads((SOURCE / "docs" / "tool.schema.json").read_text())
PAGE = jsonschema.Draft202012Validator({**{k: v for k, v in SCHEMA.items() if k != "oneOf"},
                                        "$ref": "#/$defs/page"})
DATA = re.compile('<script type="application/json" id="data">(.*?)</script>', re.S)
COMPLETE = "<html[^>]* data-complete"
HOSTILE = ["</script><script>alert(1)</script>", "<!--<script>", "<img src=x onerror=alert(1)>",
           "]]>&amp;&lt;", "a\u2028b\u2029c", "\u202egnp.exe\u202c", "x" * 32767, "\u0085\u200f\ufeff",
           "tab\tline\nend", "'\"`${x}\\u0041", "\U0001f3f0\u0301", "a" + "\u20ac" * 99]


def letters(number):
    text = ""
    while number > 0:
        number, rest = divmod(number - 1, 26)
        text = chr(65 + rest) + text
    return text


def workbook(target, rows, title="Data"):
    """A workbook with these rows of numbers and texts; None for no cell."""
    def cell(row, column, value):
        place = f"{letters(column)}{row}"
        if isinstance(value, str):
            text = html.escape(value)
            return f'<c r="{place}" t="inlineStr"><is><t xml:space="preserve">{text}</t></is></c>'
        return "" if value is None else f'<c r="{place}"><v>{value}</v></c>'

    office = "http://schemas.openxmlformats.org"
    sheet = "".join(f'<row r="{r}">' + "".join(
        cell(r, c, value) for c, value in enumerate(row, start=1)) + "</row>"
        for r, row in enumerate(rows, start=1))
    parts = {
        "xl/workbook.xml": f'<workbook xmlns="{office}/spreadsheetml/2006/main" xmlns:r="{office}/'
                           'officeDocument/2006/relationships"><sheets><sheet name='
                           f'"{html.escape(title)}" sheetId="1" r:id="a"/></sheets></workbook>',
        "xl/_rels/workbook.xml.rels": f'<Relationships xmlns="{office}/package/2006/relationships">'
                                      f'<Relationship Id="a" Type="{office}/officeDocument/2006/'
                                      'relationships/worksheet" Target="worksheets/sheet1.xml"/>'
                                      '</Relationships>',
        "xl/styles.xml": f'<styleSheet xmlns="{office}/spreadsheetml/2006/main"><cellXfs count="1">'
                         '<xf numFmtId="0"/></cellXfs></styleSheet>',
        "xl/worksheets/sheet1.xml": f'<worksheet xmlns="{office}/spreadsheetml/2006/main"><sheetData>'
                                    f'{sheet}</sheetData></worksheet>'}
    with zipfile.ZipFile(target, "w", zipfile.ZIP_DEFLATED, compresslevel=1) as made:
        for name, content in parts.items():
            made.writestr(name, content)
    return target


def spread(values, most):
    """What a page says of the distribution of these numbers."""
    if not values:
        return None
    least, greatest = min(values), max(values)
    each = greatest - least < most and all(value == math.trunc(value) for value in values)
    bins = [0] * (int(greatest - least) + 1 if each else min(most, math.ceil(2 * len(values) ** 0.5)))
    width = greatest / 2 - least / 2
    for value in values:
        place = (value / 2 - least / 2) / width if width > 0 else 0
        bins[int(value - least) if each else min(int(place * len(bins)), len(bins) - 1)] += 1
    return {"least": least, "median": statistics.median(values), "greatest": greatest,
            "eachNumber": each, "bins": bins}


def strip(rows, of, most):
    counts = [0] * min(of, most)
    for row in rows:
        counts[row * len(counts) // of] += 1
    return counts if rows else None


def frequent(texts, most):
    """The number of different texts and the most frequent ones; `texts` are (row, text)."""
    counts = collections.Counter(text for _, text in texts)
    rows = {text: row for row, text in reversed(texts)}
    order = sorted(counts, key=lambda text: (-counts[text], rows[text]))
    return {"different": len(counts), "frequent": [
        {"text": text, "count": counts[text], "row": rows[text]} for text in order[:most]]}


class PageTest(unittest.TestCase):
    def setUp(self):
        self.folder = pathlib.Path(tempfile.mkdtemp())
        self.addCleanup(shutil.rmtree, self.folder, ignore_errors=True)
        (self.folder / "temporary").mkdir()
        self.page = self.folder / "page.html"

    def tearDown(self):
        self.assertEqual(os.listdir(self.folder / "temporary"), [])

    def run_tool(self, *arguments, expected=0):
        done = subprocess.run([TOOL, *map(str, arguments)], capture_output=True, check=False,
                              cwd=self.folder, timeout=120,
                              env={**os.environ, "TMPDIR": str(self.folder / "temporary")})
        self.assertEqual(done.returncode, expected, done.stderr.decode())
        return done.stdout.decode()

    def written(self, book, *options):
        """The data in the page of the workbook."""
        self.run_tool(book, "--page", self.page, *options)
        data = json.loads(DATA.search(self.page.read_text())[1])
        PAGE.validate(data)
        return data

    def opened(self, page=None):
        """The page's elements as the browser has them, and what its console said."""
        home = self.folder / "home"
        done = subprocess.run(
            ["chromium", "--headless", "--no-sandbox", "--disable-gpu", "--disable-dev-shm-usage",
             "--enable-logging=stderr", f"--user-data-dir={home}", "--virtual-time-budget=20000",
             "--dump-dom", (page or self.page).as_uri()], capture_output=True, timeout=120,
            check=True, env={**os.environ, "HOME": str(self.folder), "TMPDIR": str(self.folder)})
        said = [line for line in done.stderr.decode().splitlines() if "CONSOLE" in line]
        return done.stdout.decode(), said

    def check_summaries(self, data, whole, bins, stretches, texts):
        """Compares the summaries with the values that --json has in full."""
        for summary, sheet in zip(data["summaries"], whole["worksheets"], strict=True):
            rows = sheet["layout"]["rows"]
            empty = [all(row >= len(c["values"]) or c["values"][row] is None
                         for c in sheet["columns"]) for row in range(rows)]
            self.assertEqual(summary["emptyRows"], sum(empty))
            for told, column in zip(summary["columns"], sheet["columns"], strict=True):
                values = column["values"]
                filled = [(row, v) for row, v in enumerate(values) if v is not None]
                if column["kind"] == "text":
                    self.assertEqual(told["texts"], frequent(filled, texts), column["name"])
                    self.assertEqual(told["lengths"], spread([len(v) for _, v in filled], bins))
                else:
                    self.assertEqual(told["distribution"], spread([v for _, v in filled], bins),
                                     column["name"])
                gone = [row for row, v in enumerate(values) if v is None]
                self.assertEqual(told["missing"], strip(gone, rows, stretches))
                self.assertEqual(sum((told.get("converted") or {"strip": []})["strip"]),
                                 column["convertedMissing"])

    def test_the_page_shows_the_figures_of_json(self):
        data = self.written(SAMPLE)
        whole = json.loads(self.run_tool(SAMPLE, "--json"))
        self.assertEqual(data["import"], whole)  # all rows are first rows
        self.assertEqual(data["explanation"], json.loads(self.run_tool(SAMPLE, "--explain", "--json")))
        self.check_summaries(data, whole, 24, 80, 8)
        lost = data["summaries"][0]["columns"][11]["converted"]
        self.assertEqual(lost["firstRows"], [{"text": "n/a", "row": 2}])
        shown, said = self.opened()
        self.assertEqual(said, [])
        self.assertRegex(shown, COMPLETE)
        for sheet in whole["worksheets"]:
            for column in sheet["columns"]:
                card = re.search(f'<li class="card {column["kind"]}" id="c{column["key"]}">.*?</h4>(.*?)<dl '
                                 'class="counts">(.*?)</dl>', shown, re.S)
                counts = {name.rstrip("s"): int(value.replace(",", "")) for name, value in
                          re.findall(r'data-count="(\w+)">([\d,]+)', card[2])}
                wanted = {"row": column["rows"], "missing": column["missing"]}
                if column["kind"] != "text":
                    wanted["converted"] = column["convertedMissing"]
                self.assertEqual(counts, wanted)
                self.assertIn(html.escape(column["format"]["words"], False), card[1])
        body = re.search("<tbody>(.*?)</tbody>", shown, re.S)[1]
        cells = [[html.unescape(re.sub("<[^>]*>", "", cell)) for cell in re.findall(
            "<td.*?>(.*?)</td>", row, re.S)] for row in body.split("</tr>")[:-1]]
        for i, column in enumerate(whole["worksheets"][0]["columns"]):
            values = column.get("shown", column["values"])
            for row, value in enumerate(values):
                self.assertEqual(cells[row][i].split(" missing, ")[0].replace("\u21b5", "\n"), value if value is not None else
                                 "n/a" if (column["name"], row) == ("Count", 2) else "missing")

    def test_every_finding_stands_at_its_column_with_its_cure(self):
        data = self.written(SAMPLE)
        page, _ = self.opened()
        for letter, key, cure in (("L", 12, "--type 'Measurements!L=text'"), ("M", 13, "--max-text 93"),
                                  ("G", 7, "--standard")):
            card = page.split(f'id="c{key}"')[1].split('<li class="card')[0]
            self.assertIn(f'data-copy="{cure}"', card)
            self.assertIn(f'<a href="#c{key}"><bdi>Measurements!{letter}</bdi>', page)
        self.assertEqual([t["trait"] for t in data["explanation"]["traits"]],
                         re.findall('<li class="finding" data-trait="(.*?)"', page))
        self.written(workbook(self.folder / "lost.xlsx", [["a", "b"], [1, 1], ["x", "y"], [2, "z"]]))
        found = re.findall('<div class="finding"[^>]*><p>(?:<b></b>)?(.*?)</p>.*?data-copy="(.*?)"', self.opened()[0])
        self.assertEqual(found, [(f"{count} of 3 cells do not fit the kind of the column; a missing value arrives.",
                                  f"--type 'Data!{column}=text'") for count, column in ((1, "A"), (2, "B"))])

    def test_summaries_of_many_values(self):
        chance = random.Random(7)
        kinds = [lambda: chance.gauss(0, 1e5), lambda: chance.randrange(-3, 9), lambda: 5, lambda: chance.choice(
            ["yes", "no", "", "n\u00e4mlich"]), lambda: chance.choice([1.5, 2.5, "n/a", None]),
                 lambda: chance.choice([-1e300, 1e300, 5e-324]), lambda: chance.randrange(10 ** 15)]
        rows = [[f"c{i}" for i in range(len(kinds))]] + [
            [kind() for kind in kinds] if r % 50 else [] for r in range(1, 1000)]
        book = workbook(self.folder / "many.xlsx", rows)
        wide = ["--range", "-1.7e308:1.7e308"]
        whole = json.loads(self.run_tool(book, "--json", *wide))
        data = self.written(book, *wide)
        self.check_summaries(data, whole, 24, 80, 8)
        for column in data["import"]["worksheets"][0]["columns"]:
            self.assertEqual(len(column["values"]), 50)
        self.assertEqual(len(self.written(book, "--head", "3")["import"]["worksheets"][0]["columns"][0]["values"]), 3)
        forced = self.written(book, "--type", "E=numeric")["summaries"][0]["columns"][4]
        self.assertNotIn("converted", forced)  # where they are is not known
        self.assertEqual(self.written(book, "--sheet", "1", "--skip-blank-rows")["summaries"][0]["emptyRows"], 0)

    def test_hostile_texts_do_no_harm(self):
        book = workbook(self.folder / "<script>&.xlsx", [HOSTILE, *([text] for text in HOSTILE), [1]],
                        title="</title><img>")
        data = self.written(book, "--max-text", "none")
        column = data["import"]["worksheets"][0]["columns"][0]
        whole = json.loads(self.run_tool(book, "--json", "--max-text", "none"))
        for shown, value in zip(column["values"], whole["worksheets"][0]["columns"][0]["values"]):
            self.assertTrue(value.startswith(shown) and len(shown.encode()) >= min(len(value.encode()), 190), shown)
        self.assertEqual(data["summaries"][0]["columns"][0]["cut"],
                         [[row, len(text)] for row, text in enumerate(HOSTILE) if len(text) > 99])
        text = self.page.read_text()
        self.assertEqual(len(re.findall("(?i)<script", text)), 2)
        self.assertIsNone(re.search("<!--<|<img|[\u2028\u2029]", text))
        shown, said = self.opened()
        self.assertEqual(said, [])
        body = DATA.sub("", shown)
        self.assertEqual((len(re.findall("(?i)<script", body)), len(re.findall("<img|\u202e", body))), (1, 0))
        self.assertIn("32,767 characters", body)
        self.assertIn(html.escape(HOSTILE[0], False), body)
        self.written(book, "--clean-sheet-names")
        self.assertIn('<a href="#c1"><bdi>__title__img_!A', self.opened()[0])

    def test_two_thousand_columns_and_a_hundred_thousand_rows_stay_small(self):
        rows = [[f"Column {c}" for c in range(2000)]] + [
            [r * c / 7 if c % 3 else f"text {r * c % 11}" for c in range(2000)] for r in range(10)]
        rows += [[r / 3] for r in range(100000 - 10)]
        self.run_tool(workbook(self.folder / "large.xlsx", rows), "--page", self.page)
        self.assertLess(self.page.stat().st_size, 5000000)
        shown, said = self.opened()
        self.assertEqual(said, [])
        self.assertEqual(shown.count('<li class="card'), 2000)
        self.assertLess(DATA.sub("", shown).count("<"), 2 * 120000)  # about two for an element

    def test_a_changed_script_does_not_run(self):
        self.written(SAMPLE)
        changed = self.folder / "changed.html"
        changed.write_text(self.page.read_text().replace('"use strict";', '"use strict" ;'))
        shown, said = self.opened(changed)
        self.assertNotRegex(shown, COMPLETE)
        self.assertIn("Content Security Policy", "".join(said))

    def test_a_failing_import_leaves_no_page(self):
        book = self.folder / "book.xlsx"
        book.write_text("no package")
        self.page.write_text("before")
        self.run_tool(book, "--page", self.page, expected=22)
        self.assertEqual(self.page.read_text(), "before")
        self.run_tool(SAMPLE, "--page", "none/page.html", expected=3)
        self.run_tool(SAMPLE, "--page", SAMPLE, expected=2)
        self.run_tool(SAMPLE, "--page", "--explain", expected=2)
        self.assertEqual(sorted(os.listdir(self.folder)), ["book.xlsx", "page.html", "temporary"])


if __name__ == "__main__":
    unittest.main()
