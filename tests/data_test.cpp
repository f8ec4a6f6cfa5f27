// Opens every file of tests/data as a host would and compares the result with the expectations beside it, which were
// derived from what other programs read in the same files.
#include <algorithm>
#include <chrono>
#include <filesystem>
#include <fstream>
#include <memory>
#include <set>
#include <string>
#include <thread>
#include <vector>

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include "dpxlsx/formats/date_time_variable_format.h"
#include "dpxlsx/model/host/entry_points.h"
#include "dpxlsx/model/host/i_column.h"
#include "dpxlsx/model/host/i_finders.h"
#include "dpxlsx/model/host/i_string.h"
#include "dpxlsx/model/host/i_worksheet.h"
#include "dpxlsx/model/host/reference.h"
#include "testkit/package_builder.h"
#include "testkit/providers.h"
#include "tests/paths.h"
#include "tests/temporary_files.h"

namespace {

using nlohmann::json;

std::string taken(dp::IString* text) { return std::unique_ptr<dp::IString>(text)->database_str(); }

// The host's part in reading date-times.
class Calendar : public dp::DateTimeVariableFormat {
  public:
    double GenerateTime(int year, int month, int day, int hour, int minute, int second,
                        int millisecond) const override {
        using namespace std::chrono;
        const sys_days date = std::chrono::year(year) / month / day;
        const milliseconds time = hours(hour) + minutes(minute) + seconds(second) + milliseconds(millisecond);
        return static_cast<double>((date.time_since_epoch() + days(25569)).count()) +
               static_cast<double>(time.count()) / 86400000.0;
    }
};

void addNumbers(const dp::INumericColumn& column, json& shown) {
    shown["converted"] = column.GetConvertedMissingCount();
    for (int row = 0; row < column.GetRowCount(); ++row) {
        const double value = column.GetValues()[row];
        const bool missing = value == dp::ExcelDataProviderBase::_missingValue;
        shown["values"].push_back(missing ? json() : json(value));
        if (!missing && !shown.contains("shown")) shown["shown"] = taken(column.GetFormat()->FormatValue(value, false));
    }
}

void addTexts(const dp::ITextColumn& column, json& shown) {
    const auto& texts = *column.GetTextValues();
    for (unsigned long row = 0; row < texts.Count(); ++row) {
        const std::string text = texts.Item(row).database_str();
        shown["values"].push_back(text.empty() ? json() : json(text));
    }
}

json contents(const dp::IColumn& column) {
    const int kind = column.GetDataType();
    json shown = {{"name", column.GetName()->database_str()},
                  {"kind", kind == 4   ? "text"
                           : kind == 2 ? "date-time"
                                       : "numeric"},
                  {"missing", column.GetMissingCount()},
                  {"values", json::array()}};
    if (const auto* numbers = dynamic_cast<const dp::INumericColumn*>(&column))
        addNumbers(*numbers, shown);
    else
        addTexts(dynamic_cast<const dp::ITextColumn&>(column), shown);
    return shown;
}

json contents(dp::IDataProvider& provider) {
    json sheets = json::array();
    const auto& worksheets = *provider.GetWorksheetFinder()->GetWorksheetPrimeKeys();
    for (unsigned long i = 0; i < worksheets.Count(); ++i) {
        dp::IWorksheet* found = nullptr;
        EXPECT_TRUE(provider.GetWorksheetFinder()->FindWorksheet(worksheets.Item(i), &found));
        json columns = json::array();
        const auto& keys = *provider.GetVariableFinder()->GetColumnPrimeKeys(worksheets.Item(i));
        for (unsigned long j = 0; j < keys.Count(); ++j) {
            dp::IColumn* column = nullptr;
            EXPECT_TRUE(provider.GetVariableFinder()->FindColumn(keys.Item(j), &column, false));
            columns.push_back(contents(*dp::Reference(column)));
        }
        sheets.push_back({{"name", dp::Reference(found)->GetTitle()}, {"columns", columns}});
    }
    return {{"sheets", sheets}};
}

json imported(const std::string& path, int rules = 0) {
    if (path.ends_with(".xml")) {
        Calendar calendar;
        const dp::Reference provider(new testkit::ReadingProvider);
        try {
            provider->read(std::make_unique<dp::ExcelXmlReader>(path, "m/d/yy", provider->GetMissingVxlValue(),
                                                                provider.get(), &calendar));
        } catch (const CmXmlException& error) {
            return {{"error", error.code()}};
        }
        return contents(*provider);
    }
    dp::IDataProvider* made = nullptr;
    EXPECT_EQ(dp::CreateDataProvider("xlsx", &made), 0);
    const dp::Reference provider(made);
    EXPECT_EQ(dp::SetReadingRules(made, rules), 0);
    const auto goOn = [](double, void*) { return 0; };
    EXPECT_EQ(dp::SetProgress(made, goOn, nullptr), 0);
    EXPECT_EQ(provider->OpenFile(path.c_str(), dp::IDataProvider::FileAccess::Read), 0);
    const json all = contents(*provider);
    EXPECT_EQ(provider->CloseFile(), 0);
    return all;
}

class DataTest : public TemporaryFiles, public testing::WithParamInterface<std::string> {};

TEST_P(DataTest, GivesWhatOtherReadersFindInIt) {
    const std::filesystem::path path = dataFile(GetParam());
    std::ifstream stored(std::filesystem::path(path).replace_extension(".expected.json"));
    const json expected = json::parse(stored);
    // A text may be cut within a character; the rest of that character becomes U+FFFD here.
    const std::string text = imported(path.string()).dump(-1, ' ', false, json::error_handler_t::replace);
    EXPECT_EQ(json::diff(expected, json::parse(text)), json::array()) << expected.dump(1);
}

// Without what is not said by cells alone: how values are shown, and whether missing ones were converted.
json withoutDisplay(json contents) {
    for (json& sheet : contents["sheets"])
        for (json& column : sheet["columns"])
            for (const char* detail : {"shown", "converted"}) column.erase(detail);
    return contents;
}

class PackageTest : public DataTest {};

// What the standard changes in the files is in standard_data.json, as patches: the values that other
// programs read.
TEST_P(PackageTest, GivesTheSameByTheStandardOrWhatItCures) {
    const std::filesystem::path path = dataFile(GetParam());
    std::ifstream stored(std::filesystem::path(path).replace_extension(".expected.json"));
    std::ifstream cured(casesFile("standard_data.json"));
    const json patches = json::parse(cured);
    json expected = withoutDisplay(json::parse(stored));
    if (patches.contains(GetParam())) expected = expected.patch(patches[GetParam()]);
    constexpr int kStandard = 1;
    EXPECT_EQ(json::diff(expected, withoutDisplay(imported(path.string(), kStandard))), json::array());
}

std::vector<std::string> dataFiles(const std::set<std::string>& extensions) {
    std::vector<std::string> names;
    for (const auto& entry : std::filesystem::directory_iterator(dataFile("")))
        if (extensions.count(entry.path().extension()) != 0) names.push_back(entry.path().filename().string());
    std::sort(names.begin(), names.end());
    return names;
}

class ThreadsTest : public TemporaryFiles {};

#ifdef __SANITIZE_THREAD__
constexpr int kOpens = 500;  // in each thread
#else
constexpr int kOpens = 25;
#endif

// What a host gets of a workbook, damaged or not.
std::string outcome(const std::string& path) try {
    const std::string type = dp::GetDataProviderFiletype(path.c_str());
    return type + imported(path).dump(-1, ' ', false, json::error_handler_t::replace);
} catch (const CmXmlException& error) {
    return std::to_string(error.code());
}

TEST_F(ThreadsTest, DoNotNoticeEachOther) {
    testkit::PackageBuilder::of({"<row><c><v>1</v></c></row><row"}).write(file("damaged.xlsx"));
    std::vector<std::string> paths = {file("damaged.xlsx")};
    for (const std::string& name : dataFiles({".xlsx"})) paths.push_back(dataFile(name));
    std::vector<std::string> expected(paths.size());
    std::transform(paths.begin(), paths.end(), expected.begin(), outcome);
    const auto import = [&](std::size_t first) {
        for (int open = 0; open < kOpens; ++open) {
            const std::size_t at = (first + static_cast<std::size_t>(open)) % paths.size();
            EXPECT_EQ(outcome(paths[at]), expected[at]) << paths[at];
        }
    };
    std::vector<std::jthread> threads;
    for (std::size_t thread = 0; thread < 8; ++thread) threads.emplace_back(import, thread * 5);
}

std::string testName(const testing::TestParamInfo<std::string>& file) {
    std::string name = file.param;
    std::replace(name.begin(), name.end(), '.', '_');
    return name;
}

INSTANTIATE_TEST_SUITE_P(, DataTest, testing::ValuesIn(dataFiles({".xlsx", ".xml"})), testName);
INSTANTIATE_TEST_SUITE_P(, PackageTest, testing::ValuesIn(dataFiles({".xlsx"})), testName);

}  // namespace
