#include "tools/help.h"

namespace dp::tool {

const char* helpText() {
    return R"(Usage: dpxlsx [OPTIONS] BOOK.xlsx
Imports an Excel workbook through the import library, as a host does, and shows
each worksheet's columns and first rows. Instead, or for a part of it:
  --list                    names of the worksheets, without reading cells
  --explain                 what the import does to this book that may surprise
  --csv [FILE|DIR/|-]       values as CSV; several worksheets go into a folder
  --json [FILE|-]           all that a host can read; what --explain finds
  --as-shown, --head N      CSV as displayed; first N rows (0 none; tables: 10)
  --sheet NAME|KEY ...      only this worksheet
Rows:
  --names given|none|infer  where names are: a row (default), nowhere, look
  --name-row ROW            row of the names (1)
  --first-row ROW           first row of data (the one after the names)
  --rows N                  number of data rows to read
  --skip-blank-rows         leave out rows without any cell
  --pad                     fill short columns with missing values
  --preview                 read the first 101 rows of each column only
Worksheets and columns (COLUMN is C, 3 or SHEET!C):
  --exclude-sheet NAME|KEY ..., --exclude COLUMN ...         leave out
  --type COLUMN=KIND ...    read as this kind: numeric, text or datetime
  --rename COLUMN=NAME ..., --position COLUMN=N ...          at the host
  --max-name N              longest variable name, in characters
  --clean-sheet-names       replace ? * / : < > | " \ in names of worksheets
Missing values (NUMBER is a number or the word missing):
  --missing VALUE           number that marks a missing value (1.23456e30)
  --missing-number NUMBER=NUMBER   numbers equal to the first become the second
  --missing-word TEXT=NUMBER       such texts in numeric columns become a number
  --missing-text TEXT=TEXT         texts equal to the first become the second
  --missing-display TEXT           how a missing number is shown (*)
Values:
  --decimal SYMBOL          of numbers written as texts, and on display (.)
  --range MIN:MAX           numbers outside become missing (-1.001e18:1.001e18)
  --max-text N              longest text, in bytes (80), or none
  --clean-text              trim texts, drop control characters
  --dates-as-text           read date-times as their displayed texts
  --true TEXT, --false TEXT texts of Booleans (TRUE, FALSE)
Program: --library FILE, --help, --version. Options with ... may be repeated.
Exit codes: 0 done, 1 damaged, 2 usage, 3 output, 4 library, 5 system, 13 bad
part, 17 no file, 18 temporary folder, 22 no package, 25 no workbook, 128+signal
)";
}

}  // namespace dp::tool
