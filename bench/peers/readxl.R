# All values of all worksheets, as data frames: readxl.R BOOK WORKSHEETS ROWS COLUMNS LAST_CELL
arguments <- commandArgs(trailingOnly = TRUE)
book <- arguments[1]
sheets <- lapply(readxl::excel_sheets(book), function(sheet)
  readxl::read_excel(book, sheet = sheet, col_names = FALSE, .name_repair = "minimal"))
shape <- as.integer(arguments[2:4])
last <- sheets[[shape[1]]]
stopifnot(length(sheets) == shape[1], dim(last) == shape[2:3], !is.na(last[[shape[3]]][shape[2]]))
