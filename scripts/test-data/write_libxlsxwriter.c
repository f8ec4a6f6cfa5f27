// Writes a workbook with libxlsxwriter: PROGRAM DATA_FOLDER
#include <stdio.h>
#include <xlsxwriter.h>

int main(int argc, char** argv) {
    char path[4096];
    if (argc != 2) return 2;
    snprintf(path, sizeof path, "%s/libxlsxwriter_report.xlsx", argv[1]);
    lxw_workbook* book = workbook_new(path);
    lxw_doc_properties properties = {.created = 1704164645};
    workbook_set_properties(book, &properties);
    lxw_worksheet* sheet = workbook_add_worksheet(book, "Report");
    lxw_worksheet* second = workbook_add_worksheet(book, "Second");
    lxw_worksheet* merged = workbook_add_worksheet(book, "Merged");

    const char* names[] = {"when", "hour", "both", "amount", "share", "tiny", "note"};
    const char* codes[] = {"mm/dd/yy", "h:mm:ss", "m/d/yy h:mm AM/PM", "[$$-409]#,##0.00", "0.000%",
                           "0.0E+00",  "@"};
    lxw_format* styles[7];
    for (int i = 0; i < 7; ++i) {
        styles[i] = workbook_add_format(book);
        format_set_num_format(styles[i], codes[i]);
        worksheet_write_string(sheet, 0, (lxw_col_t)i, names[i], NULL);
    }
    for (int row = 1; row <= 6; ++row) {
        if (row == 4) continue;
        lxw_datetime when = {2000 + row * 4, row * 2, 28, row * 3, row * 9, 7.5};
        worksheet_write_datetime(sheet, (lxw_row_t)row, 0, &when, styles[0]);
        worksheet_write_number(sheet, (lxw_row_t)row, 1, row / 7.0, styles[1]);
        worksheet_write_datetime(sheet, (lxw_row_t)row, 2, &when, styles[2]);
        worksheet_write_number(sheet, (lxw_row_t)row, 3, row * 1234.56, styles[3]);
        worksheet_write_number(sheet, (lxw_row_t)row, 4, row / 8.0, styles[4]);
        worksheet_write_number(sheet, (lxw_row_t)row, 5, row * 1.5e-9, styles[5]);
        worksheet_write_string(sheet, (lxw_row_t)row, 6, row % 2 ? "odd ñ" : "even 漢", styles[6]);
    }
    lxw_row_col_options hidden = {.hidden = LXW_TRUE};
    worksheet_set_column_opt(sheet, 3, 4, 8.43, NULL, &hidden);
    worksheet_set_row_opt(sheet, 2, 15, NULL, &hidden);

    worksheet_write_string(second, 1, 1, "not in the first row", NULL);
    worksheet_write_number(second, 2, 1, 5, NULL);
    worksheet_write_boolean(second, 0, 3, 1, NULL);
    worksheet_write_boolean(second, 1, 3, 0, NULL);
    worksheet_write_formula_num(second, 2, 3, "=1+1", NULL, 2);
    worksheet_write_blank(second, 5, 5, styles[3]);
    worksheet_write_number(second, 100, 200, 42, NULL);

    worksheet_merge_range(merged, 0, 0, 0, 2, "across", NULL);
    worksheet_merge_range(merged, 1, 0, 3, 0, "down", NULL);
    worksheet_write_number(merged, 1, 1, 1, NULL);
    worksheet_write_number(merged, 3, 1, 3, NULL);

    lxw_chartsheet* chartsheet = workbook_add_chartsheet(book, "Picture");
    lxw_chart* chart = workbook_add_chart(book, LXW_CHART_COLUMN);
    chart_add_series(chart, NULL, "=Report!$D$2:$D$7");
    chartsheet_set_chart(chartsheet, chart);
    return (int)workbook_close(book);
}
