#include <unistd.h>

#include <algorithm>
#include <sys/stat.h>

#include "dpxlsx/model/host/entry_points.h"
#include "dpxlsx/model/host/reference.h"
#include "dpxlsx/provider/entry_name.h"
#include "dpxlsx/provider/temporary_directory.h"
#include "dpxlsx/provider/unpacking.h"
#include "dpxlsx/readers/xml/file_copy.h"
#include "dpxlsx/readers/xml/xml_reader.h"
#include "testkit/package_builder.h"
#include "testkit/recording_provider.h"
#include "tests/case_table.h"
#include "tests/temporary_files.h"

// Entry points, unpacking, and what is left on disk.
namespace {

namespace fs = boost::filesystem;
using Access = dp::IDataProvider::FileAccess;
using testkit::EnvironmentVariable;
using testkit::PackageBuilder;

const std::string kRow = "<row><c><v>1</v></c></row>";

TEST(EntryPoints, KnowTheirFiles) {
    for (const auto& c : caseTable("file_names.txt")) {
        EXPECT_EQ(dp::IsMicrosoftXLSXFile(c[1].c_str()), !c[2].empty()) << c[0];
        EXPECT_EQ(dp::GetDataProviderFiletype(c[1].c_str()), c[2]) << c[0];
    }
    EXPECT_FALSE(dp::IsMicrosoftXLSXFile(nullptr));
    EXPECT_STREQ(dp::GetDataProviderFiletype(nullptr), "");
}

TEST(EntryPoints, MakeProvidersOfTheirTypeOnly) {
    for (const char* type : {"XLSX", "xls", "", static_cast<const char*>(nullptr)}) {
        auto* provider = reinterpret_cast<dp::IDataProvider*>(&type);
        EXPECT_EQ(dp::CreateDataProvider(type, &provider), -22);
        EXPECT_EQ(provider, nullptr);
    }
    dp::IDataProvider* provider = nullptr;
    ASSERT_EQ(dp::CreateDataProvider("xlsx", &provider), 0);
    EXPECT_EQ(provider->AddRef(), 1U);
    provider->Release();
    EXPECT_EQ(dp::CreateDataProvider("xlsx", nullptr), -1);
}

TEST(EntryNames, StayInTheirDirectory) {
    for (const auto& c : caseTable("entries.txt")) {
        SCOPED_TRACE(c[0]);
        dp::EntryName entry;
        const bool sound = c[2] != "outside";
        EXPECT_EQ(dp::parseEntryName(c[1], entry), sound);
        if (sound) {
            EXPECT_EQ(entry.directory + "|" + entry.file, c[2] + "|" + c[3]);
        }
    }
}

class Opening : public TemporaryFiles {
  protected:
    long open(const std::string& path) { return provider.OpenFile(path.c_str(), Access::Read); }
    long openPackage(const PackageBuilder& package) {
        package.write(file("book.xlsx"));
        return open(file("book.xlsx"));
    }
    PackageBuilder sound() { return PackageBuilder::of({kRow}); }
    // Everything below the temporary directory, sorted.
    std::string unpacked() {
        std::vector<std::string> entries;
        for (fs::recursive_directory_iterator at(temporary()), end; at != end; ++at)
            entries.push_back(fs::relative(at->path(), provider.GetTempDirectoryPath()).string());
        std::sort(entries.begin(), entries.end());
        std::string text;
        for (const std::string& entry : entries) text += entry + " ";
        return text;
    }

    void TearDown() override {
        provider.CloseFile();
        TemporaryFiles::TearDown();
    }

    testkit::RecordingProvider provider;
};

TEST_F(Opening, AnswersResultCodes) {
    fs::create_directory(file("folder.xlsx"));
    write("text.xlsx", "no package");
    write("empty.xlsx", "");
    sound().write(file("report.xlsm"));
    sound().write(file("report"));
    fs::create_symlink(file("nowhere.xlsx"), file("dangling.xlsx"));
    const struct {
        const char* name;
        long result;
    } cases[] = {{"missing.xlsx", -17}, {"folder.xlsx", -17}, {"dangling.xlsx", -17}, {"report.xlsm", -22},
                 {"report", -22},       {"text.xlsx", -22},   {"empty.xlsx", -22}};
    std::vector<std::string> names;
    for (const auto& c : cases) {
        EXPECT_EQ(open(file(c.name)), c.result) << c.name;
        EXPECT_EQ(provider.GetWorksheets(file(c.name).c_str(), names), c.result) << c.name;
    }
    EXPECT_EQ(provider.OpenFile(nullptr, Access::Read), -17);
    provider.CloseFile();
    EXPECT_EQ(provider.OpenFile(file("text.xlsx").c_str(), Access::Write), -1);
    EXPECT_TRUE(fs::is_empty(temporary()));
}

TEST_F(Opening, UnpacksIntoAPrivateDirectoryThatGoesAgain) {
    for (const mode_t mask : {0U, 0777U}) {
        const mode_t before = ::umask(mask);
        const long result = openPackage(
            sound().add("docs/", "").add("docs/deep/er/a.txt", "a").add("xl/../C:/b:c", "b").add("xl/..", ""));
        ::umask(before);
        ASSERT_EQ(result, 0);
        EXPECT_EQ(fs::status(provider.GetTempDirectoryPath()).permissions(), fs::owner_all);
        for (const char* entry : {"book.xlsx", "docs", "docs/deep/er/a.txt", "xl/workbook.xml"}) {
            const fs::file_status status = fs::status(provider.GetTempDirectoryPath() + "/" + entry);
            EXPECT_EQ(status.permissions(), status.type() == fs::directory_file ? 0700 : 0600) << entry;
        }
    }
    const fs::path directory = provider.GetTempDirectoryPath();
    EXPECT_EQ(directory.parent_path(), temporary());
    EXPECT_EQ(unpacked(),
              ". C: C:/b:c book.xlsx docs docs/deep docs/deep/er docs/deep/er/a.txt xl xl/_rels "
              "xl/_rels/workbook.xml.rels xl/styles.xml xl/workbook.xml xl/worksheets "
              "xl/worksheets/sheet1.xml ");
    dp::ExternalDataRecordCell dated;
    dated.formatIndex = 12;  // of the short date
    EXPECT_TRUE(provider.IsDateTimeFormatType(dated));
    EXPECT_EQ(provider.CloseFile(), 0);
    EXPECT_FALSE(provider.IsDateTimeFormatType(dated)) << "the styles go with the file";
    EXPECT_FALSE(fs::exists(directory));
    EXPECT_EQ(provider.GetTempDirectoryPath(), "");
    EXPECT_EQ(provider.GetWorksheetPrimeKeys()->Count(), 2UL) << "the cells stay";
    dp::IColumn* column = nullptr;
    ASSERT_TRUE(provider.GetVariableFinder()->FindColumn(1, &column, false));
    EXPECT_TRUE(dp::Reference(column)->GetFormat()->GetAuto()) << "and load without the file";
}

TEST_F(Opening, ResolvesRelativeNames) {
    sound().write(file("BOOK.XLSX"));
    fs::current_path(files());
    const EnvironmentVariable relative("TMPDIR", "../tmp");
    EXPECT_EQ(open("BOOK.XLSX"), 0);
    EXPECT_EQ(fs::current_path(), files());
    const fs::path directory = provider.GetTempDirectoryPath();
    EXPECT_TRUE(directory.is_absolute());
    EXPECT_TRUE(fs::exists(directory / "BOOK.XLSX"));
    fs::current_path(workingDirectory());
    provider.CloseFile();
}

TEST_F(Opening, WritesNothingOutside) {
    const std::string longName(300, 'n');
    const struct {
        const char* name;
        PackageBuilder package;
        long result;
    } cases[] = {
        {"climbs out", sound().add("../escaped", "x"), -1},
        {"climbs out of a folder", sound().add("xl/../../escaped", "x"), -1},
        {"absolute", sound().add(file("escaped"), "x"), -1},
        {"named like the copy", sound().add("book.xlsx", "x"), -1},
        {"named like the copy, dotted", sound().add("./book.xlsx", "x"), -1},
        {"named like the copy, up and down", sound().add("xl/../book.xlsx", "x"), -1},
        {"directory where a file is wanted", sound().add("xl", "x"), -1},
        {"file where a directory is wanted", sound().add("xl/styles.xml/x", "x"), -1},
        {"directory entry of a file", sound().add("xl/styles.xml/", ""), 0},
        {"twice", sound().add("xl/worksheets/sheet1.xml", PackageBuilder::worksheet(kRow)), 0},
        {"equal once cut", sound().add(longName + "1", "x").add(longName + "2", "x"), 0},
        {"no name", sound().add("", "x"), 0},
        {"target in disguise",
         sound().set("xl/_rels/workbook.xml.rels", PackageBuilder::relationships(PackageBuilder::relation(
                                                       "r1", "worksheet", "..%2f..%2f..%2ffiles/secret.xml"))),
         13},
    };
    write("secret.xml", PackageBuilder::worksheet(kRow));
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        long result = 0;
        try {
            result = openPackage(c.package);
        } catch (const CmXmlException& e) {
            result = e.code();
        }
        EXPECT_EQ(result, c.result);
        provider.CloseFile();
        EXPECT_TRUE(fs::is_empty(temporary()));
        EXPECT_FALSE(fs::exists(file("escaped")) || fs::exists(temporary() / "escaped"));
    }
}

// Somebody else may have put links where entries go.
TEST_F(Opening, FollowsNoLinks) {
    sound().write(file("book.xlsx"));
    write("outside/styles.xml", "kept");
    const std::pair<const char*, std::string> links[] = {{"xl", "outside"}, {"xl/styles.xml", "outside/styles.xml"}};
    for (const auto& [link, target] : links) {
        const fs::path directory = files() / "unpacked";
        fs::create_directories((directory / link).parent_path());
        fs::create_symlink(file(target), directory / link);
        EXPECT_EQ(dp::unpackArchive(file("book.xlsx"), directory.string()), dp::PackageStatus::EntryError) << link;
        EXPECT_EQ(fs::file_size(file("outside/styles.xml")), 4U) << link;
        fs::remove_all(directory);
    }
    EXPECT_EQ(std::distance(fs::directory_iterator(files() / "outside"), fs::directory_iterator()), 1);
    dp::removeDirectoryAndContents(file("book.xlsx"));
    EXPECT_TRUE(fs::exists(file("book.xlsx"))) << "no directory";
}

TEST_F(Opening, CopiesForItsOwnerAndOverNothing) {
    fs::permissions(write("from", "new"), fs::owner_all | fs::group_read | fs::others_read);
    EXPECT_TRUE(dp::copyFile(file("from"), file("to")));
    EXPECT_EQ(fs::status(file("to")).permissions(), fs::owner_read | fs::owner_write);
    write("there", "kept by all means");
    EXPECT_FALSE(dp::copyFile(file("from"), file("there")));
    EXPECT_EQ(fs::file_size(file("there")), 17U);
}

// All that a host does with absolute paths, when the working directory has been removed, and when the temporary
// directory has a name that looks like an address.
TEST_F(Opening, NeedsNoWorkingDirectory) {
    sound().write(file("book.xlsx"));
    fs::create_directories(file("c:"));
    fs::copy_file(file("book.xlsx"), file("c:/book.xlsx"));
    const fs::path address = temporary() / "a:/b";
    fs::create_directories(address);
    const EnvironmentVariable likeAnAddress("TMPDIR", temporary().string() + "/a://b");
    fs::create_directory(file("gone"));
    fs::current_path(file("gone"));
    fs::remove(file("gone"));
    for (const std::string& book : {file("book.xlsx"), files().string() + "/c://book.xlsx", "/" + file("book.xlsx")}) {
        SCOPED_TRACE(book);
        std::vector<std::string> names;
        EXPECT_EQ(provider.GetWorksheets(book.c_str(), names), 0);
        EXPECT_EQ(names.size(), 1UL);
        EXPECT_TRUE(dp::IsMicrosoftXLSXFile(book.c_str()));
        EXPECT_EQ(open(book), 0);
        EXPECT_EQ(provider.GetTempDirectoryPath().find(temporary().string()), 0UL);
        EXPECT_EQ(provider.CloseFile(), 0);
        EXPECT_EQ(provider.taken(), "+S1 @0 0,0=1 @0");
        provider.ClearWorksheets();
    }
    EXPECT_EQ(open("//no-such-book.xlsx"), -17);
    EXPECT_THROW(open("book.xlsx"), fs::filesystem_error) << "a relative name has nothing to be relative to";
    const EnvironmentVariable relative("TMPDIR", ".");
    EXPECT_THROW(open(file("book.xlsx")), fs::filesystem_error);
    fs::current_path(workingDirectory());
    EXPECT_TRUE(fs::is_empty(address));
    fs::remove_all(temporary() / "a:");
}

TEST_F(Opening, CopiesAcrossFileSystems) {
    const fs::path other = fs::path("/dev/shm") / fs::unique_path("dpxlsx-%%%%-%%%%");
    boost::system::error_code error;
    if (!fs::create_directory(other, error)) GTEST_SKIP() << "no second file system to write to";
    sound().write(file("book.xlsx"));
    const EnvironmentVariable elsewhere("TMPDIR", other.string());
    EXPECT_EQ(open(file("book.xlsx")), 0);
    provider.CloseFile();
    EXPECT_TRUE(fs::remove(other)) << "and nothing is left in it";
}

TEST_F(Opening, ChecksEveryEntry) {
    sound().add("docs/a.txt", std::string(5000, 'a')).write(file("book.xlsx"));
    std::string bytes = content("book.xlsx");
    const auto at = bytes.find("docs/a.txt");
    ASSERT_NE(at, bytes.npos);
    bytes[at + 10 + 4] = static_cast<char>(bytes[at + 10 + 4] ^ 0x55);
    write("broken.xlsx", bytes);
    EXPECT_EQ(open(file("broken.xlsx")), -1);
    EXPECT_NE(provider.GetTempDirectoryPath(), "") << "left until the next step";
    EXPECT_EQ(openPackage(sound()), 0) << "which opening is";
    provider.CloseFile();
}

TEST_F(Opening, NeedsAWholeEndRecord) {
    sound().write(file("book.xlsx"));
    const std::string bytes = content("book.xlsx");
    for (std::size_t missing = 1; missing <= 22; ++missing) {
        write("cut.xlsx", bytes.substr(0, bytes.size() - missing));
        EXPECT_EQ(open(file("cut.xlsx")), -22) << missing;
    }
}

TEST_F(Opening, StaysUsableAfterFailures) {
    EXPECT_THROW(openPackage(PackageBuilder::of({kRow, "<row>"})), CmXmlException);
    EXPECT_NE(provider.taken(), "");
    EXPECT_EQ(provider.CloseFile(), 0);
    provider.ClearWorksheets();
    EXPECT_EQ(openPackage(sound()), 0);
    EXPECT_EQ(provider.taken(), "+S1 @0 0,0=1 @0");
    // Without clearing, the next workbook's worksheets are appended, except its empty ones.
    EXPECT_EQ(openPackage(PackageBuilder::of({"", kRow, kRow})), 0);
    EXPECT_EQ(provider.taken(), "+S1 @1 +S2 @2 0,0=1 +S3 @3 0,0=1 -1 @0");
    EXPECT_EQ(provider.GetWorksheetPrimeKeys()->Count(), 3UL);
    EXPECT_EQ(provider.GetWorksheetRowCount(1), 1U);
}

}  // namespace
