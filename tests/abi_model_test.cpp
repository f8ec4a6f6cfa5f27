#include <algorithm>
#include <memory>
#include <tuple>

#include "dpxlsx/formats/date_time_variable_format.h"
#include "dpxlsx/formats/fraction_variable_format.h"
#include "dpxlsx/formats/numeric_variable_format.h"
#include "dpxlsx/formats/percentage_variable_format.h"
#include "dpxlsx/formats/text_variable_format.h"
#include "dpxlsx/model/columns.h"
#include "dpxlsx/model/formula.h"
#include "dpxlsx/model/host/reference.h"
#include "dpxlsx/model/rows.h"
#include "dpxlsx/model/worksheet.h"
#include "tests/abi.h"

// The objects that a host receives, seen through raw tables and memory.
namespace {

using namespace raw;

constexpr std::size_t kTwoTables = 16;

// Checks a column through its own table and through that of IVariable.
void expectColumn(void* column, const Contract& contract, int getters) {
    void* variable = static_cast<char*>(column) + 8;
    const Contract asVariable = contractOf("IVariable");
    EXPECT_EQ(expectGetters(column, column, contract, contract, kTwoTables), getters);
    EXPECT_EQ(expectGetters(column, variable, asVariable, contract, kTwoTables), 8);
    for (const std::string key : {"PrimeKey", "VariableBodyPrimeKey", "OriginalVariablePrimeKey"}) {
        call<void>(variable, slotOf(asVariable, "Set" + key), 77);
        EXPECT_EQ(call<int>(variable, slotOf(asVariable, "Get" + key)), 77) << key;
    }
    EXPECT_EQ(call<int>(variable, slotOf(asVariable, "GetType")), 3);
    EXPECT_EQ(call<unsigned>(column, slotOf(contract, "AddRef")), 1U);
    call<void>(column, slotOf(contract, "Release"));  // deletes it
}

// The fields of a new object: numbers, flags and texts, 0 for a null pointer.
std::string freshState(const void* object, const std::string& name, std::size_t start = 8) {
    const Contract contract = contractOf(name);
    std::ostringstream state;
    for (const std::string& word : contract.fields) {
        const Field field = fieldOf(contract, word.substr(0, word.find(':')), start);
        const void* at = static_cast<const char*>(object) + field.offset;
        if (field.type == "b") state << peek<bool>(at, 0) << ' ';
        if (field.type == "i") state << peek<int>(at, 0) << ' ';
        if (field.type == "d") state << peek<double>(at, 0) << ' ';
        if (field.type == "p") state << peek<void*>(at, 0) << ' ';
        if (field.type == "t") state << *static_cast<const std::string*>(at) << ' ';
        if (field.type == "s") state << call<const char*>(at, 2) << ' ';
    }
    return state.str();
}

TEST(HostContract, FreshObjects) {
    const struct {
        std::string name;
        std::unique_ptr<dp::IVariableFormat> format;
        const char* state;
    } formats[] = {{"NumericVariableFormat", std::make_unique<dp::NumericVariableFormat>(), "0 0 0 0 0 0 0 "},
                   {"PercentageVariableFormat", std::make_unique<dp::PercentageVariableFormat>(), "0 0 0 0 0 0 0 "},
                   {"FractionVariableFormat", std::make_unique<dp::FractionVariableFormat>(), "0 0 0 0 0 0 0 0 0 0 "},
                   {"TextVariableFormat", std::make_unique<dp::TextVariableFormat>(), "0 0 "},
                   {"DateTimeVariableFormat", std::make_unique<dp::DateTimeVariableFormat>(), "1  0 "}};
    for (const auto& [name, format, state] : formats) EXPECT_EQ(freshState(format.get(), name), state) << name;
    EXPECT_EQ(freshState(std::make_unique<dp::NumericColumn>().get(), "NumericColumn", kTwoTables),
              "  0 0 0 0 0 0 0 0 0 1 0 0 1 0 0 0 0 ");
    EXPECT_EQ(freshState(std::make_unique<dp::TextColumn>().get(), "TextColumn", kTwoTables),
              "  0 0 0 0 0 0 0 0 1 0 0 1 0 0 ");
    EXPECT_EQ(freshState(std::make_unique<dp::Worksheet>().get(), "Worksheet"), "0     0 0 1 0 ");
    const dp::WorksheetView view;
    EXPECT_EQ(freshState(&view, "WorksheetView"), "1 1 1 1 1 1 1 1 1 1 8 0 2 10 10 0 Arial Arial * ");
    const dp::FormulaManager manager;
    EXPECT_EQ(freshState(&manager, "FormulaManager"), "0 0 0   ");
    const dp::ColumnView column;
    EXPECT_EQ(freshState(&column, "ColumnView"), "1 0 0 0 ");
}

// Checks that an object starts without references and deletes itself with its last one.
template <class Object>
void expectCounted() {
    static int gone = 0;
    struct Counted : Object {
        ~Counted() override { ++gone; }
    };
    auto* object = new Counted;
    EXPECT_DEBUG_DEATH(object->Release(), "without AddRef");
    EXPECT_EQ(object->AddRef(), 1U);
    EXPECT_EQ(object->AddRef(), 2U);
    object->Release();
    EXPECT_EQ(gone, 0);
    object->Release();
    EXPECT_EQ(gone, 1);
}

TEST(HostContract, ReferencesAreCounted) {
    expectCounted<dp::NumericColumn>();
    expectCounted<dp::TextColumn>();
    expectCounted<dp::Worksheet>();
}

// What each use of a Reference does to the counts of two objects that another one holds.
TEST(HostContract, ReferenceHoldsOneCount) {
    struct Object {
        unsigned count = 0;
        unsigned AddRef() { return ++count; }
        void Release() { --count; }
    };
    using Reference = dp::Reference<Object>;
    struct Case {
        const char* name;
        void (*use)(Reference& first, Reference& second);
        unsigned counts[2];
        bool isNull[2];
    };
    const Case cases[] = {
        {"none", [](Reference&, Reference&) {}, {1, 1}, {false, false}},
        {"reset", [](Reference& first, Reference&) { first.reset(); }, {0, 1}, {true, false}},
        {"reset to itself", [](Reference& first, Reference&) { first.reset(first.get()); }, {1, 1}, {false, false}},
        {"reset to another",
         [](Reference& first, Reference& second) { first.reset(&*second); },
         {0, 2},
         {false, false}},
        {"copy", [](Reference& first, Reference& second) { second = first; }, {2, 0}, {false, false}},
        {"copy to itself", [](Reference& first, Reference&) { first = *&first; }, {1, 1}, {false, false}},
        {"move", [](Reference& first, Reference& second) { second = std::move(first); }, {1, 0}, {true, false}},
        {"move to itself", [](Reference& first, Reference&) { first = std::move(*&first); }, {1, 1}, {false, false}},
        {"null", [](Reference& first, Reference&) { first = Reference(nullptr); }, {0, 1}, {true, false}},
        {"copied and gone", [](Reference& first, Reference&) { Reference(first).reset(); }, {1, 1}, {false, false}},
        {"moved and gone",
         [](Reference& first, Reference&) { const Reference moved(std::move(first)); },
         {0, 1},
         {true, false}},
    };
    for (const auto& [name, use, counts, isNull] : cases) {
        Object objects[2];
        {
            Reference first(&objects[0]), second(&objects[1]);
            use(first, second);
            EXPECT_EQ(objects[0].count, counts[0]) << name;
            EXPECT_EQ(objects[1].count, counts[1]) << name;
            EXPECT_EQ(first == nullptr, isNull[0]) << name;
            EXPECT_EQ(second == nullptr, isNull[1]) << name;
            EXPECT_TRUE(first == nullptr || &first->count == &(*first).count) << name;
        }
        EXPECT_EQ(objects[0].count + objects[1].count, 0U) << name;
    }
}

// A format that records how it was called.
template <class Format>
struct Recording : Format {
    dp::IString* FormatValue(double, bool full) const override { return new dp::String(full ? "full 1.5" : "1.5"); }
};

TEST(HostContract, ValuesShowInFullWithTheSymbolOfTheHost) {
    const auto shown = [](std::unique_ptr<dp::IVariableFormat> format, char decimal) -> std::string {
        dp::NumericColumn column;
        column.format = std::move(format);
        const std::unique_ptr<dp::IString> text(column.GetFormattedValue(1.5, decimal));
        return text ? text->database_str() : "null";
    };
    using Number = Recording<dp::NumericVariableFormat>;
    EXPECT_EQ(shown(nullptr, ','), "null");
    EXPECT_EQ(shown(std::make_unique<Number>(), '.') + shown(std::make_unique<Number>(), ','), "full 1.5full 1,5");
    EXPECT_EQ(shown(std::make_unique<Recording<dp::DateTimeVariableFormat>>(), ','), "1.5");
}

TEST(HostContract, NumericColumn) {
    const Contract contract = contractOf("NumericColumn");
    auto* column = new dp::NumericColumn;
    column->format = std::make_unique<dp::TextVariableFormat>();
    column->values.reset(new double[2]{1.5, 2.5});
    EXPECT_EQ(call<int>(column, slotOf(contract, "GetStorageType")), 0);
    const std::unique_ptr<dp::IString> text(
        call<dp::IString*>(column, slotOf(contract, "GetFormattedValue"), 2.5, '.'));
    EXPECT_STREQ(text->database_str(), "");
    expectColumn(column, contract, 11);
}

TEST(HostContract, TextColumn) {
    const Contract contract = contractOf("TextColumn");
    auto* column = new dp::TextColumn;
    column->textValues.items.emplace_back("a");
    EXPECT_EQ(call<int>(column, slotOf(contract, "GetDataType")), 4);
    EXPECT_EQ(call<int>(column, slotOf(contract, "GetStorageType")), 1);

    const auto* texts = call<const void*>(column, slotOf(contract, "GetTextValues"));
    const Contract collection = contractOf("Collection");
    const Contract string = contractOf("String");
    EXPECT_EQ(call<unsigned long>(texts, slotOf(collection, "Count")), 1UL);
    void* item = call<void*>(texts, slotOf(collection, "Item"), 0UL);
    const std::string replacement = "b";
    EXPECT_EQ(*call<std::string*>(item, slotOf(string, "operator="), &replacement), "b");
    const char* characters = call<const char*>(item, slotOf(string, "database_str"));
    EXPECT_STREQ(characters, "b");
    EXPECT_EQ(call<const char*>(item, slotOf(string, "application_str")), characters);
    expectColumn(column, contract, 10);
}

template <class Object>
int expectOwnGetters(Object& object, const char* name) {
    const Contract contract = contractOf(name);
    return expectGetters(&object, &object, contract, contract);
}

TEST(HostContract, SmallObjects) {
    dp::ColumnView view;
    EXPECT_EQ(expectOwnGetters(view, "ColumnView"), 4);
    dp::ColumnOrdering ordering;
    EXPECT_EQ(expectOwnGetters(ordering, "ColumnOrdering"), 2);
    dp::ExpressionError error;
    EXPECT_EQ(expectOwnGetters(error, "ExpressionError"), 6);
    dp::WorksheetView worksheetView;
    EXPECT_EQ(expectOwnGetters(worksheetView, "WorksheetView"), 19);
    dp::CRows rows;
    EXPECT_EQ(expectOwnGetters(rows, "CRows"), 2);
    rows.rows = {4, 5};
    int count = -1;
    const int* numbers = nullptr;
    call<void>(&rows, slotOf(contractOf("CRows"), "GetRows"), &count, nullptr);
    call<void>(&rows, slotOf(contractOf("CRows"), "GetRows"), nullptr, &numbers);
    EXPECT_EQ(count * 10 + numbers[1], 25);
}

TEST(HostContract, Worksheet) {
    auto* sheet = new dp::Worksheet;
    const Contract contract = contractOf("Worksheet");
    EXPECT_EQ(expectOwnGetters(*sheet, "Worksheet"), 12);
    call<void>(sheet, slotOf(contract, "SetPrimeKey"), 5);
    EXPECT_EQ(call<int>(sheet, slotOf(contract, "GetPrimeKey")), 5);
    EXPECT_EQ(call<int>(sheet, slotOf(contract, "GetDDELinkCount")), 0);
    for (const char* absent : {"GetDesign", "GetAnalysis", "GetResponseModels"})
        EXPECT_EQ(call<void*>(sheet, slotOf(contract, absent)), nullptr) << absent;
    EXPECT_EQ(call<unsigned>(sheet, slotOf(contract, "AddRef")), 1U);
    call<void>(sheet, slotOf(contract, "Release"));
}

TEST(HostContract, FormulaManager) {
    static bool gone = false;
    struct Node : dp::FormulaModelNode {
        ~Node() override { gone = true; }
    };
    {
        const Contract contract = contractOf("FormulaManager");
        dp::FormulaManager manager;
        EXPECT_EQ(expectOwnGetters(manager, "FormulaManager"), 3);
        manager.listSeparator = std::string(";");
        manager.decimalSymbol = std::string(",");
        EXPECT_STREQ(call<const char*>(&manager, slotOf(contract, "GetListSeparator")), ";");
        EXPECT_STREQ(call<const char*>(&manager, slotOf(contract, "GetDecimalSymbol")), ",");
        auto* node = new Node;
        manager.formulaNodes.push_back(node);
        EXPECT_EQ(call<int>(&manager, slotOf(contract, "GetFormulaNodeCount")), 1);
        EXPECT_EQ(call<void*>(&manager, slotOf(contract, "GetFormulaNode"), 0),
                  static_cast<dp::IFormulaModelNode*>(node));
    }
    EXPECT_TRUE(gone) << "the manager owns its nodes";
}

// Checks a node through its own table and through that of its kind, which lacks three operations.
Contract expectNode(void* node, int type, const char* name, int getters) {
    const Contract own = contractOf(name);
    Contract kind = own;
    kind.slots.erase(kind.slots.begin() + 11, kind.slots.begin() + 14);
    void* second = call<void*>(node, slotOf(own, "GetFormulaNodeInterface"));
    EXPECT_EQ(second, static_cast<char*>(node) + fieldOf(own, "secondTable").offset);

    for (const auto& [facet, table] : {std::pair{node, &own}, {second, &kind}}) {
        EXPECT_EQ(expectGetters(node, facet, *table, own), getters);
        call<void>(facet, slotOf(*table, "SetPrimeKey"), 9);
        EXPECT_EQ(call<int>(facet, slotOf(*table, "GetPrimeKey")), 9);
        EXPECT_EQ(call<int>(facet, slotOf(*table, "GetType")), type);
    }
    call<void>(node, slotOf(own, "SetParentNode"), node);
    call<void>(node, slotOf(own, "SetParentNode"), second);
    call<void>(node, slotOf(own, "SetChildNode"), second);
    EXPECT_EQ(call<int>(second, slotOf(kind, "GetParentNodeCount")), 2);
    EXPECT_EQ(call<int>(second, slotOf(kind, "GetChildNodeCount")), 1);
    EXPECT_EQ(call<void*>(second, slotOf(kind, "GetParentNode"), 0), node);
    EXPECT_EQ(call<void*>(second, slotOf(kind, "GetChildNode"), 0), second);
    return own;
}

TEST(HostContract, FormulaNodes) {
    dp::FormulaVariableNode variable;
    variable.formula = std::string("A+B");
    variable.variablePositions = {{3, 30}, {1, 10}};
    variable.expressionErrors.resize(1);
    variable.expressionErrors[0].code = 7;
    const Contract own = expectNode(&variable, 0, "FormulaVariableNode", 4);
    int value = 0;
    int key = 0;
    call<void>(&variable, slotOf(own, "GetVariablePosition"), 0, &value, nullptr);
    call<void>(&variable, slotOf(own, "GetVariablePosition"), 0, nullptr, &key);
    EXPECT_EQ(value, 10);
    EXPECT_EQ(key, 1);
    EXPECT_EQ(call<int>(&variable, slotOf(own, "GetVariablePositionCount")), 2);
    EXPECT_STREQ(call<const char*>(&variable, slotOf(own, "GetFormula")), "A+B");
    EXPECT_EQ(call<int>(&variable, slotOf(own, "GetExpressionErrorCount")), 1);
    EXPECT_EQ(call<void*>(&variable, slotOf(own, "GetExpressionError"), 0), variable.expressionErrors.data());

    dp::FormulaVariableNode copy;
    copy = dp::FormulaVariableNode(variable);
    EXPECT_EQ(copy.expressionErrors.at(0).code * 10 + copy.GetChildNodeCount(), 71);
    EXPECT_EQ(copy.variablePositions, variable.variablePositions);

    dp::FormulaModelNode model;
    model.terms = std::string("A B");
    const Contract modelContract = expectNode(&model, 1, "FormulaModelNode", 6);
    EXPECT_STREQ(call<const char*>(&model, slotOf(modelContract, "GetTerms")), "A B");
    dp::FormulaModelVariableNode modelVariable;
    expectNode(&modelVariable, 2, "FormulaModelVariableNode", 4);
}

template <class Format>
void expectNumericFormat(const char* name, int subtype, int getters) {
    Format format;
    const Contract contract = contractOf(name);
    EXPECT_EQ(expectOwnGetters(format, name), getters);
    EXPECT_EQ(call<int>(&format, slotOf(contract, "GetType")), 0);
    EXPECT_EQ(call<int>(&format, slotOf(contract, "GetNumericSubtype")), subtype);
    poke(&format, fieldOf(contract, "decimalPlaces").offset, 3);
    poke(&format, fieldOf(contract, "significantDigits").offset, 4);
    poke(&format, fieldOf(contract, "rangeLow").offset, 5.0);
    poke(&format, fieldOf(contract, "rangeHigh").offset, 6.0);
    int places = 0;
    int digits = 0;
    double low = 0;
    double high = 0;
    call<void>(&format, slotOf(contract, "GetDecimalPlaces"), &places, &digits);
    call<void>(&format, slotOf(contract, "GetValueRange"), &low, &high);
    EXPECT_EQ(std::tuple(places, digits, low, high), std::tuple(3, 4, 5.0, 6.0));
    call<void>(&format, slotOf(contract, "GetDecimalPlaces"), nullptr, nullptr);
    call<void>(&format, slotOf(contract, "GetValueRange"), nullptr, nullptr);
}

TEST(HostContract, NumericFormats) {
    expectNumericFormat<dp::NumericVariableFormat>("NumericVariableFormat", 0, 3);
    expectNumericFormat<dp::PercentageVariableFormat>("PercentageVariableFormat", 4, 3);
    expectNumericFormat<dp::FractionVariableFormat>("FractionVariableFormat", 5, 6);
}

TEST(HostContract, TextAndDateTimeFormats) {
    dp::TextVariableFormat text;
    EXPECT_EQ(expectOwnGetters(text, "TextVariableFormat"), 2);
    EXPECT_EQ(call<int>(&text, slotOf(contractOf("TextVariableFormat"), "GetType")), 2);

    dp::DateTimeVariableFormat time("M/d/yyyy");
    const Contract slots = contractOf("DateTimeVariableFormat");
    EXPECT_EQ(expectOwnGetters(time, "DateTimeVariableFormat"), 2);
    EXPECT_EQ(call<int>(&time, slotOf(slots, "GetType")), 1);
    const unsigned given[4] = {1, 2, 3, 4};
    std::memcpy(reinterpret_cast<char*>(&time) + fieldOf(slots, "dateTimeParameters").offset, given, sizeof given);
    dp::DateTimeVariableFormat other;
    call<void>(&other, slotOf(slots, "SetDateTimeParameters"), &time);
    unsigned p[4] = {};
    call<void>(&other, slotOf(slots, "GetDateTimeParameters"), &p[0], &p[1], &p[2], &p[3]);
    EXPECT_TRUE(std::equal(p, p + 4, given));
    double value = 7.0;
    EXPECT_FALSE(call<bool>(&time, slotOf(slots, "ConvertToDatetime"), nullptr, nullptr, &value));
    EXPECT_EQ(value, 7.0);
    EXPECT_EQ(call<double>(&time, slotOf(slots, "GenerateTime"), 2010, 1, 5, 0, 0, 0, 0), 0.0);
    call<void>(&time, slotOf(slots, "SetGlobalDateTimeFormat"), nullptr);
    EXPECT_EQ(call<void*>(&time, slotOf(slots, "CovertVextralDateTimeToString"), 1.0), nullptr);
    EXPECT_FALSE(call<bool>(&time, slotOf(slots, "ValidVextralTime"), 1.0));
    EXPECT_EQ(call<double>(&time, slotOf(slots, "GetCurrentVextralTime")), 0.0);
    const std::unique_ptr<dp::IString> shown(call<dp::IString*>(&time, slotOf(slots, "FormatValue"), 40179.0, false));
    EXPECT_STREQ(shown->database_str(), "1/1/2010");
}

}  // namespace
