#include <algorithm>
#include <bit>
#include <cstdint>
#include <initializer_list>
#include <map>
#include <memory>
#include <optional>
#include <random>
#include <set>
#include <string>
#include <tuple>
#include <utility>

#include <gtest/gtest.h>

#include "dpxlsx/store/blank_rows.h"
#include "dpxlsx/store/row_layout.h"
#include "dpxlsx/store/text_pool.h"
#include "dpxlsx/store/worksheet_cells.h"
#include "testkit/allocated_bytes.h"

namespace dp {
namespace {

using Model = std::map<unsigned, std::map<unsigned, ExternalDataRecordCell>>;

ExternalDataRecordCell cellWith(std::uint32_t type, std::int32_t integer, std::int32_t boolean, double number,
                                std::string text, std::int32_t format) {
    ExternalDataRecordCell cell;
    cell.type = static_cast<ExternalCellType>(type);
    std::tie(cell.intValue, cell.boolValue, cell.numValue) = std::tuple(integer, boolean, number);
    cell.textValue = std::move(text);
    cell.formatIndex = format;
    return cell;
}

auto fieldsOf(const ExternalDataRecordCell& cell) {
    return std::tuple(std::uint32_t{cell.type}, cell.intValue, cell.boolValue,
                      std::bit_cast<std::uint64_t>(cell.numValue), cell.textValue, cell.formatIndex);
}

ExternalDataRecordCell textCell(const std::string& text) { return cellWith(CELL_TEXT, 0, 0, 0.0, text, -1); }

ExternalDataRecord recordOf(unsigned row, unsigned column, const ExternalDataRecordCell& cell) {
    ExternalDataRecord record(0, 0, row, column);
    record.cell = cell;
    return record;
}

// Mostly cells that have only the field their type names, and some with any other combination of fields.
class RandomCells {
  public:
    unsigned below(unsigned bound) { return static_cast<unsigned>(random_() % bound); }

    ExternalDataRecordCell next() {
        const bool usual = below(5) != 0;
        const std::uint32_t type =
            usual ? oneOf({3U, 4U, 5U, 6U, 8U}) : oneOf({0U, 1U, 2U, 4U, 5U, 7U, 15U, 16U, 0xFFFFFFFFU});
        const auto holds = [&](std::uint32_t named) { return usual ? type == named : below(2) == 0; };
        return cellWith(type, holds(CELL_INTEGER) ? oneOf({1, -1, INT32_MIN, INT32_MAX}) : 0,
                        holds(CELL_BOOLEAN) ? oneOf({1, -1, 0, 256}) : 0,
                        holds(CELL_NUMBER) || holds(CELL_DATETIME) ? number() : 0.0,
                        holds(CELL_TEXT) ? std::string(below(300), static_cast<char>(below(3))) : "",
                        usual ? static_cast<std::int32_t>(below(300)) - 1
                              : oneOf({-1, 0, 268435454, 268435455, INT32_MAX, INT32_MIN, -2}));
    }

  private:
    template <typename Value>
    Value oneOf(std::initializer_list<Value> values) {
        return values.begin()[below(static_cast<unsigned>(values.size()))];
    }
    double number() { return below(3) ? std::bit_cast<double>(random_()) : oneOf({0.0, -0.0}); }

    std::mt19937_64 random_{7};
};

void expectSameColumn(const CellColumn& column, const std::map<unsigned, ExternalDataRecordCell>& model) {
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

// The results of all lookups of `row`: the row found, or 2^32 for end().
template <typename Column>
auto lookups(const Column& column, unsigned row) {
    const auto found = [&](auto it) { return it == column.end() ? 1ULL << 32 : it->first; };
    return std::tuple(found(column.find(row)), found(column.lower_bound(row)), found(column.upper_bound(row)),
                      column.count(row));
}

void expectSame(const WorksheetCells& cells, const Model& model) {
    ASSERT_EQ(cells.size(), model.size());
    std::size_t position = 0;
    unsigned rowCount = 0;
    auto column = cells.begin();
    for (const auto& [number, expected] : model) {
        ASSERT_EQ(column->first, number);
        ASSERT_EQ(&cells.nth(position++), &*column);
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
        unsigned (*rowOf)(unsigned number, unsigned any);
    };
    constexpr auto anyRow = [](unsigned, unsigned any) { return any; };
    const Case kCases[] = {
        {"ascending", 20000, 1000, 20, 5000, [](unsigned i, unsigned) { return i / 20; }},
        {"descending", 20000, 4000, 5, 7001, [](unsigned i, unsigned) { return 4000 - i / 5; }},
        {"few late", 5000, 5000, 1, 300, [](unsigned i, unsigned r) { return r % 20 ? i : r; }},
        {"random", 20000, 6000, 3, 6007, anyRow},
        {"repeats of few rows", 5000, 7, 2, 501, anyRow},
        {"read after each", 700, 300, 2, 1, anyRow},
        {"many columns", 5000, 20, 2000, 2500, anyRow},
        {"largest numbers", 500, 0xFFFFFFFF, 0xFFFFFFFF, 100, anyRow},
    };
    for (const Case& named : kCases) {
        SCOPED_TRACE(named.name);
        RandomCells random;
        WorksheetCells cells;
        Model model;
        for (unsigned i = 0; i < named.records; ++i) {
            const unsigned row = named.rowOf(i, random.below(named.rows));
            const unsigned column = random.below(4) ? i % named.columns : random.below(named.columns);
            const ExternalDataRecordCell cell = random.next();
            cells.add(recordOf(row, column, cell));
            model[column][row] = cell;
            if (i % named.readEvery != 0) continue;
            const unsigned sought = random.below(named.rows);
            ASSERT_EQ(lookups(cells.find(column)->second, sought), lookups(model[column], sought));
            if (i % 8 != 0) continue;
            ASSERT_NO_FATAL_FAILURE(expectSame(cells, model));
        }
        ASSERT_NO_FATAL_FAILURE(expectSame(cells, model));
    }
}

TEST(CellStore, ReachesToTheLargestNumbers) {
    WorksheetCells cells;
    EXPECT_EQ(cells.rowCount(), 0U);
    cells.add(recordOf(0xFFFFFFFE, 0xFFFFFFFE, textCell("far")));
    EXPECT_EQ(cells.rowCount(), 0xFFFFFFFFU);
    const CellColumn& column = cells.nth(0).second;
    EXPECT_EQ(column.upper_bound(0xFFFFFFFF), column.end());
}

TEST(CellStore, MovesKeepCellsAndClearForgetsThem) {
    WorksheetCells from;
    for (unsigned i = 0; i < 600; ++i) from.add(recordOf(600 - i, i % 3, textCell("t")));
    WorksheetCells cells = std::move(from);
    from.add(recordOf(1, 1, textCell("again")));
    EXPECT_EQ(from.size(), 1U);
    EXPECT_EQ(cells.rowCount(), 601U);
    CellColumn column = std::move(cells[2]);
    EXPECT_EQ(column.size(), 200U);
    EXPECT_TRUE(cells[2].empty());
    for (unsigned row = 0; row < 9; ++row) cells[2].assign(row, textCell("again"));
    EXPECT_EQ(cells[2].size(), 9U);
    EXPECT_EQ(&cells.nth(0), &*cells.begin());
    cells.clear();
    for (unsigned i = 0; i < 3; ++i) cells.add(recordOf(i, 7 - i, textCell("t")));
    EXPECT_EQ(cells.nth(0).first, 5U);
    column.clear();
    EXPECT_EQ(column.begin(), column.end());
    column.assign(4, cellWith(CELL_TEXT, 1, 2, 3.0, "rare", -7));
    EXPECT_EQ(column.begin()->second.intValue(), 1);
}

TEST(CellStore, KeepsEqualTextsOnce) {
    const auto pool = std::make_shared<TextPool>();
    WorksheetCells first(pool);
    WorksheetCells second(pool);
    const std::string text(26, 'x');
    first.add(recordOf(0, 0, textCell(text)));
    first.add(recordOf(9, 7, cellWith(CELL_TEXT, 0, 0, 1.0, text, 2)));
    second.add(recordOf(3, 1, cellWith(CELL_TEXT, 0, 0, 0.0, text, 0x7FFFFFFF)));
    const auto address = [](const WorksheetCells& cells, unsigned column) {
        return cells.find(column)->second.begin()->second.textValue().data();
    };
    EXPECT_EQ(address(first, 0), address(first, 7));
    EXPECT_EQ(address(first, 0), address(second, 1));
    EXPECT_EQ(second.find(1)->second.begin()->second.formatIndex(), 0x7FFFFFFF);
    EXPECT_EQ(pool->size(), 1U);
}

// New cells reuse the memory of cells that were destroyed while the pool still looked up their texts.
TEST(CellStore, DeliversTextsBeforeTheirCellsGo) {
    const auto pool = std::make_shared<TextPool>();
    const ExternalDataRecordCell number = cellWith(CELL_NUMBER, 0, 0, 5.0, "", -1);
    std::optional<CellColumn> gone(std::in_place, pool);
    gone->assign(0, textCell("gone"));
    gone.reset();
    CellColumn column(pool);
    for (const char* text : {"cleared", "known", "known"}) {
        column.assign(0, number);
        EXPECT_EQ(column.begin()->second.numValue(), 5.0) << "before " << text;
        column.clear();
        column.assign(0, textCell(text));
        column.clear();
    }
}

TEST(CellStore, CellsThatAreFiledAgainTakeNoMemory) {
    WorksheetCells cells;
    const std::size_t before = testkit::allocatedBytes();
    for (unsigned i = 0; i < 100000; ++i)
        cells.add(recordOf(i / 2 % 3, i % 7 ? 0 : 1, cellWith(CELL_TEXT, 1, 2, 3.0, "rare", -7)));
    EXPECT_LT(testkit::allocatedBytes() - before, 100000U);
}

TEST(TextPool, KeepsManyTextsInLittleMemory) {
    TextPool pool;
    const std::size_t before = testkit::allocatedBytes();
    for (int i = 0; i < 400000; ++i)
        pool.intern("a text of forty-two bytes, the last ones " + std::to_string(100000 + i));
    EXPECT_LT(testkit::allocatedBytes() - before, 30'000'000U);
    EXPECT_EQ(pool.size(), 400000U);
}

TEST(BlankRows, AreCountedAsInASet) {
    RandomCells random;
    for (unsigned round = 0; round < 40; ++round) {
        WorksheetCells cells;
        std::set<unsigned> occupied;
        const unsigned height = round % 2 ? 300 : 20000;
        for (unsigned i = 0; i < 200; ++i) {
            const unsigned row = random.below(height);
            const unsigned column = random.below(4);
            cells.add(recordOf(row, column, textCell("t")));
            if (column != 3) occupied.insert(row);
        }
        const unsigned last = random.below(height);
        const BlankRows blank = findBlankRows(cells, last, [](unsigned column) { return column != 3; });
        for (unsigned i = 0; i < 100; ++i) {
            const unsigned from = random.below(height), end = random.below(height + 100);
            unsigned expected = 0;
            for (unsigned row = from; row < std::min(end, last + 1); ++row) expected += occupied.count(row) ? 0U : 1U;
            ASSERT_EQ(blank.countBetween(from, end), expected) << from << " to " << end;
        }
    }
}

TEST(RowLayout, DecidesAtItsLimits) {
    EXPECT_EQ(lastRow(WorksheetCells()), 0U);
    EXPECT_EQ(rowCountUpTo({0, kNotSet}, 0x7FFFFFFE), 0x7FFFFFFFU);
    EXPECT_EQ(rowCountUpTo({0, kNotSet}, 0x7FFFFFFF), 0U) << "more than a host can count";
    WorksheetCells cells;
    cells.add(recordOf(0, 0, textCell("name")));
    cells.add(recordOf(10, 1, textCell("below the limit")));
    EXPECT_EQ(unpaddedRowCount({1, 5}, cells.find(1)->second), 0U);
    SheetReadOptions options{VNR_INFER, 5};
    inferRows(options, cells);
    EXPECT_EQ(options.variableNameRow, 0U) << "whatever it was";
}

// Also of short texts that the pages for them have no room for.
TEST(TextPool, TellsTextsApartAtAnyLength) {
    for (const std::size_t mostPages : {ShortTexts::kMostPages, std::size_t{2}}) {
        TextPool pool(mostPages);
        std::map<std::string, PooledText> texts;
        for (const std::size_t length : {1U, 7U, 8U, 15U, 16U, 17U, 33U, 254U, 255U, 256U, 5000U, 70000U}) {
            for (std::size_t place = 0; place < std::min<std::size_t>(length, 40); ++place) {
                std::string text(length, '\0');
                text[length - 1 - place] = 'x';
                texts.emplace(text, pool.intern(text));
            }
        }
        for (const auto& [text, kept] : texts) {
            EXPECT_EQ(kept.view(), text);
            EXPECT_EQ(pool.intern(text), kept);
        }
        EXPECT_EQ(pool.size(), texts.size());
        EXPECT_EQ(pool.intern(""), PooledText());
    }
}

TEST(ShortTexts, FillTheirPagesAndNoMore) {
    ShortTexts texts(2);
    unsigned begun = 0;
    while (begun < 1000 && texts.begin(std::to_string(100 + begun))) ++begun;
    EXPECT_EQ(begun, (512U + 1024U) / 4);
    EXPECT_FALSE(texts.begin("one")) << "again";
    EXPECT_NE(texts.find("100"), nullptr);
}

TEST(ExternalDataRecord, CopiesAllAndInitializesAll) {
    const auto allOf = [](const ExternalDataRecord& record) {
        return std::tuple_cat(fieldsOf(record.cell),
                              std::tuple(record.reserved0, record.reserved1, record.row, record.column));
    };
    ExternalDataRecord record(1, 2, 3, 4);
    record.cell = cellWith(CELL_TEXT, 5, 6, 7.0, "text", 8);
    const ExternalDataRecord copy = record;
    record.initialize();
    EXPECT_EQ(allOf(record), std::tuple(0U, 0, 0, 0ULL, "", -1, 0U, 0U, 0U, 0U));
    record = copy;
    const auto seven = std::bit_cast<std::uint64_t>(7.0);
    EXPECT_EQ(allOf(record), std::tuple(5U, 5, 6, seven, "text", 8, 1U, 2U, 3U, 4U));
}

}  // namespace
}  // namespace dp
