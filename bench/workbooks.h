#pragma once

#include <string>

// Workbooks for measurements, generated and the same in every run.
namespace bench {

enum class Content { Numbers, Texts, Mixed };
// In which order the rows stand in the worksheet part.
enum class Order { Ascending, Descending, Random };

struct Workload {
    const char* name;
    Content content;
    unsigned sheets;
    unsigned rows;
    unsigned columns;
    Order order = Order::Ascending;

    unsigned long cells() const { return 1UL * sheets * rows * columns; }
};

// Writes a package of that shape.
void writeWorkbook(const std::string& path, const Workload& workload);

// Writes an XML Spreadsheet 2003 document of one mixed worksheet.
void writeSpreadsheet2003(const std::string& path, unsigned rows, unsigned columns);

}  // namespace bench
