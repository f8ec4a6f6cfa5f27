// All values of all worksheets, in the layout that needs least memory:
// sheetjs.js BOOK WORKSHEETS ROWS COLUMNS LAST_CELL
const [file, sheets, rows, columns] = process.argv.slice(2);
const book = require("xlsx").readFile(file, { dense: true, cellText: false, cellHTML: false });
const last = book.Sheets[book.SheetNames[sheets - 1]];
if (last[rows - 1][columns - 1].v === undefined) process.exit(1);
