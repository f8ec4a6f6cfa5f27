#include <bit>
#include <cmath>
#include <cstdint>
#include <limits>
#include <map>
#include <memory>
#include <random>
#include <string>
#include <utility>
#include <vector>

#include <gtest/gtest.h>

#include "store/worksheet_cells.h"

namespace dp {
namespace {

using Model = std::map<unsigned, std::map<unsigned, ExternalDataRecordCell>>;

ExternalDataRecordCell cellOf(std::uint32_t type, std::int32_t integer, std::int32_t boolean,
                              double number, std::string text, std::int32_t format) {
    ExternalDataRecordCell cell;
    cell.type = static_cast<ExternalCellType>(type);
    cell.intValue = integer;
    cell.boolValue = boolean;
    cell.numValue = number;
    cell.textValue = std::move(text);
    cell.formatIndex = format;
    return cell;
}

ExternalDataRecordCell textCell(const std::string& text) {
    return cellOf(CELL_TEXT, 0, 0, 0.0, text, -1);
}

auto fieldsOf(const ExternalDataRecordCell& cell) {
    return std::tuple(std::uint32_t{cell.type}, cell.intValue, cell.boolValue,
                      std::bit_cast<std::uint64_t>(cell.numValue), cell.textValue,
                      cell.formatIndex);
}

ExternalDataRecord recordOf(unsigned row, unsigned column, const ExternalDataRecordCell& cell) {
    ExternalDataRecord record(0, 0, row, column);
    record.cell = cell;
    return record;
}

// Mostly cells as readers deliver them, and some of every other combination of fields.
class RandomCells {
  public:
    explicit RandomCells(unsigned seed) : random_(seed) {}

    unsigned below(unsigned bound) { return static_cast<unsigned>(random_() % bound); }

    ExternalDataRecordCell next() {
        const auto bits = std::bit_cast<double>(random_());
        const auto format = static_cast<std::int32_t>(below(300)) - 1;
        switch (below(6)) {
            case 0:
            case 1:
                return cellOf(CELL_NUMBER, 0, 0, bits, "", format);
            case 2:
                return cellOf(CELL_TEXT, 0, 0, 0.0, text(), format);
            case 3:
                return cellOf(CELL_DATETIME, 0, 0, below(50000), "", format);
            case 4:
                return cellOf(CELL_INTEGER + 3 * below(2), maybe(), 0, 0.0, "", format);
            default:
                return anything();
        }
    }

  private:
    std::int32_t maybe() {
        constexpr std::int32_t kExtremes[] = {0, -1, INT32_MIN, INT32_MAX};
        return kExtremes[below(4)];
    }
    std::string text() { return std::string(below(40), static_cast<char>('a' + below(4))); }
    ExternalDataRecordCell anything() {
        constexpr std::uint32_t kTypes[] = {0, 1, 2, 3, 4, 5, 6, 7, 8, 15, 16, 0xFFFFFFFF};
        constexpr double kNumbers[] = {0.0, -0.0, 1.5, std::numeric_limits<double>::infinity()};
        constexpr std::int32_t kFormats[] = {-1,        0,         268435454, 268435455,
                                             INT32_MAX, INT32_MIN, -2,        7};
        return cellOf(kTypes[below(12)], maybe(), maybe(), kNumbers[below(4)],
                      below(2) ? text() : "", kFormats[below(8)]);
    }

    std::mt19937_64 random_;
};

void expectSameColumn(const CellColumn& column,
                      const std::map<unsigned, ExternalDataRecordCell>& model) {
    ASSERT_EQ(column.size(), model.size());
    auto cell = column.begin();
    for (const auto& [row, expected] : model) {
        ASSERT_EQ(cell->first, row);
        ASSERT_EQ(fieldsOf(cell->second), fieldsOf(expected)) << "row " << row;
        ++cell;
    }
    ASSERT_EQ(cell, column.end());
    auto back = column.rbegin();
    for (auto expected = model.rbegin(); expected != model.rend(); ++expected, ++back)
        ASSERT_EQ(back->first, expected->first);
    ASSERT_EQ(back, column.rend());
}

void expectSameLookups(const CellColumn& column,
                       const std::map<unsigned, ExternalDataRecordCell>& model, unsigned row) {
    const auto same = [&](CellColumn::const_iterator found, auto expected) {
        if (expected == model.end()) return found == column.end();
        return found != column.end() && found->first == expected->first &&
               fieldsOf(found->second) == fieldsOf(expected->second);
    };
    EXPECT_TRUE(same(column.find(row), model.find(row))) << row;
    EXPECT_TRUE(same(column.lower_bound(row), model.lower_bound(row))) << row;
    EXPECT_TRUE(same(column.upper_bound(row), model.upper_bound(row))) << row;
    EXPECT_EQ(column.count(row), model.count(row)) << row;
}

void expectSame(const WorksheetCells& cells, const Model& model) {
    ASSERT_EQ(cells.size(), model.size());
    std::size_t position = 0;
    unsigned rowCount = 0;
    auto column = cells.begin();
    for (const auto& [number, expected] : model) {
        ASSERT_EQ(column->first, number);
        ASSERT_EQ(&cells.nth(position++), &*column);
        ASSERT_EQ(cells.find(number), column);
        ASSERT_NO_FATAL_FAILURE(expectSameColumn(column->second, expected));
        rowCount = std::max(rowCount, expected.rbegin()->first + 1);
        ++column;
    }
    EXPECT_EQ(cells.rowCount(), rowCount);
}

TEST(CellStore, AnswersAsPlainMapsDo) {
    struct Case {
        const char* name;
        unsigned records, rows, columns, readEvery;
        unsigned (*rowOf)(unsigned number, RandomCells& random, unsigned rows);
    };
    constexpr auto ascending = [](unsigned i, RandomCells&, unsigned) { return i / 20; };
    constexpr auto descending = [](unsigned i, RandomCells&, unsigned) { return 4000 - i / 5; };
    constexpr auto any = [](unsigned, RandomCells& r, unsigned rows) { return r.below(rows); };
    constexpr auto mostlyAscending = [](unsigned i, RandomCells& r, unsigned rows) {
        return r.below(20) ? i : r.below(rows);
    };
    const Case kCases[] = {
        {"ascending", 20000, 1000, 20, 5000, ascending},
        {"descending", 20000, 4000, 5, 7001, descending},
        {"random", 20000, 6000, 3, 6007, any},
        {"repeats of few rows", 5000, 7, 2, 501, any},
        {"few late", 5000, 5000, 1, 300, mostlyAscending},
        {"read after each", 700, 300, 2, 1, any},
        {"many columns", 5000, 20, 2000, 2500, any},
        {"largest numbers", 500, 0xFFFFFFFF, 0xFFFFFFFF, 100, any},
    };
    for (const Case& named : kCases) {
        SCOPED_TRACE(named.name);
        RandomCells random(7);
        WorksheetCells cells;
        Model model;
        for (unsigned i = 0; i < named.records; ++i) {
            const unsigned row = named.rowOf(i, random, named.rows);
            const unsigned column =
                random.below(4) ? i % named.columns : random.below(named.columns);
            const ExternalDataRecordCell cell = random.next();
            cells.add(recordOf(row, column, cell));
            model[column][row] = cell;
            if (i % named.readEvery != 0) continue;
            expectSameLookups(cells.find(column)->second, model[column], random.below(named.rows));
            if (i % (named.readEvery * 8) == 0) {
                ASSERT_NO_FATAL_FAILURE(expectSame(cells, model));
            }
        }
        ASSERT_NO_FATAL_FAILURE(expectSame(cells, model));
        for (unsigned i = 0; i < 500; ++i)
            expectSameLookups(cells.begin()->second, model.begin()->second,
                              random.below(std::max(named.rows, 100U)));
    }
}

TEST(CellStore, FilesByColumnThenRow) {
    WorksheetCells cells;
    EXPECT_EQ(cells.rowCount(), 0U);
    cells.add(recordOf(5, 2, cellOf(CELL_NUMBER, 0, 0, 1.0, "", 3)));
    cells.add(recordOf(0, 2, textCell("first")));
    cells.add(recordOf(5, 2, cellOf(CELL_DATETIME, 0, 0, 60.0, "", 9)));
    ASSERT_EQ(cells.size(), 1U);
    EXPECT_EQ(cells.rowCount(), 6U);
    const CellColumn& column = cells.find(2)->second;
    std::vector<unsigned> rows;
    for (const auto& [row, cell] : column) rows.push_back(row);
    EXPECT_EQ(rows, (std::vector<unsigned>{0, 5}));
    EXPECT_EQ(column.find(5)->second.type(), CELL_DATETIME);
    EXPECT_EQ(column.find(5)->second.formatIndex(), 9);
    EXPECT_EQ(std::prev(column.end())->second.numValue(), 60.0);
    cells.add(recordOf(0xFFFFFFFE, 0xFFFFFFFE, textCell("far")));
    EXPECT_EQ(cells.rowCount(), 0xFFFFFFFFU);
    EXPECT_EQ(cells.nth(1).first, 0xFFFFFFFEU);
}

TEST(CellStore, MovesKeepCellsAndClearForgetsThem) {
    WorksheetCells from;
    for (unsigned i = 0; i < 600; ++i) from.add(recordOf(600 - i, i % 3, textCell("t")));
    WorksheetCells cells = std::move(from);
    from.add(recordOf(1, 1, textCell("again")));
    EXPECT_EQ(from.size(), 1U);
    cells.add(recordOf(601, 2, textCell("u")));
    EXPECT_EQ(cells.rowCount(), 602U);
    CellColumn column = std::move(cells[2]);
    EXPECT_EQ(column.size(), 201U);
    column.clear();
    EXPECT_EQ(column.begin(), column.end());
    column.assign(4, cellOf(CELL_TEXT, 1, 2, 3.0, "rare", -7));
    EXPECT_EQ(column.begin()->second.intValue(), 1);
}

TEST(CellStore, KeepsEqualTextsOnce) {
    const auto pool = std::make_shared<TextPool>();
    WorksheetCells first(pool);
    WorksheetCells second(pool);
    const std::string text(26, 'x');
    first.add(recordOf(0, 0, textCell(text)));
    first.add(recordOf(9, 7, cellOf(CELL_TEXT, 0, 0, 1.0, text, 2)));
    second.addText(3, 1, pool->intern(text), 0x7FFFFFFF);
    const auto address = [](const WorksheetCells& cells, unsigned column) {
        return cells.find(column)->second.begin()->second.textValue().data();
    };
    EXPECT_EQ(address(first, 0), address(first, 7));
    EXPECT_EQ(address(first, 0), address(second, 1));
    EXPECT_EQ(second.find(1)->second.begin()->second.formatIndex(), 0x7FFFFFFF);
    EXPECT_EQ(pool->size(), 1U);
}

TEST(TextPool, TellsTextsApartAtAnyLength) {
    TextPool pool;
    std::map<std::string, PooledText> texts;
    for (const std::size_t length : {1U, 7U, 8U, 15U, 16U, 17U, 33U, 5000U, 70000U}) {
        for (std::size_t place = 0; place < std::min<std::size_t>(length, 40); ++place) {
            std::string text(length, '\0');
            text[length - 1 - place] = 'x';
            texts.emplace(text, pool.intern(text));
        }
    }
    EXPECT_EQ(pool.size(), texts.size());
    for (const auto& [text, kept] : texts) {
        EXPECT_EQ(kept.view(), text);
        EXPECT_EQ(pool.intern(text), kept);
    }
    EXPECT_EQ(pool.intern(""), PooledText());
}

TEST(ExternalDataRecord, CopiesAllAndInitializesAll) {
    ExternalDataRecord record(1, 2, 3, 4);
    record.cell = cellOf(CELL_TEXT, 5, 6, 7.0, "text", 8);
    const ExternalDataRecord copy = record;
    record.initialize();
    EXPECT_EQ(fieldsOf(record.cell), fieldsOf(ExternalDataRecordCell()));
    EXPECT_EQ(record.reserved0 | record.reserved1 | record.row | record.column, 0U);
    record = copy;
    EXPECT_EQ(fieldsOf(record.cell), fieldsOf(cellOf(CELL_TEXT, 5, 6, 7.0, "text", 8)));
    EXPECT_EQ(std::tuple(record.reserved0, record.reserved1, record.row, record.column),
              std::tuple(1U, 2U, 3U, 4U));
    EXPECT_EQ(fieldsOf(ExternalDataRecordCell()), fieldsOf(cellOf(0, 0, 0, 0.0, "", -1)));
}

}  // namespace
}  // namespace dp
