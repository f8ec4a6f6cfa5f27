// Writes workbooks and XML Spreadsheet 2003 documents with libraries of npm:
// node write_with_node.js DATA_FOLDER MODULES_FOLDER
'use strict';
const fs = require('fs');
const path = require('path');
const [data, modules] = process.argv.slice(2);
const load = (name) => require(require.resolve(name, {paths: [modules]}));
const file = (name) => path.join(data, name);
const utc = (...parts) => new Date(Date.UTC(...parts));
const stamp = utc(2024, 0, 2, 3, 4, 5);

function sheetJs() {
    const X = load('xlsx');
    const kinds = X.utils.aoa_to_sheet([
        ['Number', 'Text', 'Truth', 'Percent', 'Day', 'Moment'],
        [1, 'one', true, 0.25, 40179, 40179.75],
        [-2.5, 'zwei – ß', false, 1, 45351, 45351.5],
        [null, null, null, null, null, null],
        [1e15, 'три', true, 0.0005, 61, 59.25],
        [0.1, '四 😀', true, -1, 2958465, 36526.999988425923]]);
    for (let row = 1; row < 6; ++row)
        for (const [column, code] of [['D', '0.0%'], ['E', 'm/d/yy'], ['F', 'm/d/yy h:mm']])
            if (kinds[column + (row + 1)]) kinds[column + (row + 1)].z = code;
    kinds.C5 = {t: 'e', v: 7, w: '#DIV/0!'};
    kinds.A8 = {t: 'n', v: 42, f: 'SUM(A2:A6)'};
    kinds['!ref'] = 'A1:F8';
    kinds['!merges'] = [X.utils.decode_range('A8:B9')];
    const blanks = X.utils.aoa_to_sheet([
        [' spaces ', 'lines', null, 'numbers after text'],
        ['  x', 'first\nsecond', null, 'none'],
        ['y  ', 'a\r\nb', null, 17],
        ['    ', 'end', null, 0.5]]);
    const book = X.utils.book_new();
    book.Props = {CreatedDate: stamp};
    X.utils.book_append_sheet(book, kinds, 'Kinds');
    X.utils.book_append_sheet(book, X.utils.aoa_to_sheet([]), 'Empty');
    X.utils.book_append_sheet(book, blanks, 'Blänks & more');
    X.writeFile(book, file('sheetjs_kinds.xlsx'), {compression: true});
    X.writeFile(book, file('sheetjs_shared_strings.xlsx'), {compression: true, bookSST: true});
    X.writeFile(book, file('sheetjs_kinds_2003.xml'), {bookType: 'xlml'});

    const dated = X.utils.book_new();
    const days = X.utils.aoa_to_sheet([
        ['day', 'plain'], [utc(2010, 0, 1), 3], [utc(2024, 1, 29, 18, 30), 4],
        [null, 5], [utc(1955, 5, 7), 6]], {cellDates: true, UTC: true});
    X.utils.book_append_sheet(dated, days, 'Days');
    X.writeFile(dated, file('sheetjs_iso_dates.xlsx'), {compression: true, cellDates: true});
    X.writeFile(dated, file('sheetjs_dates_2003.xml'), {bookType: 'xlml', cellDates: true});
}

async function excelJs() {
    const Excel = load('exceljs');
    const book = new Excel.Workbook();
    book.created = book.modified = stamp;
    const sheet = book.addWorksheet('Report');
    sheet.columns = [
        {header: 'day', key: 'a', style: {numFmt: 'dd/mm/yyyy'}},
        {header: 'rich', key: 'b'}, {header: 'computed', key: 'c', style: {numFmt: '0.000'}},
        {header: 'link', key: 'd', hidden: true}, {header: 'error', key: 'e'}];
    for (let i = 1; i <= 4; ++i)
        sheet.addRow([
            utc(2020 + i, i, i * 5), {richText: [{text: `run ${i} `},
                {font: {bold: true}, text: 'bold'}, {text: ' ж'}]},
            {formula: `A${i + 1}*${i}`, result: i / 7},
            {text: `link ${i}`, hyperlink: '#Report!A1'},
            i === 2 ? 8 : {error: '#N/A'}]);
    sheet.mergeCells('A7:B8');
    sheet.getCell('A7').value = utc(2030, 0, 1, 12);
    sheet.getRow(3).hidden = true;
    book.addWorksheet('Empty');
    await book.xlsx.writeFile(file('exceljs_report.xlsx'));

    const stream = new Excel.stream.xlsx.WorkbookWriter(
        {filename: file('exceljs_stream.xlsx'), useSharedStrings: false, useStyles: true});
    stream.created = stream.modified = stamp;
    const first = stream.addWorksheet('Stream');
    first.addRow(['text', 'number', 'truth', 'time']).commit();
    for (let i = 0; i < 5; ++i) {
        const row = first.addRow([`línea ${i}\n日本`, i * 1.1, i % 2 === 0, i / 24]);
        row.getCell(4).numFmt = 'h:mm AM/PM';
        row.commit();
    }
    first.commit();
    await stream.commit();
}

function excel4node() {
    const xl = load('excel4node');
    const book = new xl.Workbook({dateFormat: 'm/d/yyyy', logLevel: 0});
    const sheet = book.addWorksheet('Styles');
    const names = ['money', 'share', 'day', 'hour', 'text', 'truth', 'sum'];
    names.forEach((name, i) => sheet.cell(1, i + 1).string(name));
    const style = (code) => book.createStyle({numberFormat: code});
    const money = style('"€"#,##0.00; ("€"#,##0.00); -'), share = style('0.0%');
    const hour = style('h:mm:ss AM/PM');
    for (let i = 2; i <= 6; ++i) {
        sheet.cell(i, 1).number(i * 1000.126).style(money);
        sheet.cell(i, 2).number(i / 16).style(share);
        sheet.cell(i, 3).number(40000 + i * 500).style(style('m/d/yyyy'));
        sheet.cell(i, 4).number(i / 10).style(hour);
        sheet.cell(i, 5).string(i === 4 ? 'שלום & <tag>' : `text ${i}`);
        sheet.cell(i, 6).bool(i % 2 === 0);
        sheet.cell(i, 7).formula(`A${i}+B${i}`);
    }
    sheet.cell(8, 1, 9, 3, true).string('merged');
    sheet.column(2).hide();
    return book.writeToBuffer().then((buffer) =>
        fs.writeFileSync(file('excel4node_styles.xlsx'), buffer));
}

function writeExcelFile() {
    const write = load('write-excel-file/node').default;
    const day = (value) => ({value, type: Date, format: 'm/d/yyyy'});
    return write([
        ['Name', 'Joined', 'Pay', 'Active', {value: 'Wide', columnSpan: 2}],
        ['Žofie', day(utc(2015, 8, 30)), {value: 1234.5, format: '#,##0.00'}, true, 'w', null],
        ['李雷', day(utc(1999, 0, 2)), {value: 0.5, format: '#,##0.00'}, false, null, 7],
        [null, null, null, null, null, null],
        ['😎', day(utc(2040, 11, 24)), {value: -3, format: '#,##0.00'}, true, '  ', 8.25],
    ], {sheet: 'People'}).toFile(file('write_excel_file_people.xlsx'));
}

async function xlsxPopulate() {
    const book = await load('xlsx-populate').fromBlankAsync();
    const sheet = book.sheet(0).name('Первый');
    sheet.cell('B2').value([['имя', 'число', 'дата', 'проценты'],
        ['раз', 1.5, 40179, 0.1], ['два', -2, 40180.25, 0.255], ['три', 1e10, 2, 3]]);
    sheet.range('D3:D5').style('numberFormat', 'd-mmm-yy');
    sheet.range('E3:E5').style('numberFormat', '0.00%');
    sheet.cell('B1').value('head');
    sheet.cell('C1').value(3).style('numberFormat', '0.00');
    sheet.cell('D1').value(40179).style('numberFormat', 'm/d/yyyy');
    sheet.column('C').hidden(true);
    book.addSheet('Пустой');
    const rich = new (load('xlsx-populate').RichText)();
    rich.add('жирный', {bold: true}).add(' и нет');
    book.addSheet('Третий').cell('A1').value('rich');
    book.sheet('Третий').cell('A2').value(rich);
    await book.toFileAsync(file('xlsx_populate_sheets.xlsx'));
}

async function excelize() {
    const wasm = require.resolve('excelize-wasm', {paths: [modules]});
    const {init} = load('excelize-wasm');
    const library = await init(path.join(path.dirname(wasm), 'excelize.wasm.gz'));
    const book = library.NewFile();
    const put = (cell, value) => book.SetCellValue('Sheet1', cell, value);
    ['count', 'ratio', 'name', 'flag', 'day'].forEach((name, i) => put('ABCDE'[i] + 1, name));
    const {style} = book.NewStyle({NumFmt: 10});
    const {style: day} = book.NewStyle({CustomNumFmt: 'mmmm d, yyyy'});
    for (let i = 2; i <= 5; ++i) {
        put(`A${i}`, i * i), put(`B${i}`, i / 9), put(`C${i}`, `имя ${i} 한국어`);
        put(`D${i}`, i % 2 === 0), put(`E${i}`, 30000 + i * 2500);
    }
    book.SetCellStyle('Sheet1', 'B2', 'B5', style);
    book.SetCellStyle('Sheet1', 'E2', 'E5', day);
    book.SetCellRichText('Sheet1', 'C6', [{Text: 'rich '}, {Text: 'text', Font: {Bold: true}}]);
    book.MergeCell('Sheet1', 'A8', 'B9');
    put('A8', 'merged');
    book.NewSheet('Data');
    book.SetCellValue('Data', 'D4', 'far');
    book.SetCellValue('Data', 'D7', 1.25);
    book.AddChartSheet('Chart1', {Type: library.Col,
        Series: [{Name: 'Sheet1!$A$1', Categories: 'Sheet1!$C$2:$C$5', Values: 'Sheet1!$A$2:$A$5'}]});
    book.NewSheet('Last');
    book.SetCellValue('Last', 'A1', 'after the chart');
    book.SetCellValue('Last', 'A2', 9);
    fs.writeFileSync(file('excelize_chart.xlsx'), book.WriteToBuffer().buffer);
}

// A table of a web page, exported as the plug-in does in a browser.
function tableExport() {
    const {JSDOM} = load('jsdom');
    const page = new JSDOM(`<table id="t" data-tableexport-display="always"><thead>
        <tr><th>City</th><th>People</th><th>Share</th><th colspan="2">Wide</th></tr></thead><tbody>
        <tr><td>Köln</td><td>1073096</td><td>12.5%</td><td>a</td><td>1.5</td></tr>
        <tr><td>東京</td><td>13960000</td><td>50%</td><td>b &amp; c</td><td>-2</td></tr>
        <tr><td></td><td></td><td></td><td></td><td></td></tr>
        <tr><td>Осло</td><td>709037</td><td>1%</td><td colspan="2">both</td></tr>
        </tbody></table>`, {runScripts: 'outside-only'});
    const script = (name) => fs.readFileSync(path.join(modules, 'node_modules', name), 'utf8');
    page.window.eval(script('jquery/dist/jquery.js'));
    page.window.eval(script('tableexport.jquery.plugin/tableExport.min.js'));
    const xml = page.window.eval(`jQuery('#t').tableExport({type: 'excel', outputMode: 'string',
        exportHiddenCells: true, mso: {fileFormat: 'xmlss', worksheetName: ['Cities']}})`);
    fs.writeFileSync(file('tableexport_table_2003.xml'), xml);
}

(async () => {
    sheetJs();
    await excelJs();
    await excel4node();
    await writeExcelFile();
    await xlsxPopulate();
    tableExport();
    await excelize();
    process.exit(0);  // the runtime of the last library would keep the process alive
})().catch((error) => {
    console.error(error);
    process.exit(1);
});
