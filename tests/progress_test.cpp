#include "dpxlsx/readers/xml/progress.h"

#include <algorithm>
#include <chrono>
#include <cstddef>
#include <functional>
#include <iterator>
#include <limits>
#include <numeric>
#include <optional>
#include <random>
#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

#include "dpxlsx/model/host/entry_points.h"
#include "dpxlsx/provider/progress_reports.h"
#include "dpxlsx/readers/xml/xml_reader.h"
#include "testkit/package_builder.h"
#include "testkit/providers.h"
#include "testkit/recording_provider.h"
#include "tests/temporary_files.h"

// What hosts are told while a workbook is opened or listed, and how they end it.
namespace {

using dp::Progress;
using testkit::PackageBuilder;
using testkit::RecordingProvider;
using Time = dp::ProgressReport::Time;

constexpr int kOwnCode = 7;
constexpr std::size_t kNever = std::numeric_limits<std::size_t>::max();

// A host that keeps what it is told and ends the work at one of the calls.
struct Told {
    static int report(double done, void* user) {
        Told& told = *static_cast<Told*>(user);
        const std::size_t call = told.done.size();
        told.done.push_back(done);
        if (call != told.endAt) return 0;
        if (told.throws && call % 2 == 0) throw std::runtime_error("the host's own");
        if (told.throws) throw CmXmlException(kOwnCode);
        return call % 2 == 0 ? 1 : -1;
    }

    std::vector<double> done;
    std::size_t endAt = kNever;
    bool throws = false;
};

// By this clock every report is due.
Time everyTime() {
    static Time time;
    return time += std::chrono::seconds(1);
}

TEST(ProgressTest, IsTheShareOfTheBytes) {
    Told told;
    Progress progress({&Told::report, &told, everyTime}, Progress::Reading::Worksheets);
    const auto tell = [&told] {
        Progress::tell();
        return told.done.back();
    };
    EXPECT_EQ(tell(), 0);
    Progress::expect(60, 39);  // 99 bytes, and the end
    Progress::countUnpacked(30);
    EXPECT_DOUBLE_EQ(tell(), 0.3);
    Progress::countUnpacked(1000);
    EXPECT_DOUBLE_EQ(tell(), 0.6) << "more than expected";
    Progress::beginPart("a");
    Progress::countRead(10);
    EXPECT_DOUBLE_EQ(tell(), 0.7);
    Progress::beginPart("a");
    Progress::countRead(5);
    EXPECT_DOUBLE_EQ(tell(), 0.7) << "the part is read once more";
    Progress::countRead(10);
    EXPECT_DOUBLE_EQ(tell(), 0.75);
    Progress::beginPart("b");
    Progress::countRead(14);
    EXPECT_DOUBLE_EQ(tell(), 0.89);
    Progress::countRead(1000);
    EXPECT_DOUBLE_EQ(tell(), 0.99);
    const std::size_t calls = told.done.size();
    tell();
    EXPECT_EQ(told.done.size(), calls) << "nothing new";
    progress.finish();
    EXPECT_EQ(told.done.back(), 1);
}

TEST(ProgressTest, IsToldTenTimesASecond) {
    static Time time;
    Told told;
    const Progress progress({&Told::report, &told, [] { return time; }}, Progress::Reading::Names);
    std::vector<int> toldAt;
    for (int now = 0; now < 500; now += 7) {
        time = Time(std::chrono::milliseconds(now));
        Progress::countRead(1);
        const std::size_t before = told.done.size();
        Progress::tell();
        if (told.done.size() > before) toldAt.push_back(now);
    }
    EXPECT_EQ(toldAt, (std::vector<int>{0, 105, 210, 315, 420}));
}

struct BookCase {
    const char* name;
    PackageBuilder package;
    int rules;
};

class ProgressOfProvider : public TemporaryFiles {
  protected:
    enum class Call { Open, List };

    long run(RecordingProvider& provider, Call call) {
        const std::string book = file("book.xlsx");
        if (call == Call::Open) return provider.OpenFile(book.c_str(), dp::IDataProvider::FileAccess::Read);
        names.clear();
        return provider.GetWorksheets(book.c_str(), names);
    }
    static std::ptrdiff_t openFiles() {
        const boost::filesystem::directory_iterator descriptors("/proc/self/fd");
        return std::distance(begin(descriptors), end(descriptors));
    }

    // The whole work; every call is checked.
    std::size_t expectRise(const BookCase& c, Call call, std::string& cells) {
        RecordingProvider provider;
        Told told;
        dp::SetReadingRules(&provider, c.rules);
        dp::setProgressReport(provider, {&Told::report, &told, everyTime});
        EXPECT_EQ(run(provider, call), 0);
        cells = provider.taken();
        EXPECT_TRUE(std::is_sorted(told.done.begin(), told.done.end()));
        EXPECT_EQ(told.done.front(), 0);
        EXPECT_EQ(told.done.back(), 1);
        EXPECT_EQ(std::count(told.done.begin(), told.done.end(), 1), 1);
        const double stillToCome = call == Call::Open ? 0.15 : 0.01;
        EXPECT_GT(told.done[told.done.size() - 2], 1 - stillToCome) << "what is read was not expected";
        EXPECT_EQ(provider.CloseFile(), 0);
        return told.done.size();
    }

    // The work is ended at one of the calls, and done again.
    void expectEnd(const BookCase& c, Call call, std::size_t at, bool throws, const std::string& cells) {
        RecordingProvider provider;
        Told told{{}, at, throws};
        dp::SetReadingRules(&provider, c.rules);
        dp::setProgressReport(provider, {&Told::report, &told, everyTime});
        const std::ptrdiff_t filesBefore = openFiles();
        std::string end;
        try {
            end = std::to_string(run(provider, call));
        } catch (const std::runtime_error& e) {
            end = e.what();
        } catch (const CmXmlException& e) {
            end = std::to_string(e.code());
        }
        EXPECT_EQ(end, !throws ? "-20" : at % 2 == 0 ? "the host's own" : std::to_string(kOwnCode));
        EXPECT_EQ(told.done.size(), at + 1) << "called after the end";
        EXPECT_TRUE(boost::filesystem::is_empty(temporary()));
        EXPECT_EQ(provider.GetTempDirectoryPath(), "");
        EXPECT_EQ(openFiles(), filesBefore);
        EXPECT_EQ(provider.CloseFile(), 0);
        provider.ClearWorksheets();
        provider.taken();
        told.endAt = kNever;
        EXPECT_EQ(run(provider, call), 0);
        EXPECT_EQ(provider.taken(), cells);
        EXPECT_EQ(told.done.back(), 1);
        EXPECT_EQ(provider.CloseFile(), 0);
    }

    std::vector<std::string> names;
};

// Parts that begin with a comment are left to libxml2, and those that end with one after they have been read once.
PackageBuilder commented(PackageBuilder package, bool atTheEnd) {
    for (auto& [name, content] : package.parts) content = atTheEnd ? content + "<!---->" : "<!---->" + content;
    return package;
}

PackageBuilder large() {
    std::string rows;
    for (int row = 0; row < 6000; ++row) rows += "<row><c><v>" + std::to_string(row) + "</v></c></row>";
    // Most of the package is a picture, which nobody reads.
    return PackageBuilder::of({rows, rows}).set("xl/media/image1.png", std::string(2 << 20, 'x'));
}

// All calls of a small work, and some of a large one.
std::vector<std::size_t> endsAmong(std::size_t calls) {
    static std::mt19937 random(18);
    std::vector<std::size_t> ends(calls);
    std::iota(ends.begin(), ends.end(), 0);
    constexpr std::size_t kMost = 32;
    if (calls <= kMost) return ends;
    std::shuffle(ends.begin(), ends.end(), random);
    return {ends.begin(), ends.begin() + 2};
}

TEST_F(ProgressOfProvider, RisesAndEndsWhereTheHostSays) {
    const PackageBuilder& small = PackageBuilder::small();
    const BookCase cases[] = {{"small", small, 0},
                              {"small, libxml2", commented(small, false), 0},
                              {"small, read twice", commented(small, true), 0},
                              {"small, by the standard", small, 1},
                              {"large", large(), 0},
                              {"large, libxml2", commented(large(), false), 0},
                              {"large, read twice", commented(large(), true), 0},
                              {"large, by the standard", large(), 1}};
    for (const BookCase& c : cases)
        for (const Call call : {Call::Open, Call::List}) {
            SCOPED_TRACE(std::string(c.name) + (call == Call::Open ? ", opened" : ", listed"));
            c.package.write(file("book.xlsx"));
            std::string cells;
            const std::size_t calls = expectRise(c, call, cells);
            for (const std::size_t at : endsAmong(calls))
                for (const bool throws : {false, true}) {
                    SCOPED_TRACE(std::to_string(at) + (throws ? ", by an exception" : ""));
                    expectEnd(c, call, at, throws, cells);
                }
        }
}

TEST_F(ProgressOfProvider, IsToldUntilSetAgain) {
    Told told;
    EXPECT_EQ(dp::SetProgress(nullptr, &Told::report, &told), -50);
    testkit::ReadingProvider other;
    EXPECT_EQ(dp::SetProgress(&other, &Told::report, &told), -50);

    PackageBuilder::small().write(file("book.xlsx"));
    RecordingProvider provider;
    const auto told01 = [&] {
        told.done.clear();
        EXPECT_EQ(run(provider, Call::List), 0);
        return !told.done.empty() && told.done.front() == 0 && told.done.back() == 1;
    };
    EXPECT_EQ(dp::SetProgress(&provider, &Told::report, &told), 0);
    EXPECT_TRUE(told01());
    provider.ClearWorksheets();
    EXPECT_TRUE(told01()) << "after clearing";
    Told toldOther;
    std::optional<RecordingProvider> another(std::in_place);
    EXPECT_EQ(dp::SetProgress(&*another, &Told::report, &toldOther), 0);
    another.emplace();  // at the same place
    EXPECT_EQ(run(*another, Call::List), 0);
    EXPECT_EQ(dp::SetProgress(&*another, nullptr, nullptr), 0);
    EXPECT_TRUE(toldOther.done.empty());
    EXPECT_TRUE(told01()) << "as it was set for this provider";
    EXPECT_EQ(dp::SetProgress(&provider, nullptr, &told), 0);
    told.done.clear();
    EXPECT_EQ(run(provider, Call::List), 0);
    EXPECT_TRUE(told.done.empty());
}

// A host that shows a dialog may get round to another workbook, or to a document of its own.
TEST_F(ProgressOfProvider, OthersMayBeReadMeanwhile) {
    struct Nested : Told {
        static int report(double done, void* user) {
            static_cast<Nested*>(user)->meanwhile();
            return Told::report(done, user);
        }
        std::function<void()> meanwhile;
    };
    commented(PackageBuilder::small(), true).write(file("book.xlsx"));
    RecordingProvider provider;
    Told alone;
    dp::setProgressReport(provider, {&Told::report, &alone, everyTime});
    EXPECT_EQ(run(provider, Call::Open), 0);
    const std::string cells = provider.taken();
    provider.ClearWorksheets();
    write("own.xml", "<own>text</own>");
    Nested nested;
    nested.meanwhile = [this] {
        RecordingProvider other;
        EXPECT_EQ(run(other, Call::Open), 0);
        XmlReader reader;
        reader.mInitialize(file("own.xml"));
        while (reader.readNode()) {
        }
    };
    dp::setProgressReport(provider, {&Nested::report, &nested, everyTime});
    EXPECT_EQ(run(provider, Call::Open), 0);
    EXPECT_EQ(nested.done, alone.done);
    EXPECT_EQ(provider.taken(), cells);
    provider.CloseFile();
}

TEST_F(ProgressOfProvider, CellsOfAnEarlierFileKeepTheirFormats) {
    PackageBuilder::small().write(file("book.xlsx"));
    RecordingProvider provider;
    EXPECT_EQ(run(provider, Call::Open), 0);
    dp::ExternalDataRecordCell cell;
    const auto hasDate = [&] {
        for (cell.formatIndex = 0; cell.formatIndex < 50; ++cell.formatIndex)
            if (provider.IsDateTimeFormatType(cell)) return true;
        return false;
    };
    EXPECT_TRUE(hasDate());
    Told told{{}, 2};  // while the package is unpacked
    dp::setProgressReport(provider, {&Told::report, &told, everyTime});
    for (const Call call : {Call::List, Call::Open}) {
        told.done.clear();
        EXPECT_EQ(run(provider, call), dp::kCancelled);
        EXPECT_TRUE(hasDate());
    }
    provider.CloseFile();
}

}  // namespace
