// All values of all worksheets, in the library's own model:
// exceljs.js BOOK WORKSHEETS ROWS COLUMNS LAST_CELL
const [file, sheets, , , cell] = process.argv.slice(2);
const book = new (require("exceljs").Workbook)();
book.xlsx.readFile(file).then(() => {
  if (book.worksheets[sheets - 1].getCell(cell).value === null) process.exit(1);
});
