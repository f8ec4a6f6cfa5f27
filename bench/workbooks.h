#pragma once

#include <string>

// Workbooks for measurements, generated and the same in every run.
namespace bench {

enum class Content { Numbers, Texts, Mixed };
// In which order the rows stand in the worksheet part.
enum class Order { Ascending, Descending, Random };
// Where the worksheet and shared-string parts have a comment, which the reader of plain parts
// leaves to libxml2.
enum class Comment { None, First, Last };

struct Workload {
    const char* name;
    Content content;
    unsigned sheets;
    unsigned rows;
    unsigned columns;
    Order order = Order::Ascending;
    Comment comment = Comment::None;

    constexpr unsigned long cells() const { return 1UL * sheets * rows * columns; }
};

// The letters of a column, by its 0-based index.
std::string columnName(unsigned column);

// Writes a package of that shape.
void writeWorkbook(const std::string& path, const Workload& workload);

// Writes an XML Spreadsheet 2003 document of one mixed worksheet.
void writeSpreadsheet2003(const std::string& path, unsigned rows, unsigned columns);

}  // namespace bench
