#include <memory>

#include "formats/date_time_variable_format.h"
#include "formats/fraction_variable_format.h"
#include "formats/numeric_variable_format.h"
#include "formats/percentage_variable_format.h"
#include "formats/text_variable_format.h"
#include "model/columns.h"
#include "model/formula.h"
#include "model/rows.h"
#include "model/worksheet.h"
#include "tests/abi.h"

// The objects that a host receives, seen through raw tables and memory. The slot and field tables
// are the contract with hosts compiled elsewhere: a change here is a change for all of them.
namespace {

using namespace raw;

const Slots kResource = {"~", "~delete", "AddRef", "Release"};

Slots operator+(Slots slots, const Slots& more) {
    slots.insert(slots.end(), more.begin(), more.end());
    return slots;
}

Fields operator+(Fields fields, const Fields& more) {
    fields.insert(fields.end(), more.begin(), more.end());
    return fields;
}

const Slots kColumn =
    kResource + Slots{"GetDataType",     "GetStorageType",  "GetName",     "GetDescription",
                      "GetLastModified", "GetMissingCount", "GetRowCount", "GetFormat",
                      "GetView",         "IsFormatDirty"};
const Slots kNumericColumn =
    kColumn + Slots{"GetValues", "GetConvertedMissingCount", "GetFormattedValue"};
const Slots kTextColumn = kColumn + Slots{"GetTextValues", "GetOrdering"};
const Slots kVariable = {"~",
                         "~delete",
                         "GetPrimeKey",
                         "SetPrimeKey",
                         "GetVariableBodyPrimeKey",
                         "SetVariableBodyPrimeKey",
                         "GetOriginalVariablePrimeKey",
                         "SetOriginalVariablePrimeKey",
                         "UseDefaultVariableBody",
                         "GetType",
                         "GetPosition",
                         "GetWorksheetId",
                         "Attached",
                         "IsCopy"};
const Fields kColumnHead = {{"name", kString},
                            {"description", kString},
                            {"primeKey", kInt},
                            {"variableBodyPrimeKey", kInt},
                            {"originalVariablePrimeKey", kInt},
                            {"position", kInt},
                            {"worksheetId", kInt},
                            {"missingCount", kInt},
                            {"lastModified", kInt},
                            {"rowCount", kInt}};
const Fields kFlags = {{"attached", kBool},
                       {"isCopy", kBool},
                       {"formatDirty", kBool},
                       {"useDefaultVariableBody", kBool}};
const Fields kNumericFields = kColumnHead + Fields{{"convertedMissingCount", kInt}} + kFlags +
                              Fields{{"dataType", kInt},
                                     {"ptr:values", kPointer},
                                     {"ptr:format", kPointer},
                                     {"view", kColumnView},
                                     {"refCount", kInt}};
const Fields kTextFields = kColumnHead + kFlags +
                           Fields{{"textValues", kCollection},
                                  {"ordering", kColumnOrdering},
                                  {"ptr:format", kPointer},
                                  {"view", kColumnView},
                                  {"refCount", kInt}};
constexpr std::size_t kTwoTables = 16;
constexpr std::size_t kOneTable = 8;

// Both columns answer these alike, through their own table and through that of IVariable.
void expectColumn(void* column, const Slots& slots, const Fields& fields) {
    const Shape own{column, column, slots, fields, kTwoTables};
    for (const auto& [operation, field] : {std::pair{"GetName", "name"},
                                           {"GetDescription", "description"},
                                           {"GetLastModified", "lastModified"},
                                           {"GetMissingCount", "missingCount"},
                                           {"GetRowCount", "rowCount"},
                                           {"GetFormat", "ptr:format"},
                                           {"GetView", "view"},
                                           {"IsFormatDirty", "formatDirty"}})
        expectGetter(own, operation, field);

    void* variable = static_cast<char*>(column) + kOneTable;
    const Shape asVariable{column, variable, kVariable, fields, kTwoTables};
    for (const auto& [operation, field] :
         {std::pair{"GetPrimeKey", "primeKey"},
          {"GetVariableBodyPrimeKey", "variableBodyPrimeKey"},
          {"GetOriginalVariablePrimeKey", "originalVariablePrimeKey"},
          {"UseDefaultVariableBody", "useDefaultVariableBody"},
          {"GetPosition", "position"},
          {"GetWorksheetId", "worksheetId"},
          {"Attached", "attached"},
          {"IsCopy", "isCopy"}})
        expectGetter(asVariable, operation, field);
    for (const auto& [operation, field] :
         {std::pair{"SetPrimeKey", "primeKey"},
          {"SetVariableBodyPrimeKey", "variableBodyPrimeKey"},
          {"SetOriginalVariablePrimeKey", "originalVariablePrimeKey"}}) {
        call<void>(variable, slotOf(kVariable, operation), 77);
        EXPECT_EQ(peek<int>(column, offsetOf(fields, field, kTwoTables)), 77) << operation;
    }
    EXPECT_EQ(call<int>(variable, slotOf(kVariable, "GetType")), 3);
    EXPECT_EQ(call<unsigned>(column, slotOf(slots, "AddRef")), 1U);
    EXPECT_EQ(call<unsigned>(column, slotOf(slots, "AddRef")), 2U);
    call<void>(column, slotOf(slots, "Release"));
    EXPECT_EQ(peek<int>(column, offsetOf(fields, "refCount", kTwoTables)), 1);
    call<void>(column, slotOf(slots, "Release"));  // the last one deletes it
}

TEST(HostContract, NumericColumn) {
    auto* column = new dp::NumericColumn;
    column->format = std::make_unique<dp::TextVariableFormat>();
    column->values.reset(new double[2]{1.5, 2.5});
    const Shape shape{column, column, kNumericColumn, kNumericFields, kTwoTables};
    for (const auto& [operation, field] : {std::pair{"GetDataType", "dataType"},
                                           {"GetValues", "ptr:values"},
                                           {"GetConvertedMissingCount", "convertedMissingCount"}})
        expectGetter(shape, operation, field);
    EXPECT_EQ(call<int>(column, slotOf(kNumericColumn, "GetStorageType")), 0);
    const std::unique_ptr<dp::IString> text(
        call<dp::IString*>(column, slotOf(kNumericColumn, "GetFormattedValue"), 2.5, '.'));
    EXPECT_STREQ(text->database_str(), "");
    expectColumn(column, kNumericColumn, kNumericFields);
}

TEST(HostContract, TextColumn) {
    auto* column = new dp::TextColumn;
    column->textValues.items.emplace_back("a");
    const Shape shape{column, column, kTextColumn, kTextFields, kTwoTables};
    expectGetter(shape, "GetTextValues", "textValues");
    expectGetter(shape, "GetOrdering", "ordering");
    EXPECT_EQ(call<int>(column, slotOf(kTextColumn, "GetDataType")), 4);
    EXPECT_EQ(call<int>(column, slotOf(kTextColumn, "GetStorageType")), 1);

    const auto* texts = call<const void*>(column, slotOf(kTextColumn, "GetTextValues"));
    const Slots collection = {"~", "~delete", "Count", "Item"};
    const Slots string = {"~", "~delete", "database_str", "application_str", "operator="};
    EXPECT_EQ(call<unsigned long>(texts, slotOf(collection, "Count")), 1UL);
    void* item = call<void*>(texts, slotOf(collection, "Item"), 0UL);
    const std::string replacement = "b";
    EXPECT_EQ(*call<std::string*>(item, slotOf(string, "operator="), &replacement), "b");
    const char* characters = call<const char*>(item, slotOf(string, "database_str"));
    EXPECT_STREQ(characters, "b");
    EXPECT_EQ(call<const char*>(item, slotOf(string, "application_str")), characters);
    expectColumn(column, kTextColumn, kTextFields);
}

struct GetterTable {
    const char* name;
    Slots slots;
    Fields fields;
    std::vector<std::pair<const char*, const char*>> getters;
};

void expectGetters(void* object, const GetterTable& table) {
    SCOPED_TRACE(table.name);
    const Shape shape{object, object, table.slots, table.fields, kOneTable};
    for (const auto& [operation, field] : table.getters) expectGetter(shape, operation, field);
}

TEST(HostContract, SmallObjects) {
    dp::ColumnView view;
    expectGetters(
        &view, {"ColumnView",
                {"~", "~delete", "GetAutoWiden", "GetWidthSet", "GetHidden", "GetWidth"},
                {{"autoWiden", kBool}, {"widthSet", kBool}, {"hidden", kBool}, {"width", kDouble}},
                {{"GetAutoWiden", "autoWiden"},
                 {"GetWidthSet", "widthSet"},
                 {"GetHidden", "hidden"},
                 {"GetWidth", "width"}}});
    dp::ColumnOrdering ordering;
    expectGetters(&ordering, {"ColumnOrdering",
                              {"~", "~delete", "GetValueOrder", "GetOrderedTextValues"},
                              {{"valueOrder", kInt}, {"orderedTextValues", kCollection}},
                              {{"GetValueOrder", "valueOrder"},
                               {"GetOrderedTextValues", "orderedTextValues"}}});
    dp::CRows rows;
    const Slots rowSlots = {"~", "~delete", "UseAllRows", "GetRowCount", "GetRows"};
    expectGetters(&rows, {"CRows",
                          rowSlots,
                          {{"useAllRows", kBool}, {"rowCount", kInt}, {"rows", kVector}},
                          {{"UseAllRows", "useAllRows"}, {"GetRowCount", "rowCount"}}});
    int count = -1;
    const int* numbers = nullptr;
    call<void>(&rows, slotOf(rowSlots, "GetRows"), &count, &numbers);
    EXPECT_EQ(count, 0);
    dp::ExpressionError error;
    expectGetters(&error, {"ExpressionError",
                           {"~", "~delete", "GetCode", "GetPosition", "GetLine", "GetRepeatCount",
                            "GetLetter", "GetArgumentCount"},
                           {{"code", kInt},
                            {"argumentCount", kInt},
                            {"letter", kInt},
                            {"line", kInt},
                            {"position", kInt},
                            {"repeatCount", kInt}},
                           {{"GetCode", "code"},
                            {"GetPosition", "position"},
                            {"GetLine", "line"},
                            {"GetRepeatCount", "repeatCount"},
                            {"GetLetter", "letter"},
                            {"GetArgumentCount", "argumentCount"}}});
}

TEST(HostContract, Worksheet) {
    auto* sheet = new dp::Worksheet;
    const Slots slots =
        kResource +
        Slots{"GetPrimeKey",      "SetPrimeKey",   "GetTitle",          "GetHiddenColumnsUsed",
              "GetVersion",       "GetCreator",    "GetCreationDates",  "GetComments",
              "GetOSVersion",     "GetView const", "GetDDELinkCount",   "GetFormulaManager const",
              "GetDesign",        "GetAnalysis",   "GetResponseModels", "GetView",
              "GetFormulaManager"};
    const Type view{184, 8};
    const Type manager{120, 8};
    const Fields fields = {{"primeKey", kInt},       {"title", kStdString},
                           {"creator", kStdString},  {"creationDates", kStdString},
                           {"comments", kStdString}, {"hiddenColumnsUsed", kBool},
                           {"version", kDouble},     {"osVersion", kInt},
                           {"view", view},           {"formulaManager", manager},
                           {"refCount", kInt}};
    expectGetters(sheet, {"Worksheet",
                          slots,
                          fields,
                          {{"GetPrimeKey", "primeKey"},
                           {"GetTitle", "title"},
                           {"GetHiddenColumnsUsed", "hiddenColumnsUsed"},
                           {"GetVersion", "version"},
                           {"GetCreator", "creator"},
                           {"GetCreationDates", "creationDates"},
                           {"GetComments", "comments"},
                           {"GetOSVersion", "osVersion"},
                           {"GetView const", "view"},
                           {"GetFormulaManager const", "formulaManager"},
                           {"GetView", "view"},
                           {"GetFormulaManager", "formulaManager"}}});
    call<void>(sheet, slotOf(slots, "SetPrimeKey"), 5);
    EXPECT_EQ(call<int>(sheet, slotOf(slots, "GetPrimeKey")), 5);
    EXPECT_EQ(call<int>(sheet, slotOf(slots, "GetDDELinkCount")), 0);
    for (const char* absent : {"GetDesign", "GetAnalysis", "GetResponseModels"})
        EXPECT_EQ(call<void*>(sheet, slotOf(slots, absent)), nullptr) << absent;
    EXPECT_EQ(call<unsigned>(sheet, slotOf(slots, "AddRef")), 1U);
    EXPECT_EQ(peek<int>(sheet, offsetOf(fields, "refCount", kOneTable)), 1);
    call<void>(sheet, slotOf(slots, "Release"));
}

TEST(HostContract, WorksheetViewAndFormulaManager) {
    dp::WorksheetView view;
    const Fields fields = {{"AllColumns", kBool},
                           {"HorizontalEntry", kBool},
                           {"PrintGrid", kBool},
                           {"PrintColumnNames", kBool},
                           {"PrintColumnLabels", kBool},
                           {"PrintRowLabels", kBool},
                           {"ActiveRow", kInt},
                           {"ActiveColumn", kInt},
                           {"LeftmostVisibleColumn", kInt},
                           {"TopVisibleRow", kInt},
                           {"StandardColumnWidth", kDouble},
                           {"DataFontStyle", kInt},
                           {"LabelFontStyle", kInt},
                           {"DataFontPointSize", kInt},
                           {"LabelFontPointSize", kInt},
                           {"PrintJustification", kInt},
                           {"DataFontFaceName", kString},
                           {"LabelFontFaceName", kString},
                           {"MissingValue", kString}};
    Slots slots = {"~", "~delete"};  // then one getter for each field, in their order
    for (const Field& field : fields) slots.push_back(field.name);
    const Shape shape{&view, &view, slots, fields, kOneTable};
    for (const Field& field : fields) expectGetter(shape, field.name, field.name);

    dp::FormulaManager manager;
    const Slots managerSlots = {"~",
                                "~delete",
                                "GetUpdateAutomatically",
                                "GetRecalculate",
                                "GetStatusUpdateRequired",
                                "GetListSeparator",
                                "GetDecimalSymbol",
                                "GetFormulaNodeCount",
                                "GetFormulaNode"};
    expectGetters(
        &manager,
        {"FormulaManager",
         managerSlots,
         {{"updateAutomatically", kBool}, {"recalculate", kBool}, {"statusUpdateRequired", kBool}},
         {{"GetUpdateAutomatically", "updateAutomatically"},
          {"GetRecalculate", "recalculate"},
          {"GetStatusUpdateRequired", "statusUpdateRequired"}}});
    manager.listSeparator = std::string(";");
    manager.decimalSymbol = std::string(",");
    EXPECT_STREQ(call<const char*>(&manager, slotOf(managerSlots, "GetListSeparator")), ";");
    EXPECT_STREQ(call<const char*>(&manager, slotOf(managerSlots, "GetDecimalSymbol")), ",");
    auto* node = new dp::FormulaModelNode;
    manager.formulaNodes.push_back(node);
    EXPECT_EQ(call<int>(&manager, slotOf(managerSlots, "GetFormulaNodeCount")), 1);
    EXPECT_EQ(call<void*>(&manager, slotOf(managerSlots, "GetFormulaNode"), 0),
              static_cast<dp::IFormulaModelNode*>(node));
}

const Slots kNode = {
    "~",           "~delete",  "GetPrimeKey",        "SetPrimeKey",       "GetType",
    "GetDirty",    "GetState", "GetParentNodeCount", "GetChildNodeCount", "GetParentNode",
    "GetChildNode"};
const Slots kNodeTail = {"SetParentNode", "SetChildNode", "GetFormulaNodeInterface"};
const Fields kNodeFields = {{"primeKey", kInt},
                            {"dirty", kBool},
                            {"state", kInt},
                            {"parentNodes", kVector},
                            {"childNodes", kVector}};

// A node answers through its own table and through that of its kind; `tail` follows in both.
void expectNode(void* node, int type, const Slots& tail, const Fields& tailFields,
                const std::vector<std::pair<const char*, const char*>>& getters) {
    const Slots own = kNode + kNodeTail + tail;
    const Slots kind = kNode + tail;
    const Fields fields = kNodeFields + Fields{{"second table", kPointer}} + tailFields;
    void* second = call<void*>(node, slotOf(own, "GetFormulaNodeInterface"));
    EXPECT_EQ(second, static_cast<char*>(node) + offsetOf(fields, "second table", kOneTable));

    for (const auto& [facet, slots] : {std::pair{node, own}, {second, kind}}) {
        const Shape shape{node, facet, slots, fields, kOneTable};
        for (const auto& [operation, field] :
             {std::pair{"GetPrimeKey", "primeKey"}, {"GetDirty", "dirty"}, {"GetState", "state"}})
            expectGetter(shape, operation, field);
        for (const auto& [operation, field] : getters) expectGetter(shape, operation, field);
        call<void>(facet, slotOf(slots, "SetPrimeKey"), 9);
        EXPECT_EQ(peek<int>(node, offsetOf(fields, "primeKey", kOneTable)), 9);
        EXPECT_EQ(call<int>(facet, slotOf(slots, "GetType")), type);
    }
    void* parent = node;
    call<void>(node, slotOf(own, "SetParentNode"), parent);
    call<void>(node, slotOf(own, "SetParentNode"), second);
    call<void>(node, slotOf(own, "SetChildNode"), second);
    EXPECT_EQ(call<int>(second, slotOf(kind, "GetParentNodeCount")), 2);
    EXPECT_EQ(call<int>(second, slotOf(kind, "GetChildNodeCount")), 1);
    EXPECT_EQ(call<void*>(second, slotOf(kind, "GetParentNode"), 0), parent);
    EXPECT_EQ(call<void*>(second, slotOf(kind, "GetChildNode"), 0), second);
}

TEST(HostContract, FormulaNodes) {
    dp::FormulaVariableNode variable;
    variable.formula = std::string("A+B");
    variable.variablePositions = {{3, 30}, {1, 10}};
    variable.expressionErrors.resize(1);
    const Slots tail = {"GetVariablePrimeKey", "GetVariablePositionCount", "GetVariablePosition",
                        "GetFormula",          "GetExpressionErrorCount",  "GetExpressionError"};
    expectNode(&variable, 0, tail,
               {{"variablePositions", kMap},
                {"expressionErrors", kVector},
                {"variablePrimeKey", kInt},
                {"formula", kString}},
               {{"GetVariablePrimeKey", "variablePrimeKey"}});
    const Slots own = kNode + kNodeTail + tail;
    int value = 0;
    int key = 0;
    call<void>(&variable, slotOf(own, "GetVariablePosition"), 0, &value, &key);
    EXPECT_EQ(value, 10);
    EXPECT_EQ(key, 1);
    EXPECT_EQ(call<int>(&variable, slotOf(own, "GetVariablePositionCount")), 2);
    EXPECT_STREQ(call<const char*>(&variable, slotOf(own, "GetFormula")), "A+B");
    EXPECT_EQ(call<int>(&variable, slotOf(own, "GetExpressionErrorCount")), 1);
    EXPECT_EQ(call<void*>(&variable, slotOf(own, "GetExpressionError"), 0),
              variable.expressionErrors.data());

    dp::FormulaModelNode model;
    model.terms = std::string("A B");
    const Slots modelTail = {"GetModelPrimeKey", "GetVariablePrimeKey", "GetTerms", "GetModelType"};
    expectNode(&model, 1, modelTail,
               {{"variablePrimeKey", kInt},
                {"modelPrimeKey", kInt},
                {"terms", kString},
                {"modelType", kInt}},
               {{"GetModelPrimeKey", "modelPrimeKey"},
                {"GetVariablePrimeKey", "variablePrimeKey"},
                {"GetModelType", "modelType"}});
    EXPECT_STREQ(call<const char*>(&model, slotOf(kNode + kNodeTail + modelTail, "GetTerms")),
                 "A B");

    dp::FormulaModelVariableNode modelVariable;
    expectNode(&modelVariable, 2, {"GetVariablePrimeKey"}, {{"variablePrimeKey", kInt}},
               {{"GetVariablePrimeKey", "variablePrimeKey"}});
}

const Slots kFormat = {"~", "~delete", "GetType", "GetAuto", "FormatValue"};
const Slots kNumericFormat =
    kFormat + Slots{"GetNumericSubtype", "GetDecimalPlaces", "GetValueRange", "ShowFullPrecision"};
const Fields kNumericHead = {{"autoFormat", kBool},
                             {"decimalPlaces", kInt},
                             {"significantDigits", kInt},
                             {"rangeLow", kDouble},
                             {"rangeHigh", kDouble}};

void expectNumericFormat(void* format, const char* name, const Slots& slots, const Fields& fields,
                         int subtype) {
    expectGetters(format,
                  {name,
                   slots,
                   fields,
                   {{"GetAuto", "autoFormat"}, {"ShowFullPrecision", "showsFullPrecision"}}});
    EXPECT_EQ(call<int>(format, slotOf(slots, "GetType")), 0);
    EXPECT_EQ(call<int>(format, slotOf(slots, "GetNumericSubtype")), subtype);
    poke(format, offsetOf(fields, "decimalPlaces", kOneTable), 3);
    poke(format, offsetOf(fields, "significantDigits", kOneTable), 4);
    poke(format, offsetOf(fields, "rangeLow", kOneTable), 5.0);
    poke(format, offsetOf(fields, "rangeHigh", kOneTable), 6.0);
    int places = 0;
    int digits = 0;
    double low = 0;
    double high = 0;
    call<void>(format, slotOf(slots, "GetDecimalPlaces"), &places, &digits);
    call<void>(format, slotOf(slots, "GetValueRange"), &low, &high);
    EXPECT_EQ(places, 3);
    EXPECT_EQ(digits, 4);
    EXPECT_EQ(low, 5.0);
    EXPECT_EQ(high, 6.0);
    call<void>(format, slotOf(slots, "GetDecimalPlaces"), nullptr, nullptr);
    call<void>(format, slotOf(slots, "GetValueRange"), nullptr, nullptr);
}

TEST(HostContract, NumericFormats) {
    dp::NumericVariableFormat numeric;
    const Fields numericFields =
        kNumericHead + Fields{{"showsFullPrecision", kBool}, {"numericSubtype", kInt}};
    expectNumericFormat(&numeric, "numeric", kNumericFormat, numericFields, 0);
    expectGetters(
        &numeric,
        {"numeric", kNumericFormat, numericFields, {{"GetNumericSubtype", "numericSubtype"}}});

    dp::PercentageVariableFormat percentage;
    const Slots percentageSlots = kNumericFormat + Slots{"GetPercentDecimalPlaces"};
    const Fields percentageFields =
        kNumericHead + Fields{{"percentDecimalPlaces", kInt}, {"showsFullPrecision", kBool}};
    expectNumericFormat(&percentage, "percentage", percentageSlots, percentageFields, 4);
    expectGetters(&percentage, {"percentage",
                                percentageSlots,
                                percentageFields,
                                {{"GetPercentDecimalPlaces", "percentDecimalPlaces"}}});

    dp::FractionVariableFormat fraction;
    const Slots fractionSlots = kNumericFormat + Slots{"GetDenominator", "GetMaximumDigits",
                                                       "GetMixedFraction", "GetFixedDenominator"};
    const Fields fractionFields = kNumericHead + Fields{{"denominator", kInt},
                                                        {"maximumDigits", kInt},
                                                        {"mixedFraction", kBool},
                                                        {"fixedDenominator", kBool},
                                                        {"showsFullPrecision", kBool}};
    expectNumericFormat(&fraction, "fraction", fractionSlots, fractionFields, 5);
    expectGetters(&fraction, {"fraction",
                              fractionSlots,
                              fractionFields,
                              {{"GetDenominator", "denominator"},
                               {"GetMaximumDigits", "maximumDigits"},
                               {"GetMixedFraction", "mixedFraction"},
                               {"GetFixedDenominator", "fixedDenominator"}}});
}

TEST(HostContract, TextAndDateTimeFormats) {
    dp::TextVariableFormat text;
    const Slots textSlots = kFormat + Slots{"GetCharacterCount"};
    expectGetters(&text, {"text",
                          textSlots,
                          {{"autoFormat", kBool}, {"characterCount", kInt}},
                          {{"GetAuto", "autoFormat"}, {"GetCharacterCount", "characterCount"}}});
    EXPECT_EQ(call<int>(&text, slotOf(textSlots, "GetType")), 2);

    dp::DateTimeVariableFormat time("M/d/yyyy");
    const Slots slots = kFormat + Slots{"GetDateTimeParameters",
                                        "SetDateTimeParameters",
                                        "GetFormatString",
                                        "ConvertToDatetime",
                                        "GenerateTime",
                                        "SetGlobalDateTimeFormat",
                                        "CovertVextralDateTimeToString",
                                        "ValidVextralTime",
                                        "GetCurrentVextralTime"};
    const Type fourInts{16, 4};
    const Fields fields = {{"autoFormat", kBool},
                           {"dateTimeParameters", fourInts},
                           {"pattern", kString},
                           {"ptr:formatter", kPointer}};
    expectGetters(
        &time,
        {"date-time", slots, fields, {{"GetAuto", "autoFormat"}, {"GetFormatString", "pattern"}}});
    EXPECT_EQ(call<int>(&time, slotOf(slots, "GetType")), 1);
    unsigned given[4] = {1, 2, 3, 4};
    std::memcpy(time.dateTimeParameters, given, sizeof given);
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
    const std::unique_ptr<dp::IString> shown(
        call<dp::IString*>(&time, slotOf(slots, "FormatValue"), 40179.0, false));
    EXPECT_STREQ(shown->database_str(), "1/1/2010");
}

}  // namespace
