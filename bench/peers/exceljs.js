// All values of all worksheets, in the library's own model.
const { Workbook } = require("exceljs");
const book = new Workbook();
book.xlsx.readFile(process.argv[2]).then(() => process.exit(book.worksheets[0].actualRowCount > 0 ? 0 : 1));
