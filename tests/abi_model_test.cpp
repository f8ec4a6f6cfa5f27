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

const std::string kColumn =
    "~ ~ AddRef Release GetDataType GetStorageType GetName GetDescription GetLastModified "
    "GetMissingCount GetRowCount GetFormat GetView IsFormatDirty ";
const std::string kNumericColumn = kColumn + "GetValues GetConvertedMissingCount GetFormattedValue";
const std::string kTextColumn = kColumn + "GetTextValues GetOrdering";
const std::string kVariable =
    "~ ~ GetPrimeKey SetPrimeKey GetVariableBodyPrimeKey SetVariableBodyPrimeKey "
    "GetOriginalVariablePrimeKey SetOriginalVariablePrimeKey UseDefaultVariableBody GetType "
    "GetPosition GetWorksheetId Attached IsCopy";
const std::string kHead =
    "name:s description:s primeKey:i variableBodyPrimeKey:i originalVariablePrimeKey:i position:i "
    "worksheetId:i missingCount:i lastModified:i rowCount:i ";
const std::string kFlags = "attached:b isCopy:b formatDirty:b useDefaultVariableBody:b ";
const std::string kNumericFields =
    kHead + "convertedMissingCount:i " + kFlags + "dataType:i values:p format:p view:24 refCount:i";
const std::string kTextFields =
    kHead + kFlags + "textValues:c ordering:48 format:p view:24 refCount:i";
constexpr std::size_t kTwoTables = 16;

// Both columns answer these alike, through their own table and through that of IVariable.
void expectColumn(void* column, const std::string& slots, const std::string& fields) {
    expectGetters({column, column, slots, fields, kTwoTables},
                  "GetName=name GetDescription=description GetLastModified=lastModified "
                  "GetMissingCount=missingCount GetRowCount=rowCount GetFormat=format GetView=view "
                  "IsFormatDirty=formatDirty");
    void* variable = static_cast<char*>(column) + 8;
    expectGetters({column, variable, kVariable, fields, kTwoTables},
                  "GetPrimeKey=primeKey GetVariableBodyPrimeKey=variableBodyPrimeKey "
                  "GetOriginalVariablePrimeKey=originalVariablePrimeKey "
                  "UseDefaultVariableBody=useDefaultVariableBody GetPosition=position "
                  "GetWorksheetId=worksheetId Attached=attached IsCopy=isCopy");
    for (const std::string key : {"primeKey", "variableBodyPrimeKey", "originalVariablePrimeKey"}) {
        std::string setter = "Set" + key;
        setter[3] = static_cast<char>(std::toupper(setter[3]));
        call<void>(variable, slotOf(kVariable, setter), 77);
        EXPECT_EQ(peek<int>(column, fieldOf(fields, key, kTwoTables).offset), 77) << key;
    }
    EXPECT_EQ(call<int>(variable, slotOf(kVariable, "GetType")), 3);
    EXPECT_EQ(call<unsigned>(column, slotOf(slots, "AddRef")), 1U);
    EXPECT_EQ(call<unsigned>(column, slotOf(slots, "AddRef")), 2U);
    call<void>(column, slotOf(slots, "Release"));
    EXPECT_EQ(peek<int>(column, fieldOf(fields, "refCount", kTwoTables).offset), 1);
    call<void>(column, slotOf(slots, "Release"));  // the last one deletes it
}

TEST(HostContract, NumericColumn) {
    auto* column = new dp::NumericColumn;
    column->format = std::make_unique<dp::TextVariableFormat>();
    column->values.reset(new double[2]{1.5, 2.5});
    expectGetters({column, column, kNumericColumn, kNumericFields, kTwoTables},
                  "GetDataType=dataType GetValues=values "
                  "GetConvertedMissingCount=convertedMissingCount");
    EXPECT_EQ(call<int>(column, slotOf(kNumericColumn, "GetStorageType")), 0);
    const std::unique_ptr<dp::IString> text(
        call<dp::IString*>(column, slotOf(kNumericColumn, "GetFormattedValue"), 2.5, '.'));
    EXPECT_STREQ(text->database_str(), "");
    expectColumn(column, kNumericColumn, kNumericFields);
}

TEST(HostContract, TextColumn) {
    auto* column = new dp::TextColumn;
    column->textValues.items.emplace_back("a");
    expectGetters({column, column, kTextColumn, kTextFields, kTwoTables},
                  "GetTextValues=textValues GetOrdering=ordering");
    EXPECT_EQ(call<int>(column, slotOf(kTextColumn, "GetDataType")), 4);
    EXPECT_EQ(call<int>(column, slotOf(kTextColumn, "GetStorageType")), 1);

    const auto* texts = call<const void*>(column, slotOf(kTextColumn, "GetTextValues"));
    const std::string collection = "~ ~ Count Item";
    const std::string string = "~ ~ database_str application_str operator=";
    EXPECT_EQ(call<unsigned long>(texts, slotOf(collection, "Count")), 1UL);
    void* item = call<void*>(texts, slotOf(collection, "Item"), 0UL);
    const std::string replacement = "b";
    EXPECT_EQ(*call<std::string*>(item, slotOf(string, "operator="), &replacement), "b");
    const char* characters = call<const char*>(item, slotOf(string, "database_str"));
    EXPECT_STREQ(characters, "b");
    EXPECT_EQ(call<const char*>(item, slotOf(string, "application_str")), characters);
    expectColumn(column, kTextColumn, kTextFields);
}

TEST(HostContract, SmallObjects) {
    dp::ColumnView view;
    expectGetters({&view, &view, "~ ~ GetAutoWiden GetWidthSet GetHidden GetWidth",
                   "autoWiden:b widthSet:b hidden:b width:d"},
                  "GetAutoWiden=autoWiden GetWidthSet=widthSet GetHidden=hidden GetWidth=width");
    dp::ColumnOrdering ordering;
    expectGetters({&ordering, &ordering, "~ ~ GetValueOrder GetOrderedTextValues",
                   "valueOrder:i orderedTextValues:c"},
                  "GetValueOrder=valueOrder GetOrderedTextValues=orderedTextValues");
    dp::CRows rows;
    const std::string rowSlots = "~ ~ UseAllRows GetRowCount GetRows";
    expectGetters({&rows, &rows, rowSlots, "useAllRows:b rowCount:i rows:v"},
                  "UseAllRows=useAllRows GetRowCount=rowCount");
    int count = -1;
    const int* numbers = nullptr;
    call<void>(&rows, slotOf(rowSlots, "GetRows"), &count, &numbers);
    EXPECT_EQ(count, 0);
    dp::ExpressionError error;
    expectGetters({&error, &error,
                   "~ ~ GetCode GetPosition GetLine GetRepeatCount GetLetter GetArgumentCount",
                   "code:i argumentCount:i letter:i line:i position:i repeatCount:i"},
                  "GetCode=code GetPosition=position GetLine=line GetRepeatCount=repeatCount "
                  "GetLetter=letter GetArgumentCount=argumentCount");
}

TEST(HostContract, Worksheet) {
    auto* sheet = new dp::Worksheet;
    const std::string slots =
        "~ ~ AddRef Release GetPrimeKey SetPrimeKey GetTitle GetHiddenColumnsUsed GetVersion "
        "GetCreator GetCreationDates GetComments GetOSVersion GetConstView GetDDELinkCount "
        "GetConstFormulaManager GetDesign GetAnalysis GetResponseModels GetView GetFormulaManager";
    const std::string fields =
        "primeKey:i title:t creator:t creationDates:t comments:t hiddenColumnsUsed:b version:d "
        "osVersion:i view:184 formulaManager:120 refCount:i";
    expectGetters({sheet, sheet, slots, fields},
                  "GetPrimeKey=primeKey GetTitle=title GetHiddenColumnsUsed=hiddenColumnsUsed "
                  "GetVersion=version GetCreator=creator GetCreationDates=creationDates "
                  "GetComments=comments GetOSVersion=osVersion GetConstView=view "
                  "GetConstFormulaManager=formulaManager GetView=view "
                  "GetFormulaManager=formulaManager");
    call<void>(sheet, slotOf(slots, "SetPrimeKey"), 5);
    EXPECT_EQ(call<int>(sheet, slotOf(slots, "GetPrimeKey")), 5);
    EXPECT_EQ(call<int>(sheet, slotOf(slots, "GetDDELinkCount")), 0);
    for (const char* absent : {"GetDesign", "GetAnalysis", "GetResponseModels"})
        EXPECT_EQ(call<void*>(sheet, slotOf(slots, absent)), nullptr) << absent;
    EXPECT_EQ(call<unsigned>(sheet, slotOf(slots, "AddRef")), 1U);
    EXPECT_EQ(peek<int>(sheet, fieldOf(fields, "refCount", 8).offset), 1);
    call<void>(sheet, slotOf(slots, "Release"));
}

TEST(HostContract, WorksheetViewAndFormulaManager) {
    dp::WorksheetView view;
    const std::string fields =
        "AllColumns:b HorizontalEntry:b PrintGrid:b PrintColumnNames:b PrintColumnLabels:b "
        "PrintRowLabels:b ActiveRow:i ActiveColumn:i LeftmostVisibleColumn:i TopVisibleRow:i "
        "StandardColumnWidth:d DataFontStyle:i LabelFontStyle:i DataFontPointSize:i "
        "LabelFontPointSize:i PrintJustification:i DataFontFaceName:s LabelFontFaceName:s "
        "MissingValue:s";
    std::string slots = "~ ~";  // then one getter for each field, in their order
    std::string getters;
    for (const std::string& field : words(fields)) {
        const std::string name = field.substr(0, field.find(':'));
        slots += " " + name;
        getters += " " + name + "=" + name;
    }
    expectGetters({&view, &view, slots, fields}, getters);

    dp::FormulaManager manager;
    const std::string managerSlots =
        "~ ~ GetUpdateAutomatically GetRecalculate GetStatusUpdateRequired GetListSeparator "
        "GetDecimalSymbol GetFormulaNodeCount GetFormulaNode";
    expectGetters({&manager, &manager, managerSlots,
                   "updateAutomatically:b recalculate:b statusUpdateRequired:b"},
                  "GetUpdateAutomatically=updateAutomatically GetRecalculate=recalculate "
                  "GetStatusUpdateRequired=statusUpdateRequired");
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

const std::string kNode =
    "~ ~ GetPrimeKey SetPrimeKey GetType GetDirty GetState GetParentNodeCount GetChildNodeCount "
    "GetParentNode GetChildNode ";
const std::string kOwnNode = kNode + "SetParentNode SetChildNode GetFormulaNodeInterface ";

// A node answers through its own table and through that of its kind; `tail` follows in both.
void expectNode(void* node, int type, const std::string& tail, const std::string& tailFields,
                const std::string& getters) {
    const std::string own = kOwnNode + tail;
    const std::string kind = kNode + tail;
    const std::string fields =
        "primeKey:i dirty:b state:i parentNodes:v childNodes:v secondTable:p " + tailFields;
    void* second = call<void*>(node, slotOf(own, "GetFormulaNodeInterface"));
    EXPECT_EQ(second, static_cast<char*>(node) + fieldOf(fields, "secondTable", 8).offset);

    for (const auto& [facet, slots] : {std::pair{node, own}, {second, kind}}) {
        expectGetters({node, facet, slots, fields},
                      "GetPrimeKey=primeKey GetDirty=dirty GetState=state " + getters);
        call<void>(facet, slotOf(slots, "SetPrimeKey"), 9);
        EXPECT_EQ(peek<int>(node, fieldOf(fields, "primeKey", 8).offset), 9);
        EXPECT_EQ(call<int>(facet, slotOf(slots, "GetType")), type);
    }
    call<void>(node, slotOf(own, "SetParentNode"), node);
    call<void>(node, slotOf(own, "SetParentNode"), second);
    call<void>(node, slotOf(own, "SetChildNode"), second);
    EXPECT_EQ(call<int>(second, slotOf(kind, "GetParentNodeCount")), 2);
    EXPECT_EQ(call<int>(second, slotOf(kind, "GetChildNodeCount")), 1);
    EXPECT_EQ(call<void*>(second, slotOf(kind, "GetParentNode"), 0), node);
    EXPECT_EQ(call<void*>(second, slotOf(kind, "GetChildNode"), 0), second);
}

TEST(HostContract, FormulaNodes) {
    dp::FormulaVariableNode variable;
    variable.formula = std::string("A+B");
    variable.variablePositions = {{3, 30}, {1, 10}};
    variable.expressionErrors.resize(1);
    const std::string tail =
        "GetVariablePrimeKey GetVariablePositionCount GetVariablePosition GetFormula "
        "GetExpressionErrorCount GetExpressionError";
    expectNode(&variable, 0, tail,
               "variablePositions:m expressionErrors:v variablePrimeKey:i formula:s",
               "GetVariablePrimeKey=variablePrimeKey");
    const std::string own = kOwnNode + tail;
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
    const std::string modelTail = "GetModelPrimeKey GetVariablePrimeKey GetTerms GetModelType";
    expectNode(&model, 1, modelTail, "variablePrimeKey:i modelPrimeKey:i terms:s modelType:i",
               "GetModelPrimeKey=modelPrimeKey GetVariablePrimeKey=variablePrimeKey "
               "GetModelType=modelType");
    EXPECT_STREQ(call<const char*>(&model, slotOf(kOwnNode + modelTail, "GetTerms")), "A B");

    dp::FormulaModelVariableNode modelVariable;
    expectNode(&modelVariable, 2, "GetVariablePrimeKey", "variablePrimeKey:i",
               "GetVariablePrimeKey=variablePrimeKey");
}

const std::string kFormat = "~ ~ GetType GetAuto FormatValue ";
const std::string kNumericFormat =
    kFormat + "GetNumericSubtype GetDecimalPlaces GetValueRange ShowFullPrecision ";
const std::string kNumericHead =
    "autoFormat:b decimalPlaces:i significantDigits:i rangeLow:d rangeHigh:d ";

void expectNumericFormat(void* format, int subtype, const std::string& tail,
                         const std::string& tailFields, const std::string& getters) {
    const std::string slots = kNumericFormat + tail;
    const std::string fields = kNumericHead + tailFields;
    expectGetters({format, format, slots, fields},
                  "GetAuto=autoFormat ShowFullPrecision=showsFullPrecision " + getters);
    EXPECT_EQ(call<int>(format, slotOf(slots, "GetType")), 0);
    EXPECT_EQ(call<int>(format, slotOf(slots, "GetNumericSubtype")), subtype);
    poke(format, fieldOf(fields, "decimalPlaces", 8).offset, 3);
    poke(format, fieldOf(fields, "significantDigits", 8).offset, 4);
    poke(format, fieldOf(fields, "rangeLow", 8).offset, 5.0);
    poke(format, fieldOf(fields, "rangeHigh", 8).offset, 6.0);
    int places = 0;
    int digits = 0;
    double low = 0;
    double high = 0;
    call<void>(format, slotOf(slots, "GetDecimalPlaces"), &places, &digits);
    call<void>(format, slotOf(slots, "GetValueRange"), &low, &high);
    EXPECT_EQ(std::tuple(places, digits, low, high), std::tuple(3, 4, 5.0, 6.0));
    call<void>(format, slotOf(slots, "GetDecimalPlaces"), nullptr, nullptr);
    call<void>(format, slotOf(slots, "GetValueRange"), nullptr, nullptr);
}

TEST(HostContract, NumericFormats) {
    dp::NumericVariableFormat numeric;
    expectNumericFormat(&numeric, 0, "", "showsFullPrecision:b numericSubtype:i",
                        "GetNumericSubtype=numericSubtype");
    dp::PercentageVariableFormat percentage;
    expectNumericFormat(&percentage, 4, "GetOwnDecimalPlaces",
                        "percentDecimalPlaces:i showsFullPrecision:b",
                        "GetOwnDecimalPlaces=percentDecimalPlaces");
    dp::FractionVariableFormat fraction;
    expectNumericFormat(
        &fraction, 5, "GetDenominator GetMaximumDigits GetMixedFraction GetFixedDenominator",
        "denominator:i maximumDigits:i mixedFraction:b fixedDenominator:b showsFullPrecision:b",
        "GetDenominator=denominator GetMaximumDigits=maximumDigits "
        "GetMixedFraction=mixedFraction GetFixedDenominator=fixedDenominator");
}

TEST(HostContract, TextAndDateTimeFormats) {
    dp::TextVariableFormat text;
    const std::string textSlots = kFormat + "GetCharacterCount";
    expectGetters({&text, &text, textSlots, "autoFormat:b characterCount:i"},
                  "GetAuto=autoFormat GetCharacterCount=characterCount");
    EXPECT_EQ(call<int>(&text, slotOf(textSlots, "GetType")), 2);

    dp::DateTimeVariableFormat time("M/d/yyyy");
    const std::string slots =
        kFormat +
        "GetDateTimeParameters SetDateTimeParameters GetFormatString ConvertToDatetime "
        "GenerateTime SetGlobalDateTimeFormat CovertVextralDateTimeToString ValidVextralTime "
        "GetCurrentVextralTime";
    const std::string fields = "autoFormat:b dateTimeParameters:4i pattern:s formatter:p";
    expectGetters({&time, &time, slots, fields}, "GetAuto=autoFormat GetFormatString=pattern");
    EXPECT_EQ(call<int>(&time, slotOf(slots, "GetType")), 1);
    const unsigned given[4] = {1, 2, 3, 4};
    std::memcpy(reinterpret_cast<char*>(&time) + fieldOf(fields, "dateTimeParameters", 8).offset,
                given, sizeof given);
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
