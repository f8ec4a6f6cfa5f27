// Prints how other programs take number-format codes: node render_codes.js MODULES_FOLDER WORK_FOLDER
// A row for each code of number_format_codes.txt and many more: whether it shows dates, times, both
// or numbers, and what values look like. SheetJS tells dates from numbers; it and LibreOffice must
// show the same. Where they do not, or where an import shows something else on purpose, a row of
// `decisions` says which text holds and why; without one the run fails. So it is with the rows of
// `sectioned`, of number codes with several sections or conditions, and `chosen`.
'use strict';
const {execFileSync} = require('child_process');
const fs = require('fs');
const path = require('path');
const [modules, work] = process.argv.slice(2);
const X = require(require.resolve('xlsx', {paths: [modules]}));

const at = (year, month, day, hour, minute, second) =>
    (Date.UTC(year, month - 1, day, hour, minute) / 1000 + second) / 86400 + 25569;
const values = [
    at(2024, 2, 29, 6, 5, 7),
    at(2023, 12, 31, 18, 45, 59),
    at(2011, 1, 5, 9, 8, 0),
    61,  // 1 March 1900, the first day on which all programs agree
    at(2024, 2, 29, 23, 59, 59.5),
    // Only under codes without dates: programs have different days for them.
    0.5 / 24,
    0.25,
    1.5,
];
const datedValues = 5;
const halfSecond = 4;
const number = 1234.5678;
// A time is cut off after its last shown unit, as ICU and LibreOffice's times of day do; SheetJS,
// and LibreOffice beside dates, round. So what holds for the half second is the text one half before.
const beforeHalfSecond = at(2024, 2, 29, 23, 59, 59);
const sameMorning = at(2023, 12, 31, 6, 5, 7);
const sameDay = at(2024, 2, 29, 18, 45, 59);
const columns = [...values, number, beforeHalfSecond, sameMorning, sameDay];

const dates = ['yyyy-mm-dd', 'dd/mm/yyyy', 'm/d/yy', 'd\\.m\\.yyyy', 'dd\\-mmm\\-yy', 'd. mmmm yyyy',
    'dddd, mmmm d, yyyy', 'ddd d mmm', 'yyyymmdd', 'DD.MM.YYYY', 'D-MMM-YYYY', 'yyyy"年"m"月"d"日"', 'mmmmm-yy',
    '[$-409]mmm d, yyyy'];
const times = ['h:mm', 'hh:mm', 'hh:mm:ss', 'h:mm AM/PM', 'hh:mm:ss am/pm', 'h:mm:ss.000', 'HH:MM', 'hhmmss', 'h"h"mm',
    'mm:ss', 'h\\:m\\:s', 'hh.mm'];
const made = [
    ...dates.flatMap((date) => [date, `${date};@`, `[Red]${date}_)`]),
    ...times.flatMap((time) => [time, `[$-409]${time};@`, `${time};[Blue]-${time}`]),
    ...dates.flatMap((date) => times.map((time) => `${date} ${time}`)),
    ...times.flatMap((time) => dates.slice(0, 4).map((date) => `${time} ${date}`)),
    // Months and minutes
    'm', 'mm', 'mmm', 'mmmm', 'mmmmm', 'mm.yyyy', 'mmddhhmm', 'h:mmm', 'mmm:ss', 'h:mm:mm', 'h AM/PM:mm',
    'ss:mm', 'h m d', 'h d m', 'm:d:s', 'mm dd ss', 'm s', 'h"m"m', 'm "s" h', 'h "literal with s" m',
    '[h]"h "m"m"', 'mm"s"', 'm/d h:m',
    // Lengths and letters
    'y', 'yy', 'yyy', 'yyyy', 'yyyyy', 'd', 'dd', 'ddd', 'dddd', 'ddddd', 'mmmmmm', 'h', 'hh', 's', 'ss',
    'd/m/y', 'Mmm-YY', 'dDdD', 'YyYy-mM-Dd', 'e', 'eeee', 'gge', '[$-411]ggge"年"m"月"d"日"', 'bb', 'bbbb', 'b1d',
    'B2yyyy', 'TT.MM.JJJJ',
    // Halves of the day, fractions of seconds, elapsed times
    'AM/PM', 'h am/pm', 'h Am/Pm', 'AM/PM h:mm', 'hh:mm:ssAM/PM', 'a/p h', 'h A/P', 'mm:ss.0 AM/PM',
    '上午/下午h"時"mm"分"', 'mmss.0', 's.00', 'ss.000', 'ss.', 'ss ".00"', 'h:mm:ss.0', 'h:mm:ss.0000', '[h]',
    '[h]:mm', '[hh]:mm:ss', '[H]:MM:SS', '[mm]:ss', '[m]:ss.0', '[ss]', '[s].000', '[h]:mm:ss.00',
    '[h] \\h\\o\\u\\r\\s', 'd [h]:mm',
    // Literals, fillings, brackets
    'yyyy-mm-dd"T"hh:mm:ss.000"Z"', 'yyyy-mm-dd\\Thh:mm', 'yyyy-mm-ddThh:mm:ssZ', 'yyyy\\\'mm',
    'd "o\'clock" h', '"it\'s" yyyy', 'yyyy\\"d', 'mmmm"."yy', 'd "de" mmmm "de" yyyy', 'dd mmm, yyyy at h:mm',
    'hh時mm分', 'h_-m', 'h* m', 'h*-mm', 'yyyy_-mm_-dd', '[Color12]yyyy', '[$-409][Red]yyyy',
    '"on "[$-409]mmm d', 'yyyy[$-409]mm', '[$-40C]d mmmm yyyy', '[DBNum1]yyyy', '[$-804]yyyy"年"m"月"',
    '[$-1010409]m/d/yyyy h:mm AM/PM', '[>=50]yyyy;0', '[<1]h:mm;yyyy', 'yyyy;General',
    // Numbers, some with letters of dates
    '"d"0', '\\d0', '0"days"', '0\\d', '0_d', '0*d', '0.00 "s"', '[Red]0', '[Cyan]0.0;[Magenta]0',
    '[Yellow]General', 'general', 'General"h"', 'General d', 'General;yyyy', '0;yyyy', ';yyyy', ';;;',
    '"yyyy"', '@', '@ yyyy', '0.00 s', '0.0 m', '0 d', '0 g', '#,##0 y', '0.0 kg', '0 e', '0.0E+00',
    '0.00e+00', '0.0E-0', '##0.0E+0', '0E+0', '0.###E+00', '0.0E+00%', '0.000%', '0.0%;[Red]-0.0%', '0"%"',
    '0\\%', '"%"0.0', '0%%', '%0', '0.00 %', '# ?/?', '# ?/8', '#/##', '0,', '0.0,,', '0, "k"', '#,##0.00,',
    '0,000', ',0', '# ##0.00', '#,##0.0##', '#,##0.???', '.00', '.##', '?0.0', '000-00-0000', '00000',
    '[<=9999999]###-####;(###) ###-####', '(0.00)', '+0.0;-0.0', '€0.00', '[$-409]0.00', '[$USD] 0.00',
    '[$kr-41D] #,##0.00', '#,##0.00 [$€-1]', '_($* #,##0.00_)', '0.00;General', 'x',
];

const ssf = (code, value) => {
    try {
        return X.SSF.format(code, value);
    } catch {
        return null;
    }
};

// Which text holds, given those of SheetJS and LibreOffice, and of which kind the code is if it is not
// what SheetJS says.
const sheetjs = (texts) => texts.sheetjs;
const office = (texts) => texts.office;
const allDigits = () => String(number);
const decisions = [
    {
        codes: ['h A/P', 'a/p h'], text: office,
        why: 'SheetJS shows A/P in capital letters, LibreOffice and ICU in small ones',
    }, {
        codes: ['[$-F400]h:mm:ss\\ AM/PM'], text: sheetjs,
        why: 'the code holds, not the time format of the system that may be shown instead',
    }, {
        codes: ['[$-40C]d mmmm yyyy'], text: sheetjs,
        why: 'names are English in every language',
    }, {
        codes: ['上午/下午h"時"mm"分"'],
        text: (texts) => texts.sheetjs.replace('上午', 'AM').replace('下午', 'PM'),
        why: 'halves of the day are English in every language',
    }, {
        codes: ['gge', '[$-411]ggge"年"m"月"d"日"'], text: (texts) => texts.sheetjs.replace(/g+/, ''),
        why: 'years are Gregorian, and eras have no name',
    }, {
        codes: ['e', 'eeee'], text: sheetjs,
        why: 'LibreOffice counts the years of an era that the code does not name',
    }, {
        codes: ['bb', 'bbbb', 'b1d', 'B2yyyy'],
        text: (_, code, value) => ssf(code.replace(/^b[12]/i, '').replace(/b/g, 'y'), value),
        why: 'years are Gregorian, not those of the Buddhist or the Hijri calendar',
    }, {
        codes: ['y', 'yyy', 'yyyyy', 'ddddd', 'mmmmmm', 'd/m/y'], text: sheetjs,
        why: 'LibreOffice cuts the letters into fields of the usual lengths',
    }, {
        codes: ['h AM/PM:mm', 'ss:mm'], text: sheetjs,
        why: 'minutes stand right behind the hours or before the seconds; LibreOffice is more generous',
    }, {
        codes: ['"on "[$-409]mmm d', 'yyyy[$-409]mm'], text: sheetjs,
        why: 'LibreOffice knows the tag of a language only at the front',
    }, {
        codes: ['d [h]:mm'], text: sheetjs,
        why: 'LibreOffice knows elapsed times only at the front',
    }, {
        codes: ['[s].000'], text: (_, code, value) => (value * 86400).toFixed(3),
        why: 'SheetJS rounds the seconds in front of their fraction, and LibreOffice does not know the code',
    }, {
        codes: ['s.00'], text: office,
        why: 'SheetJS shows the fraction twice',
    }, {
        codes: ['h*-mm'], text: office,
        why: 'SheetJS shows the character that fills the cell',
    }, {
        codes: ['[<1]h:mm;yyyy'], kind: 'time', text: sheetjs,
        why: 'the first section decides the kind, whatever the others show',
    }, {
        codes: ['General d', 'General;yyyy', '0;yyyy', '@ yyyy', '0.00;-0.00;zero'], kind: 'number',
        why: 'the first section decides, and what it begins with; SheetJS says date but shows numbers too',
    }, {
        codes: ['0.00 s', '0.0 m', '0 d', '0 g', '#,##0 y', '0.0 kg', '0 e'], kind: 'number', text: allDigits,
        why: 'a number with a unit that should be quoted; SheetJS says date, but LibreOffice shows numbers',
    }, {
        codes: ['0.00e+00', '0*d', 'general'], kind: 'number',
        why: 'SheetJS takes letters of the exponent, the filling or the word for those of a date',
    }, {
        codes: ['0E+0'], text: () => '1.2345678E+03',
        why: 'without decimals the numeric format shows all digits',
    }, {
        codes: ['# ?/?', '# ?/8', '#/##', '0,', '0.0,,', '0, "k"', '#,##0.00,', '0%%', '0.0E+00%'], text: allDigits,
        why: 'the numeric formats have no fractions, no division by thousands and no powers of percent',
    }, {
        codes: ['"yyyy"', ';;;', ';yyyy', 'x'], kind: 'number', text: allDigits,
        why: 'the only section, or an empty one, hides the number; the format shows it',
    }, {
        codes: ['"WAAR";"WAAR";"ONWAAR"'], text: () => 'WAAR',
        why: 'the text stands in place of the number',
    },
];

// Number codes with several sections or conditions. Behind some stands the code without what the numeric
// formats do not show: grouping, units, widths, and texts around the numbers of the first section.
const numbers = [-1234.567, -5, -0.4, 0, 0.4, 5, 100, 1234.567];
const sectioned = [
    // Two sections
    ['0;-0'], ['0;(0)'], ['0.00;-0.00'], ['0.00;(0.00)'], ['0.0;- 0.0'], ['0.0;"minus "0.0'], ['0.0;0.0"-"'],
    ['0.0;0.0" below"'], ['0.0;\\-0'], ['0;-0.000'], ['0.0%;-0.0%'], ['0%;(0.0%)'], ['0.00;-0%'], ['0%;-0.00'],
    ['0.0E+00;-0.0E+00'], ['0.00E+00;(0.00E+00)'], ['0.00;-0.0E+00'], ['General;-General'], ['General;(General)'],
    ['0.0;"below"'], ['"above";0.0'], ['0.0;[Red]-0.0'], ['[Blue]0.0;[Red](0.0)'], ['0.0;0.0'], ['0.0;[Red]0.0'],
    ['0.00;@'], ['0.0;'], [';-0.0'],
    // Three and four
    ['0.0;-0.0;0'], ['0.0;-0.0;"-"'], ['0.0;(0.0);"zero"'], ['0.00;-0.00;0%'], ['0.0;-0.0;"none";@'],
    ['0.0;-0.0;0.00;"text "@'], ['0.00;-0.00;@'], ['"up";"down";"same"'], ['0.0;-0.0;"about "0.0'],
    ['General;-General;"nil"'], ['0.0%;-0.0%;-'], ['0;-0;;@'], ['0.0;;'], [';;0.0'], ['0.0;-0.0;#'],
    ['0.0;-0.0;"none"#'],
    // Grouping, units, widths
    ['#,##0.00_);(#,##0.00)', '0.00;(0.00)'], ['#,##0_);[Red]\\(#,##0\\)', '0;(0)'],
    ['"$"#,##0.00_);[Red]\\("$"#,##0.00\\)', '0.00;(0.00)'], ['"$"#,##0;-"$"#,##0', '0;-0'],
    ['#,##0.00\\ "€";[Red]\\-#,##0.00\\ "€"', '0.00;-0.00'], ['[$€-2]\\ #,##0.00;\\-[$€-2]\\ #,##0.00', '0.00;-0.00'],
    ['_(* #,##0.00_);_(* \\(#,##0.00\\);_(* "-"??_);_(@_)', '0.00;(0.00);"-"'],
    ['_("$"* #,##0_);_("$"* \\(#,##0\\);_("$"* "-"_);_(@_)', '0;(0);"$-"'],
    ['_-* #,##0.00\\ "zł"_-;\\-* #,##0.00\\ "zł"_-;_-* "-"??\\ "zł"_-;_-@_-', '0.00;-0.00;"-"'],
    ['0.0" kg";-0.0" kg"', '0.0;-0.0'], ['0.0" kg";0.0" kg"', '0.0'], ['0.00 %;-0.00 %', '0.00%;-0.00%'],
    ['"$"0.0_);("$"0.0)', '0.0;(0.0)'], ['0.0" m"_);(0.0" m")', '0.0;(0.0)'], ['0.0;000-000', '0.0;-0'],
    // Conditions
    ['[>=100]0.0;[<-5]0;General'], ['[>=100]0.0;[<-5]-0.00;0.000'], ['[>=100]0.0;[<-5](0.00);0.000'], ['[<100]0.0;0.00'],
    ['[>100]0.0;0.00'], ['[>=0]0.0;(0.00)'], ['[>=0]0.0;-0.00'], ['[<0]-0.0;0.00'], ['[<0](0.0);0.00'],
    ['[<0]-0.0;[=0]"zero";0.00'], ['[=0]"zero";0.0'], ['[>0]"+"0.0;[<0]-0.0;0', '[>0]0.0;[<0]-0.0;0'],
    ['[>0]0.0;[<0]"minus "0.0;"zero"'], ['[<>5]0.0;"five"'], ['[=5]"five";[=100]"hundred";General'],
    ['[<100]"low";[>1000]"high"'], ['[>=100]0.0;[<=-5]-0.00'], ['[<5]0.0;[>=5]0.00'], ['[<=-5]0.0;0.00'],
    ['[>-5]0.0;-0.00'], ['[<-100]0.0;[<0]-0.00;0'], ['[>=1000]0.0;[>=0]0.00;0.000'], ['[<-5]-0.0;[<0](0.00);0'],
    ['[<1]0.0%;0.00'], ['[>=1000]0.00E+00;0.0'], ['[>100]0.0'], ['0.00;[<0]-0.0'], ['0.00;[<-100]-0.0'],
    ['0.0;[=0]"zero";-0.00'], ['[>=100]0.0;-0.0;0.000'], ['[>=100]"over "0;0.0', '[>=100]0;0.0'],
    ['[<5]0.0;"at least "0'], ['[Red][<0]-0.0;[Blue]0.00'],
    // Sections that the numeric formats show with all digits
    ['0.0;-0.0,"k"'], ['0;-# ?/?'],
];

// For these codes the one that shows the value, where programs disagree, hide it or lose its sign.
const dropped = 'the minus is left out only in a section for negative numbers alone that shows one of its own';
const chosen = [
    {
        codes: ['General;(General)', '0.0E+00;-0.0E+00', '0.00E+00;(0.00E+00)', '0.00;-0.0E+00', 'General;-General;"nil"'],
        why: 'SheetJS has no sections for General and shows exponents with a minus of their own',
    },
    {codes: ['0.0;0.0', '0.0;[Red]0.0', '"above";0.0'], code: (x, code) => (x < 0 ? '0.0' : code), why: dropped},
    {
        codes: ['0.0;"minus "0.0', '[>0]0.0;[<0]"minus "0.0;"zero"'],
        code: (x, code) => (x < 0 ? '0.0;-"minus "0.0' : code), why: dropped,
    },
    {codes: ['0.0;0.0" below"'], code: (x, code) => (x < 0 ? '0.0" below"' : code), why: dropped},
    {
        codes: ['0.0;', '0.0;;', ';-0.0', ';;0.0', '0;-0;;@', '0.0;-0.0;#'],
        code: (x, code) => (ssf(code, x) === '' ? 'General' : code),
        why: 'a section without a text hides the number; the format shows it',
    },
    {
        codes: ['0.0;-0.0,"k"', '0;-# ?/?'], code: (x, code) => (x < 0 ? 'General' : code),
        why: 'the numeric formats have no fractions and no division by thousands',
    },
    {codes: ['[<0](0.0);0.00'], code: (x) => (x < 0 ? '0.0' : '0.00'), why: 'the first section shows the number alone'},
    {
        codes: ['[>=100]0.0;[<-5]0;General'],
        code: (x) => (x >= 100 ? '0.0' : x < -5 ? '0' : 'General'), why: dropped,
    },
    {
        codes: ['[>=100]0.0;[<-5]-0.00;0.000'],
        code: (x) => (x >= 100 ? '0.0' : x < -5 ? '0.00' : '0.000'), why: dropped,
    },
    {
        codes: ['[>=100]0.0;[<-5](0.00);0.000'],
        code: (x) => (x >= 100 ? '0.0' : x < -5 ? '0;(0.00)' : '0.000'), why: dropped,
    },
    {codes: ['[<100]0.0;0.00'], code: (x) => (x < 100 ? '0.0' : '0.00'), why: dropped},
    {codes: ['[>100]0.0;0.00'], code: (x) => (x > 100 ? '0.0' : '0.00'), why: dropped},
    {codes: ['[=0]"zero";0.0'], code: (x) => (x === 0 ? '"zero"' : '0.0'), why: dropped},
    {codes: ['[<>5]0.0;"five"'], code: (x) => (x === 5 ? '"five"' : '0.0'), why: dropped},
    {codes: ['[<5]0.0;[>=5]0.00'], code: (x) => (x < 5 ? '0.0' : '0.00'), why: dropped},
    {codes: ['[<=-5]0.0;0.00'], code: (x) => (x <= -5 ? '0.0' : '0.00'), why: dropped},
    {codes: ['[>-5]0.0;-0.00'], code: (x) => (x > -5 ? '0.0' : '0.00'), why: dropped},
    {codes: ['[<-100]0.0;[<0]-0.00;0'], code: (x) => (x < -100 ? '0.0' : x < 0 ? '0.00' : '0'), why: dropped},
    {
        codes: ['[>=1000]0.0;[>=0]0.00;0.000'],
        code: (x) => (x >= 1000 ? '0.0' : x >= 0 ? '0.00' : '0.000'), why: dropped,
    },
    {codes: ['[<-5]-0.0;[<0](0.00);0'], code: (x) => (x < -5 ? '0.0' : x < 0 ? '0;(0.00)' : '0'), why: dropped},
    {codes: ['[<1]0.0%;0.00'], code: (x) => (x < 1 ? '0.0%' : '0.00'), why: dropped},
    {codes: ['[>=1000]0.00E+00;0.0'], code: (x) => (x >= 1000 ? '0.00E+00' : '0.0'), why: dropped},
    {codes: ['[>=100]0;0.0'], code: (x) => (x >= 100 ? '0' : '0.0'), why: dropped},
    {codes: ['[<5]0.0;"at least "0'], code: (x) => (x < 5 ? '0.0' : '"at least "0'), why: dropped},
    {
        codes: ['[=5]"five";[=100]"hundred";General'],
        code: (x) => (x === 5 ? '"five"' : x === 100 ? '"hundred"' : 'General'), why: dropped,
    },
    {
        codes: ['[<100]"low";[>1000]"high"'], code: (x) => (x < 100 ? '"low"' : x > 1000 ? '"high"' : 'General'),
        why: 'a number that no section is for is shown with all digits',
    },
    {
        codes: ['[>=100]0.0;[<=-5]-0.00'], code: (x) => (x >= 100 ? '0.0' : x <= -5 ? '0.00' : 'General'),
        why: 'a number that no section is for is shown with all digits',
    },
    {
        codes: ['[>100]0.0'], code: (x) => (x > 100 ? '0.0' : 'General'),
        why: 'a number that no section is for is shown with all digits',
    },
    {
        codes: ['0.00;[<-100]-0.0'], code: (x) => (x >= 0 ? '0.00' : x < -100 ? '0.0' : 'General'),
        why: 'a number that no section is for is shown with all digits',
    },
    {
        codes: ['0.00;[<0]-0.0'], code: (x) => (x < 0 ? '0.0' : '0.00'),
        why: 'a first section without a condition is for positive numbers, whatever the second is for',
    },
    {
        codes: ['0.0;[=0]"zero";-0.00'], code: (x) => (x > 0 ? '0.0' : x === 0 ? '"zero"' : '0.00'),
        why: 'a first section without a condition is for positive numbers, whatever the second is for',
    },
    {
        codes: ['[>=100]0.0;-0.0;0.000'], code: (x) => (x >= 100 || x < 0 ? '0.0' : '0.000'),
        why: 'a second of three sections is for negative numbers, whatever the first is for',
    },
];

// What LibreOffice shows of the values, by way of a workbook and a text file: one row a code, one column a value.
// The package is put together here because SheetJS writes only some 200 codes.
function showByOffice(codes, values) {
    const main = 'xmlns="http://schemas.openxmlformats.org/spreadsheetml/2006/main"';
    const relations = 'http://schemas.openxmlformats.org/officeDocument/2006/relationships';
    const packages = 'http://schemas.openxmlformats.org/package/2006';
    const type = 'application/vnd.openxmlformats-';
    const sheets = `${type}officedocument.spreadsheetml`;
    const list = (items, write) => items.map(write).join('');
    const attribute = (text) => text.replace(/&/g, '&amp;').replace(/</g, '&lt;').replace(/"/g, '&quot;');
    const relationships = (targets) => `<Relationships xmlns="${packages}/relationships">` +
        list(targets, ([kind, target], i) =>
            `<Relationship Id="r${i}" Type="${relations}/${kind}" Target="${target}"/>`) +
        '</Relationships>';
    const parts = {
        '[Content_Types].xml': `<Types xmlns="${packages}/content-types">` +
            `<Default Extension="rels" ContentType="${type}package.relationships+xml"/>` +
            list([['workbook', 'sheet.main'], ['styles', 'styles'], ['sheet', 'worksheet']], ([part, kind]) =>
                `<Override PartName="/xl/${part}.xml" ContentType="${sheets}.${kind}+xml"/>`) +
            '</Types>',
        '_rels/.rels': relationships([['officeDocument', 'xl/workbook.xml']]),
        'xl/_rels/workbook.xml.rels': relationships([['styles', 'styles.xml'], ['worksheet', 'sheet.xml']]),
        'xl/workbook.xml': `<workbook ${main} xmlns:r="${relations}"><sheets>` +
            '<sheet name="codes" sheetId="1" r:id="r1"/></sheets></workbook>',
        'xl/styles.xml': `<styleSheet ${main}><numFmts>` +
            list(codes, (code, i) => `<numFmt numFmtId="${200 + i}" formatCode="${attribute(code)}"/>`) +
            '</numFmts><fonts><font/></fonts><fills><fill/></fills><borders><border/></borders>' +
            '<cellStyleXfs><xf/></cellStyleXfs><cellXfs>' +
            list(codes, (_, i) => `<xf numFmtId="${200 + i}" applyNumberFormat="1"/>`) + '</cellXfs></styleSheet>',
        'xl/sheet.xml': `<worksheet ${main}><sheetData>` +
            list(codes, (_, i) => `<row>${list(values, (value) => `<c s="${i}"><v>${value}</v></c>`)}</row>`) +
            '</sheetData></worksheet>',
    };
    const zip = X.CFB.utils.cfb_new();
    for (const [name, text] of Object.entries(parts)) X.CFB.utils.cfb_add(zip, `/${name}`, Buffer.from(text));
    X.CFB.utils.cfb_del(zip, '/\u0001Sh33tJ5');
    fs.writeFileSync(path.join(work, 'codes.xlsx'), X.CFB.write(zip, {fileType: 'zip', type: 'buffer'}));
    const asShown = 'csv:Text - txt - csv (StarCalc):9,34,76,1,,1033,true,true';  // tabs, UTF-8, US English
    execFileSync('soffice', ['--headless', '--convert-to', asShown, '--outdir', work, path.join(work, 'codes.xlsx')],
        {env: {...process.env, HOME: work}, stdio: 'ignore'});
    const lines = fs.readFileSync(path.join(work, 'codes.csv'), 'utf8').split('\n');
    const unquoted = (text) => (text.startsWith('"') ? text.slice(1, -1).replace(/""/g, '"') : text);
    return codes.map((_, row) => lines[row].split('\t').map(unquoted));
}

// A number as the numeric formats can show it: the digits without leading zeros, the point, an
// exponent of two digits, and the percent sign behind them, if it is one.
function bare(text, code) {
    const isPercent = text.includes('%') && !/"[^"]*%|\\%/.test(code);
    const [mantissa, exponent] = text.split(/(?<=\d)e\+?(?=[-\d])/i);
    const digits = mantissa.replace(/[^0-9.]/g, '').replace(/^0+(?=\d)/, '');
    const power = exponent === undefined ? '' : `E+${exponent.padStart(2, '0')}`;
    return digits + power + (isPercent ? '%' : '');
}

const showsFraction = (code) => /s\]?\.0/i.test(code);
const isElapsed = (code) => /\[[hms]+\]/i.test(code);

function row(code, shown) {
    const decision = decisions.find(({codes}) => codes.includes(code)) || {};
    const text = (value) => {
        const texts = {sheetjs: ssf(code, value), office: shown[columns.indexOf(value)]};
        if (decision.text) return decision.text(texts, code, value);
        if (texts.sheetjs !== null && texts.sheetjs !== texts.office)
            throw new Error(`${code}: "${texts.sheetjs}" or "${texts.office}"?`);
        return texts.office;
    };
    const kindOfDate = () => {
        const isDate = isElapsed(code) ? code.includes('d') : text(values[0]) !== text(sameMorning);
        const isTime = isElapsed(code) || text(values[0]) !== text(sameDay);
        return isDate && isTime ? 'date-time' : isDate ? 'date' : 'time';
    };
    const kind = decision.kind || (X.SSF.is_date(code) ? kindOfDate() : 'number');
    const cut = (value, i) => text(i === halfSecond && !showsFraction(code) ? beforeHalfSecond : value);
    const shows = kind === 'number' ? [decision.text ? decision.text() : bare(shown[columns.indexOf(number)], code)] :
        values.slice(0, kind === 'time' ? values.length : datedValues).map(cut);
    return {code, kind, shows, ...(decision.why && {why: decision.why})};
}

// Without the spaces around it, and the zeros at the end of a mantissa.
const trimmed = (text) => text.trim().replace(/(\.\d*?)0+(?=E)/, '$1').replace('.E', 'E');

// `plain` is the code that other programs are asked for.
function sectionedRow(code, plain, shown) {
    const decision = chosen.find(({codes}) => codes.includes(plain));
    const shows = numbers.map((value, i) => {
        const texts = [ssf(plain, value), shown[i]].map((text) => trimmed(text || ''));
        if (!decision && texts[0] !== texts[1]) throw new Error(`${code}: "${texts[0]}" or "${texts[1]}"?`);
        if (decision && decision.code) return trimmed(ssf(decision.code(value, plain), value));
        return texts[1];
    });
    return {code, shows, ...(decision && {why: decision.why})};
}

const found = fs.readFileSync(path.join(__dirname, 'number_format_codes.txt'), 'utf8').trimEnd().split('\n');
const codes = [...new Set([...found, ...made])];
const orComplaint = (makeRow) => {
    try {
        return makeRow();
    } catch (error) {
        console.error(error.message);
        process.exitCode = 1;
        return {};
    }
};
const shown = showByOffice(codes, columns);
const rows = codes.map((code, i) => orComplaint(() => row(code, shown[i])));
const plainCodes = sectioned.map(([code, plain]) => plain || code);
const numbersShown = showByOffice(plainCodes, numbers);
const sectionedRows = sectioned.map(([code], i) =>
    orComplaint(() => sectionedRow(code, plainCodes[i], numbersShown[i])));
const lines = (entries) => entries.map((entry) => JSON.stringify(entry)).join(',\n');
const cutting = 'times are cut off after their last unit, not rounded';
console.log(`{"halfSecond": "${cutting}",`);
console.log(`"values": ${JSON.stringify(values)}, "number": ${number}, "codes": [`);
console.log(`${lines(rows)}\n],`);
console.log(`"numbers": ${JSON.stringify(numbers)}, "sectioned": [\n${lines(sectionedRows)}\n]}`);
