// Prints the values of a workbook as SheetJS reads them: node sheetjs_cells.js MODULES_FOLDER BOOK
// {"date1904", "sheets": {NAME: [[row, column, type, value, format code], ...]}} with 0-based rows and
// columns, the types n, s, b and e, and a code for dates alone. Chart sheets are left out.
'use strict';
const [modules, file] = process.argv.slice(2);
const X = require(require.resolve('xlsx', {paths: [modules]}));

const book = X.readFile(file, {cellNF: true, cellText: false});
const sheets = {};
for (const name of book.SheetNames) {
    const sheet = book.Sheets[name];
    if (sheet['!type'] === 'chart') continue;
    sheets[name] = Object.keys(sheet).filter((key) => key[0] !== '!').map((key) => {
        const {r, c} = X.utils.decode_cell(key);
        const {t, v, z} = sheet[key];
        return [r, c, t, v, t === 'n' && X.SSF.is_date(z || '') ? z : ''];
    }).filter(([, , type, value]) => type !== 'z' && value !== undefined && !Number.isNaN(value));
}
const properties = (book.Workbook && book.Workbook.WBProps) || {};
console.log(JSON.stringify({date1904: Boolean(properties.date1904), sheets}));
