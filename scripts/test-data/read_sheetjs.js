// Prints the cells of a spreadsheet as SheetJS reads them: node read_sheetjs.js MODULES_FOLDER FILE
// One list a worksheet: {"name", "cells": [[row, column, type, value], ...]} with 0-based rows and
// columns and the types n (number), s (text), b (Boolean), e (error) and d (ISO date and time).
'use strict';
const [modules, file] = process.argv.slice(2);
const X = require(require.resolve('xlsx', {paths: [modules]}));

const book = X.readFile(file, {cellText: false, sheetStubs: false});
const sheets = [];
book.SheetNames.forEach((name) => {
    const sheet = book.Sheets[name];
    if (sheet['!type'] === 'chart') return;
    const cells = Object.keys(sheet).filter((key) => key[0] !== '!').map((key) => {
        const {r, c} = X.utils.decode_cell(key);
        return [r, c, sheet[key].t, sheet[key].v];
    });
    sheets.push({name, cells: cells.filter((cell) => cell[2] !== 'z' && cell[3] !== undefined)});
});
console.log(JSON.stringify(sheets));
