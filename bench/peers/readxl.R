# All values of all worksheets, as data frames.
book <- commandArgs(trailingOnly = TRUE)[1]
sheets <- lapply(readxl::excel_sheets(book), function(sheet)
  readxl::read_excel(book, sheet = sheet, col_names = FALSE, .name_repair = "minimal"))
stopifnot(nrow(sheets[[1]]) > 0)
