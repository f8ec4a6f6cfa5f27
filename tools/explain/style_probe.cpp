#include "tools/explain/style_probe.h"

#include <array>
#include <cstdlib>
#include <filesystem>
#include <system_error>
#include <vector>

#include <dpxlsx/model/host/i_finders.h>
#include <dpxlsx/model/host/reference.h>
#include <minizip/zip.h>

#include "tools/host/column.h"
#include "tools/host/interrupt.h"
#include "tools/options/column_reference.h"
#include "tools/options/settings.h"
#include "tools/package/package.h"

namespace dp::tool {

namespace {

namespace fs = std::filesystem;

constexpr size_t kMostColumns = 16384;
constexpr size_t kLargestStyleSheet = 64 << 20;  // bytes

constexpr const char* kProbeWorkbook =
    "<workbook xmlns=\"http://schemas.openxmlformats.org/spreadsheetml/2006/main\" "
    "xmlns:r=\"http://schemas.openxmlformats.org/officeDocument/2006/relationships\">"
    "<bookViews/><sheets><sheet name=\"Styles\" sheetId=\"1\" r:id=\"a\"/></sheets></workbook>";
constexpr const char* kProbeRelationships =
    "<Relationships xmlns=\"http://schemas.openxmlformats.org/package/2006/relationships\">"
    "<Relationship Id=\"a\" Type=\"http://schemas.openxmlformats.org/officeDocument/2006/"
    "relationships/worksheet\" Target=\"worksheets/sheet1.xml\"/></Relationships>";

class TemporaryFolder {
  public:
    TemporaryFolder() {
        std::error_code error;
        std::string name = (fs::temp_directory_path(error) / "dpxlsx-XXXXXX").string();
        if (!error && mkdtemp(name.data()) != nullptr) path_ = name;
    }
    ~TemporaryFolder() {
        std::error_code ignored;
        if (!path_.empty()) fs::remove_all(path_, ignored);
    }
    TemporaryFolder(const TemporaryFolder&) = delete;
    TemporaryFolder& operator=(const TemporaryFolder&) = delete;

    // Empty when the directory could not be made.
    const std::string& path() const { return path_; }

  private:
    std::string path_;
};

// A ZIP archive that is written entry by entry.
class Archive {
  public:
    explicit Archive(const std::string& path)
        : archive_(zipOpen64(path.c_str(), APPEND_STATUS_CREATE)), good_(archive_ != nullptr) {}
    ~Archive() { close(); }
    Archive(const Archive&) = delete;
    Archive& operator=(const Archive&) = delete;

    void begin(const char* name) {
        constexpr int kFastest = 1;
        good_ = good_ && zipOpenNewFileInZip(archive_, name, nullptr, nullptr, 0, nullptr, 0,
                                             nullptr, Z_DEFLATED, kFastest) == ZIP_OK;
    }
    void write(const char* bytes, size_t size) {
        good_ =
            good_ && zipWriteInFileInZip(archive_, bytes, static_cast<unsigned>(size)) == ZIP_OK;
    }
    void add(const char* name, const std::string& content) {
        begin(name);
        write(content.data(), content.size());
    }
    // Whether all of it has been written.
    bool close() {
        if (archive_ != nullptr && zipClose(archive_, nullptr) != ZIP_OK) good_ = false;
        archive_ = nullptr;
        return good_;
    }

  private:
    zipFile archive_;
    bool good_;
};

// One number per style, side by side.
std::string worksheetOf(const std::vector<int>& styles) {
    std::string text =
        "<worksheet xmlns=\"http://schemas.openxmlformats.org/spreadsheetml/2006/main\">"
        "<sheetData><row r=\"1\">";
    for (size_t i = 0; i < styles.size(); ++i) {
        const bool isNone = styles[i] == StyledColumn::kNone;
        text += "<c r=\"" + columnLetters(static_cast<unsigned>(i + 1)) + "1\"" +
                (isNone ? "" : " s=\"" + std::to_string(styles[i]) + "\"") + "><v>45000.5</v></c>";
    }
    return text + "</row></sheetData></worksheet>";
}

bool copyStyles(const std::string& book, Archive& archive) {
    Package package(book);
    Entry entry(package, package.has(kStyles) ? kStyles : package.similarTo(kStyles));
    std::array<char, 1 << 14> buffer;
    archive.begin(kStyles);
    size_t size = 0;
    int count = 0;
    while ((count = entry.read(buffer.data(), buffer.size())) > 0) {
        stopIfInterrupted();
        size += static_cast<size_t>(count);
        if (size > kLargestStyleSheet) return false;
        archive.write(buffer.data(), static_cast<size_t>(count));
    }
    return count == 0;
}

bool makeProbe(const std::string& path, const std::string& book, const std::vector<int>& styles) {
    Archive archive(path);
    archive.add(kWorkbook, kProbeWorkbook);
    archive.add("xl/_rels/workbook.xml.rels", kProbeRelationships);
    archive.add("xl/worksheets/sheet1.xml", worksheetOf(styles));
    return copyStyles(book, archive) && archive.close();
}

// The answers for the columns of the open probe, in their order.
std::vector<StyleAnswer> readAnswers(IDataProvider& provider) {
    std::vector<StyleAnswer> answers;
    for (const SheetEntry& sheet : listSheets(provider)) {
        const IVariableFinder& finder = *provider.GetVariableFinder();
        const IReadOnlyCollection<int>& keys = *finder.GetColumnPrimeKeys(sheet.key);
        for (unsigned long i = 0; i < keys.Count(); ++i) {
            IColumn* found = nullptr;
            if (!finder.FindColumn(keys.Item(i), &found, true)) continue;
            const Column column(found, kDefaultMissing, false);
            answers.push_back({column.kind() == Kind::DateTime, !column.pattern().empty()});
        }
    }
    return answers;
}

std::vector<StyleAnswer> importProbe(const Library& library, const std::string& path,
                                     bool standard) {
    const Reference<IDataProvider> provider(library.createProvider("xlsx"));
    if (standard) library.readByStandard(*provider);
    std::vector<StyleAnswer> answers;
    provider->SetReadOptionDefaultUseVariableNameRow(VNR_NONE);
    try {
        if (provider->OpenFile(path.c_str(), IDataProvider::FileAccess::Read) == 0) {
            answers = readAnswers(*provider);
        }
    } catch (...) {
        answers.clear();  // the import of the book itself fails on such a style sheet too
    }
    provider->CloseFile();
    return answers;
}

}  // namespace

std::map<int, StyleAnswer> askForStyles(const Library& library, const std::string& book,
                                        const std::map<int, UsedFormat>& formats, bool standard) {
    std::vector<int> styles;
    for (const auto& [style, format] : formats) {
        if (styles.size() < kMostColumns) styles.push_back(style);
    }
    std::map<int, StyleAnswer> result;
    const TemporaryFolder folder;
    const std::string probe = folder.path() + "/styles.xlsx";
    if (styles.empty() || folder.path().empty() || !makeProbe(probe, book, styles)) return result;
    const std::vector<StyleAnswer> answers = importProbe(library, probe, standard);
    if (answers.size() != styles.size()) return result;
    for (size_t i = 0; i < styles.size(); ++i) result.emplace(styles[i], answers[i]);
    return result;
}

}  // namespace dp::tool
