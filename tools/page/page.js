
"use strict";
(() => {
const book = JSON.parse(document.getElementById("data").textContent);
const sheets = book.import.worksheets.map((sheet, i) => ({ ...sheet, summary: book.summaries[i] }));

// --- Elements. Texts of the workbook enter the page as text nodes only. ---

function fill(node, attributes, children) {
    for (const [name, value] of Object.entries(attributes)) {
        if (value !== null && value !== undefined) node.setAttribute(name, value);
    }
    node.append(...children.flat(Infinity).filter((child) => child !== null && child !== undefined));
    return node;
}

const el = (name, attributes = {}, ...children) => fill(document.createElement(name), attributes, children);
const svg = (name, attributes = {}, ...children) =>
    fill(document.createElementNS("http://www.w3.org/2000/svg", name), attributes, children);

// --- Words and numbers ---

const whole = new Intl.NumberFormat("en", { maximumFractionDigits: 0 });
const digits = new Intl.NumberFormat("en", { maximumSignificantDigits: 6 });

function number(value) {
    const size = Math.abs(value);
    if (size !== 0 && (size >= 1e10 || size < 1e-4)) return minus(value.toExponential(4).replace(/\.?0+e/, "e"));
    return minus(Number.isInteger(value) ? whole.format(value) : digits.format(value));
}

const minus = (text) => text.replaceAll("-", "\u2212");
const counted = (count, unit, units = unit + "s") => `${whole.format(count)} ${count === 1 ? unit : units}`;

function share(part, all) {
    if (part < all / 1000) return "under 0.1%";
    if (part < all && part > all - all / 1000) return "over 99.9%";
    return `${digits.format(Math.round(1000 * part / all) / 10)}%`;
}

const capital = (text) => text.charAt(0).toUpperCase() + text.slice(1);

// Control characters become visible symbols; those that turn the direction of writing are replaced.
const visible = (text) => text
    .replace(/\n/g, "\u21b5")
    .replace(/\t/g, "\u21e5")
    .replace(/[\u0000-\u001f]/g, (c) => String.fromCharCode(0x2400 + c.charCodeAt(0)))
    .replace(/\u007f/g, "\u2421")
    .replace(/[\u0080-\u009f\u2028-\u202e\u2066-\u2069]/g, "\ufffd");

const plain = (text, most = 200) => {
    const letters = Array.from(text.slice(0, 2 * most + 2));
    return visible(letters.length > most ? letters.slice(0, most).join("") + "\u2026" : text);
};

// A text of the workbook; `characters` is its length when only its beginning is known.
const quoted = (text, characters) => [
    el("bdi", {}, visible(text) + (characters ? "\u2026" : "")),
    characters ? el("span", { class: "whole" }, ` ${whole.format(characters)} characters`) : null];

const named = (column) => column.name === ""
    ? el("span", { class: "nameless" }, "no name") : el("bdi", {}, plain(column.name, 100));

// --- Rows: 0-based in the data, 1-based in the worksheet ---

const rowNumber = (sheet, row) => book.blankRowsLeftOut ? row + 1 : sheet.layout.firstDataRow + row;

function rowRange(sheet, first, last) {
    const from = whole.format(rowNumber(sheet, first));
    return first === last ? from : `${from}\u2013${whole.format(rowNumber(sheet, last))}`;
}

// The rows [first, last] of a stretch of a strip.
const stretch = (sheet, strip, i) => {
    const start = (at) => Math.ceil(at * sheet.layout.rows / strip.length);
    return [start(i), start(i + 1) - 1];
};

// Where a strip has rows, in words.
function rowsInWords(sheet, strip) {
    const ranges = [];
    strip.forEach((count, i) => {
        if (count === 0) return;
        const [first, last] = stretch(sheet, strip, i);
        const before = ranges[ranges.length - 1];
        if (before && before[1] + 1 === first) before[1] = last;
        else ranges.push([first, last]);
    });
    const most = 4;
    const words = ranges.slice(0, most).map(([first, last]) => rowRange(sheet, first, last)).join(", ");
    const more = ranges.length > most ? " and further down" : "";
    const within = strip.length < sheet.layout.rows ? "within " : "";
    return `${within}${ranges.length === 1 && ranges[0][0] === ranges[0][1] ? "row" : "rows"} ${words}${more}`;
}

// --- Findings ---

const columnOf = new Map();
const sheetOf = new Map();
for (const sheet of sheets) {
    sheetOf.set(sheet.title, sheet);
    sheet.columns.forEach((column, i) => {
        column.summary = sheet.summary.columns[i];
        column.sheet = sheet;
        column.findings = [];
        columnOf.set(column.summary.reference, column);
    });
}
// A place is a column, a cell, a range or a worksheet.
const columnAt = (place) => columnOf.get(place.replace(/(![A-Z]+)\d+(:[A-Z]+\d+)?$/, "$1"));
for (const trait of book.explanation.traits) {
    for (const place of trait.places) columnAt(place.place)?.findings.push({ trait, place });
}

function cure(options) {
    return el("span", { class: "cure" }, el("code", {}, options), " ",
        el("button", { type: "button", "data-copy": options, "aria-label": `Copy ${plain(options, 60)}` }, "Copy"));
}

// The advice of a trait, with the options in it ready to copy.
function advice(trait) {
    const parts = [];
    let rest = trait.advice;
    for (const options of trait.cures) {
        const at = rest.indexOf(options);
        if (at < 0) continue;
        parts.push(visible(rest.slice(0, at)), cure(options));
        rest = rest.slice(at + options.length);
    }
    return [parts, rest === "" ? null : `${visible(rest)}.`];
}

// What was found, and what follows a colon: often a long list. A colon in parentheses is no such mark.
function headOf(found) {
    const head = /^(?:[^:(]|\([^)]*\))*(?=: )/.exec(found);
    return head === null ? [found, ""] : [head[0], found.slice(head[0].length + 2)];
}

function placeLink(place) {
    const column = columnAt(place.place);
    const sheet = sheetOf.get(place.place);
    const target = column ? `#c${column.key}` : sheet ? `#w${sheet.key}` : null;
    const words = plain(place.place, 60);
    return el("li", {}, target ? el("a", { href: target }, el("bdi", {}, words)) : el("bdi", {}, words));
}

function findingItem(trait) {
    const most = 24;
    const places = trait.places.slice(0, most).map(placeLink);
    const more = trait.places.length - most;
    if (more > 0) places.push(el("li", {}, `and ${whole.format(more)} more`));
    const [head, details] = trait.found.length > 160 ? headOf(trait.found) : [trait.found, ""];
    return el("li", { class: "finding", "data-trait": trait.trait },
        el("h3", {}, capital(visible(head))),
        details === "" ? null : el("details", {}, el("summary", {}, "Details"), el("p", {}, visible(details))),
        el("p", {}, el("b", {}, "Import: "), visible(trait.effect), "."),
        el("p", {}, el("b", {}, "Advice: "), advice(trait)),
        places.length > 0 ? el("div", { class: "places" }, el("span", {}, "Where"), el("ul", {}, places)) : null);
}

function showFindings() {
    const traits = book.explanation.traits;
    const title = traits.length === 0 ? "Nothing to explain" : counted(traits.length, "thing to know", "things to know");
    document.getElementById("findings").append(
        el("h2", { id: "findings-title" }, title),
        traits.length === 0
            ? el("p", { class: "fine" }, "Nothing is known that this import loses or changes, besides the missing values below.")
            : el("ol", {}, traits.map(findingItem)));
}

// --- Charts ---

// Where a value stands in a distribution, from 0 to 1.
const placed = (spread, value) => {
    if (spread.eachNumber) return (value - spread.least + 0.5) / spread.bins.length;
    const width = spread.greatest / 2 - spread.least / 2;
    return width > 0 ? (value / 2 - spread.least / 2) / width : 0.5;
};

function dayInWords(serial, spread) {
    const time = new Date(Math.round((serial - 25569) * 86400) * 1000);
    if (Number.isNaN(time.getTime())) return number(serial);
    const iso = time.toISOString().replace("T", " ");
    if (spread.greatest < 1) return iso.slice(11, 16);
    return spread.greatest - spread.least < 3 ? iso.slice(0, 16) : iso.slice(0, 10);
}

// The values of a bin, in words.
function binInWords(spread, i, words) {
    if (spread.eachNumber) return words(spread.least + i);
    const at = (part) => spread.least * (1 - part) + spread.greatest * part;
    return `${words(at(i / spread.bins.length))} to ${words(at((i + 1) / spread.bins.length))}`;
}

const spreads = new WeakMap();  // of the charts, for the pointer

function histogram(spread, words, what, labels) {
    const bins = spread.bins;
    const height = 100;
    const top = Math.max(...bins);
    const path = bins.map((count, i) => count === 0 ? "" :
        `M${i + 0.06} ${height}v${-Math.max(3, height * count / top).toFixed(1)}h.88V${height}z`).join("");
    const fullest = bins.indexOf(top);
    const all = bins.reduce((sum, count) => sum + count, 0);
    const label = `Histogram of ${counted(all, what)}: ${labels[0]} to ${labels[2]}, median ${labels[1]}; ` +
        `most frequent ${binInWords(spread, fullest, words)} (${whole.format(top)})`;
    const x = (placed(spread, spread.median) * bins.length).toFixed(2);
    const chart = svg("svg", { class: "histogram", viewBox: `0 0 ${bins.length} ${height}`, preserveAspectRatio: "none", role: "img", "aria-label": label },
        svg("title", {}, label),
        svg("path", { class: "base", d: `M0 ${height}H${bins.length}` }), svg("path", { class: "bars", d: path }),
        svg("path", { class: "median", d: `M${x} 0V${height}` }));
    spreads.set(chart, { spread, words, what });
    return chart;
}

function scale(names, labels, exact) {
    return el("dl", { class: "scale" }, names.map((name, i) =>
        el("div", {}, el("dt", {}, name), el("dd", { title: exact[i] }, labels[i]))));
}

function spreadChart(column) {
    const spread = column.summary.distribution;
    if (spread === null) return el("p", { class: "more" }, "No values");
    const exact = [spread.least, spread.median, spread.greatest];
    const isDate = column.kind === "datetime";
    const labels = exact.map((value, i) => (isDate && column.summary.iso[i]) || number(value));
    const words = isDate ? (serial) => dayInWords(serial, spread) : number;
    if (spread.least === spread.greatest) return el("p", { class: "always" }, "Always ", el("b", { title: spread.least }, labels[0]));
    return el("div", { class: "chart" }, histogram(spread, words, "value", labels),
        scale(["minimum", "median", "maximum"], labels, exact));
}

function frequentTexts(column) {
    const { different, frequent } = column.summary.texts;
    if (frequent.length === 0) return [el("p", { class: "more" }, "No values")];
    const lengths = column.summary.lengths;
    const values = column.rows - column.missing;
    const most = frequent[0].count === 1 ? 3 : frequent.length;
    const items = frequent.slice(0, most).map((entry) => {
        const item = el("li", {}, el("span", { class: "quoted" }, quoted(plain(entry.text, 80), entry.characters)),
            el("span", { class: "count" }, `${whole.format(entry.count)}\u00d7`));
        item.style.setProperty("--share", `${(100 * entry.count / values).toFixed(1)}%`);
        return item;
    });
    const words = different === values ? "all different" : different === 1 ? "all equal" : counted(different, "different text");
    const span = lengths.least === lengths.greatest ? counted(lengths.least, "character")
        : `${whole.format(lengths.least)} to ${counted(lengths.greatest, "character")}, median ${number(lengths.median)}`;
    return [el("ol", { class: "frequent", "aria-label": "Most frequent texts" }, items),
        el("p", { class: "more" }, `${capital(words)}; ${span}`),
        lengths.bins.length > 1 && values > 20 ? el("div", { class: "chart lengths" }, histogram(lengths, number, "length",
            [lengths.least, lengths.median, lengths.greatest].map(number))) : null];
}

// Bars over the stretches of a strip, in the units of rows. What is rare stays visible: a few rows of a
// stretch, and all but a few.
function stripPath(sheet, strip) {
    return strip.map((count, i) => {
        if (count === 0) return "";
        const [first, last] = stretch(sheet, strip, i);
        const rows = last - first + 1;
        const height = count === rows ? 10 : Math.min(Math.max(10 * count / rows, 4), 7);
        return `M${first} 10v${-height.toFixed(2)}h${rows}V10z`;
    }).join("");
}

function strip(column) {
    const { sheet, summary } = column;
    const rows = sheet.layout.rows;
    if (column.rows === 0) return null;
    const converted = summary.converted ? summary.converted.strip : null;
    const ends = column.rows < rows ? `ends at row ${whole.format(rowNumber(sheet, column.rows - 1))}` : null;
    const words = summary.missing === null ? "no missing values" : `missing: ${rowsInWords(sheet, summary.missing)}`;
    const changed = converted === null ? null : `of them converted: ${rowsInWords(sheet, converted)}`;
    return el("figure", { class: "strip" },
        svg("svg", { viewBox: `0 0 ${rows} 10`, preserveAspectRatio: "none", role: "img", "aria-label": "Missing and converted values from the first row to the last" },
            svg("rect", { class: "present", width: column.rows, height: 10 }),
            summary.missing === null ? null : svg("path", { class: "absent", d: stripPath(sheet, summary.missing) }),
            converted === null ? null : svg("path", { class: "changed", d: stripPath(sheet, converted) })),
        el("figcaption", {},
            el("span", {}, summary.missing === null ? null : el("span", { class: "key absent" }), capital(words)),
            changed === null ? null : el("span", {}, "; ", el("span", { class: "key changed" }), changed),
            ends === null ? null : `; ${ends}`));
}

// --- Columns ---

function count(key, value, of, words = key) {
    return el("div", { class: value === 0 ? "none" : key }, el("dt", {}, words),
        el("dd", { "data-count": key }, whole.format(value), of ? ` (${of})` : null));
}

function lostTexts(column) {
    const converted = column.summary.converted;
    if (!converted) return null;
    const shown = converted.frequent.slice(0, 4);
    const more = converted.different - shown.length;
    return el("p", { class: "lost" }, "Lost: ", shown.map((entry, i) => [i > 0 ? ", " : null,
        quoted(plain(entry.text, 40), entry.characters), entry.count > 1 ? ` ${whole.format(entry.count)}\u00d7` : null]).flat(),
        more > 0 ? ` and ${counted(more, "other text")}` : null);
}

// What was found in one column of a trait that may concern many.
function foundHere(trait, place) {
    if (place.cells === undefined) return trait.found;
    const head = headOf(trait.found)[0].replace(/ \((first: )?[^)]*![^)]*\)/, "");
    return trait.places.length > 1 && /^\d/.test(head) ? `${whole.format(place.cells)} of ${head}` : head;
}

function cardFinding({ trait, place }) {
    const options = place.cure || trait.cures[0];
    const cells = /![A-Z]+(\d.*)$/.test(place.place) ? `${plain(place.place.slice(place.place.lastIndexOf("!") + 1))}: ` : "";
    return el("div", { class: "finding", "data-trait": trait.trait },
        el("p", {}, el("b", {}, cells), capital(plain(foundHere(trait, place), 150)), "; ", plain(trait.effect, 150), "."),
        options ? el("p", {}, cure(options)) : null);
}

function card(column) {
    const { kind, rows, missing, convertedMissing } = column;
    return el("li", { class: `card ${kind}`, id: `c${column.key}` },
        el("h4", {}, el("span", { class: "letters" }, column.summary.letters), named(column)),
        el("p", { class: "kind" }, el("b", {}, kind), ` \u00b7 ${plain(column.format.words || "", 80)}`),
        el("dl", { class: "counts" }, count(rows === 1 ? "row" : "rows", rows), count("missing", missing, missing === 0 ? "" : share(missing, rows)),
            kind === "text" ? null : count("converted", convertedMissing, "", convertedMissing === 0 ? "converted" : "of them converted")),
        kind === "text" ? frequentTexts(column) : spreadChart(column),
        lostTexts(column),
        strip(column),
        column.findings.map(cardFinding));
}

// --- First rows ---

function cell(column, row) {
    const side = column.kind === "text" ? "" : "right";
    if (row >= column.rows) return el("td", { class: "beyond" });
    const values = column.shown || column.values;
    if (column.values[row] === null) {
        const lost = column.summary.converted?.firstRows.find((entry) => entry.row === row);
        if (!lost) return el("td", { class: `gone ${side}` }, "missing");
        return el("td", { class: `turned ${side}`, title: "Its content did not fit the kind of the column: it is missing" },
            el("s", {}, el("bdi", {}, plain(lost.text, 60))), el("span", { class: "unseen" }, " missing, did not fit"));
    }
    const cut = column.summary.cut.find(([at]) => at === row);
    const exact = column.iso ? column.iso[row] : column.kind === "numeric" ? column.values[row] : null;
    return el("td", { class: side || null, title: exact !== null && String(exact) !== values[row] ? exact : null },
        quoted(values[row], cut && cut[1]));
}

const mostValues = (columns) => Math.max(0, ...columns.map((column) => column.values.length));

function rowsTable(sheet, columns, shown) {
    const head = columns.map((column) => el("th", { scope: "col", class: column.kind === "text" ? null : "right" },
        el("span", { class: "letters" }, column.summary.letters), named(column)));
    const body = Array.from({ length: shown }, (_, row) => el("tr", {},
        el("th", { scope: "row" }, whole.format(rowNumber(sheet, row))), columns.map((column) => cell(column, row))));
    return el("table", {}, el("thead", {}, el("tr", {}, el("th", { scope: "col" }, "row"), head)), el("tbody", {}, body));
}

const kColumnsAtOnce = 40;

function firstRows(sheet) {
    const place = el("div", { class: "scroll onscreen", tabindex: 0, role: "region", "aria-label": `First rows of ${plain(sheet.title, 60)}` });
    const more = el("button", { type: "button" });
    const below = el("p", { class: "below onscreen" });
    sheet.columnsShown = 0;
    const show = () => {
        sheet.columnsShown = Math.min(sheet.columns.length, sheet.columnsShown + kColumnsAtOnce);
        place.replaceChildren(rowsTable(sheet, sheet.columns.slice(0, sheet.columnsShown), mostValues(sheet.columns)));
        const left = sheet.columns.length - sheet.columnsShown;
        more.textContent = `Show ${Math.min(left, kColumnsAtOnce)} more columns`;
        below.replaceChildren(...(left > 0
            ? [`${counted(sheet.columnsShown, "column")} of ${whole.format(sheet.columns.length)}`, more] : []));
        below.hidden = left === 0;
    };
    more.addEventListener("click", show);
    show();
    return [place, below, el("div", { class: "printed" })];
}

// Tables one below the other, each as wide as the paper.
function printTables(sheet) {
    const most = { rows: 15, columns: 7 };
    const columns = sheet.columns.slice(0, sheet.columnsShown);
    const width = Math.ceil(columns.length / Math.ceil(columns.length / most.columns));
    const rows = Math.min(most.rows, mostValues(sheet.columns));
    const blocks = [el("p", {}, `${counted(rows, "row")} of ${whole.format(sheet.layout.rows)}, ` +
        `${counted(columns.length, "column")} of ${whole.format(sheet.columns.length)}`)];
    for (let at = 0; at < columns.length; at += width) {
        const block = columns.slice(at, at + width);
        const table = rowsTable(sheet, block, Math.min(rows, mostValues(block)));
        table.style.setProperty("--columns", block.length);
        blocks.push(table);
    }
    return blocks;
}

// --- Worksheets ---

function fact(words, value) {
    return el("div", {}, el("dt", {}, words), el("dd", {}, value));
}

function layoutFacts(sheet) {
    const { nameRow, firstDataRow, rows, lastUsedRow } = sheet.layout;
    const left = sheet.columnsLeftOut;
    return el("dl", { class: "layout" },
        fact("Names", nameRow === null ? "none" : `row ${whole.format(nameRow)}`),
        fact("Data", `from row ${whole.format(firstDataRow)}`),
        fact("Rows of data", whole.format(rows)),
        fact("Last used row", whole.format(lastUsedRow)),
        fact("Rows without any value", whole.format(sheet.summary.emptyRows) + (book.blankRowsLeftOut ? " (blank rows are left out)" : "")),
        fact("Columns", whole.format(sheet.columns.length) + (left > 0 ? ` (${whole.format(left)} more left out)` : "")));
}

const waiting = [];  // columns whose cards are not in the page yet

function worksheet(sheet) {
    const cards = el("ul", { class: "cards" });
    for (const column of sheet.columns) waiting.push({ column, cards });
    const shown = mostValues(sheet.columns);
    return el("section", { class: "sheet", id: `w${sheet.key}`, "aria-labelledby": `t${sheet.key}` },
        el("h2", { id: `t${sheet.key}` }, el("bdi", {}, plain(sheet.title, 100))),
        layoutFacts(sheet),
        shown === 0 ? null : [el("h3", { class: "part" }, "First rows",
            el("small", { class: "onscreen" }, shown < sheet.layout.rows ? `${whole.format(shown)} of ${whole.format(sheet.layout.rows)}` : "all of them")), firstRows(sheet)],
        el("h3", { class: "part" }, "Columns"), cards);
}

const made = [];  // { column, node } of the cards

function makeCards(until) {
    while (waiting.length > 0 && performance.now() < until) {
        const { column, cards } = waiting.shift();
        const node = card(column);
        made.push({ column, node });
        cards.append(node);
    }
}

const makeAllCards = () => makeCards(Infinity);

// A slice at a time, so that the page answers from the start.
function makeCardsInSlices() {
    makeCards(performance.now() + 30);
    if (waiting.length > 0) setTimeout(makeCardsInSlices);
    else document.documentElement.setAttribute("data-complete", "");
}

// --- The head ---

function figure(words, value, more, kind) {
    return el("div", { class: kind }, el("dt", {}, words), el("dd", {}, whole.format(value), more ? el("small", {}, ` ${more}`) : null));
}

function showHead() {
    const path = book.import.file;
    const name = path.slice(path.lastIndexOf("/") + 1);
    const columns = sheets.flatMap((sheet) => sheet.columns);
    const sum = (value) => columns.reduce((total, column) => total + value(column), 0);
    const cells = sum((column) => column.rows);
    const missing = sum((column) => column.missing);
    const converted = sum((column) => column.convertedMissing);
    document.title = `${plain(name, 80)} \u2013 import report`;
    document.getElementById("top").append(
        el("h1", {}, el("bdi", {}, plain(name, 120))),
        el("p", { class: "path" }, "What an import of this workbook delivers", name === path ? null : [" \u00b7 ", el("bdi", {}, plain(path, 300))]),
        el("dl", { class: "figures" },
            figure(sheets.length === 1 ? "worksheet" : "worksheets", sheets.length), figure(columns.length === 1 ? "column" : "columns", columns.length),
            figure(cells - missing === 1 ? "value" : "values", cells - missing),
            figure("missing", missing, missing === 0 ? "" : share(missing, cells)),
            figure(converted === 0 ? "converted" : "of them converted", converted, "", converted === 0 ? null : "converted")),
        sheets.length < 2 ? "" : el("nav", { "aria-label": "Worksheets" }, el("ul", {},
            sheets.map((sheet) => el("li", {}, el("a", { href: `#w${sheet.key}` }, el("bdi", {}, plain(sheet.title, 60))))))));
}

function showFoot() {
    document.getElementById("end").append(
        el("p", {}, `Made by dpxlsx ${book.version}. Missing: no value arrives. Converted: the cell had content that does not fit the kind of its column, and is missing. ` +
            "The data of this page is in it as JSON, in the element with the id \u201cdata\u201d."));
}

// --- Finding columns ---

const kConditions = {
    all: ["all columns", () => true],
    missing: ["with missing values", (column) => column.missing > 0],
    converted: ["with converted values", (column) => column.convertedMissing > 0],
    findings: ["with things to know", (column) => column.findings.length > 0],
};

function filterTools() {
    const search = el("input", { type: "search", size: 18, placeholder: "name or letters", autocomplete: "off" });
    const choice = el("select", {}, Object.entries(kConditions).map(([key, [words]]) => el("option", { value: key }, words)));
    const result = el("output", {});
    const apply = () => {
        makeAllCards();
        const wanted = search.value.trim().toLowerCase();
        const holds = kConditions[choice.value][1];
        let shown = 0;
        for (const { column, node } of made) {
            const fits = holds(column) && (wanted === "" || column.name.toLowerCase().includes(wanted) ||
                column.summary.letters.toLowerCase() === wanted);
            node.hidden = !fits;
            shown += fits ? 1 : 0;
        }
        result.textContent = shown === made.length ? "" : `${whole.format(shown)} of ${counted(made.length, "column")}`;
    };
    search.addEventListener("input", apply);
    choice.addEventListener("change", apply);
    return el("div", { class: "tools", role: "search", "aria-label": "Columns" },
        el("label", {}, "Find a column", search), el("label", {}, "Show", choice), result);
}

// --- What the user does ---

async function copy(button) {
    const options = button.dataset.copy;
    try {
        await navigator.clipboard.writeText(options);
    } catch {
        getSelection().selectAllChildren(button.previousElementSibling);
        document.execCommand("copy");
    }
    button.textContent = "Copied";
    document.getElementById("said").textContent = `Copied: ${plain(options, 100)}`;
    setTimeout(() => { button.textContent = "Copy"; }, 2000);
}

document.addEventListener("click", (event) => {
    const button = event.target.closest("button[data-copy]");
    if (button) copy(button);
    if (event.target.closest("a[href^='#']")) makeAllCards();
});

document.addEventListener("pointermove", (event) => {
    const chart = event.target.closest?.("svg.histogram");
    if (!chart) return;
    const { spread, words, what } = spreads.get(chart);
    const box = chart.getBoundingClientRect();
    const bin = Math.floor((event.clientX - box.left) / box.width * spread.bins.length);
    if (!(bin in spread.bins)) return;
    chart.querySelector("title").textContent = `${binInWords(spread, bin, words)}: ${counted(spread.bins[bin], what)}`;
});

addEventListener("beforeprint", () => {
    makeAllCards();
    for (const sheet of sheets) {
        document.querySelector(`#w${sheet.key} .printed`)?.replaceChildren(...printTables(sheet));
    }
});
addEventListener("afterprint", () => {
    for (const place of document.querySelectorAll(".printed")) place.replaceChildren();
});

showHead();
showFindings();
document.getElementById("worksheets").append(filterTools(),
    ...(sheets.length === 0 ? [el("p", { class: "fine" }, "No worksheet with values.")] : sheets.map(worksheet)));
showFoot();
makeCardsInSlices();
if (location.hash !== "") {
    makeAllCards();
    document.getElementById(location.hash.slice(1))?.scrollIntoView();
}
})();
