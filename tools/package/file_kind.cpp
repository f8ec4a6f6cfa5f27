#include "tools/package/file_kind.h"

#include <algorithm>
#include <array>
#include <cctype>
#include <fstream>
#include <string_view>

#include "tools/host/exit_code.h"
#include "tools/host/interrupt.h"

namespace dp::tool {

namespace {

constexpr std::string_view kZipMark = "PK\x03\x04";
constexpr std::string_view kCompoundMark = "\xD0\xCF\x11\xE0\xA1\xB1\x1A\xE1";

bool contains(std::string_view text, std::string_view part) {
    return text.find(part) != std::string_view::npos;
}

// The directory entries of a compound file have 128 bytes and lie at multiples of 128: the name in
// UTF-16, its length in bytes including the final zero, and the entry's type.
constexpr size_t kDirectoryEntry = 128;

bool namesStream(std::string_view entry, std::string_view name) {
    constexpr size_t kLengthAt = 0x40;
    constexpr size_t kTypeAt = 0x42;
    constexpr char kStream = 2;
    const size_t length = 2 * (name.size() + 1);
    if (static_cast<size_t>(static_cast<unsigned char>(entry[kLengthAt])) != length ||
        entry[kLengthAt + 1] != 0 || entry[kTypeAt] != kStream) {
        return false;
    }
    for (size_t i = 0; i < name.size(); ++i) {
        if (entry[2 * i] != name[i] || entry[2 * i + 1] != 0) return false;
    }
    return true;
}

// Checks every place where the directory may have an entry instead of following chains of sectors,
// which a damaged file may have wrong.
FileKind compoundKind(std::ifstream& file) {
    std::array<char, 512 * kDirectoryEntry> block;
    file.clear();
    file.seekg(0);
    while (file.read(block.data(), block.size()), file.gcount() > 0) {
        stopIfInterrupted();
        const std::string_view bytes(block.data(), static_cast<size_t>(file.gcount()));
        for (size_t at = 0; at + kDirectoryEntry <= bytes.size(); at += kDirectoryEntry) {
            const std::string_view entry = bytes.substr(at, kDirectoryEntry);
            if (namesStream(entry, "EncryptedPackage")) return FileKind::PasswordProtected;
            if (namesStream(entry, "Workbook") || namesStream(entry, "Book")) {
                return FileKind::OldWorkbook;
            }
        }
    }
    return FileKind::OtherCompound;
}

FileKind textKind(std::string_view beginning) {
    std::string text(beginning);
    std::transform(text.begin(), text.end(), text.begin(),
                   [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
    if (contains(text, "urn:schemas-microsoft-com:office:spreadsheet")) {
        return FileKind::Spreadsheet2003;
    }
    if (contains(text, "<html") || contains(text, "<table")) return FileKind::WebPage;
    // UTF-16 text has zero bytes, but begins with a byte order mark.
    const bool wide = text.starts_with("\xFF\xFE") || text.starts_with("\xFE\xFF");
    return wide || !contains(text, std::string_view("\0", 1)) ? FileKind::PlainText
                                                              : FileKind::Unknown;
}

FileKind archiveKind(const Package& package) {
    struct Sign {
        const char* entry;
        FileKind kind;
    };
    constexpr Sign kSigns[] = {
        {kWorkbook, FileKind::Workbook},
        {"xl/workbook.bin", FileKind::BinaryWorkbook},
        {"word/document.xml", FileKind::TextDocument},
        {"ppt/presentation.xml", FileKind::Presentation},
        {"content.xml", FileKind::OpenDocument},
        {"_rels/.rels", FileKind::Workbook},  // its workbook part may have another name
    };
    for (const Sign& sign : kSigns) {
        if (!package.similarTo(sign.entry).empty()) return sign.kind;
    }
    return FileKind::OtherArchive;
}

}  // namespace

FileKind fileKind(const std::string& path, const Package& package) {
    if (package.isOpen()) return archiveKind(package);
    std::ifstream file(path, std::ios::binary);
    if (!file) throw readFailure(path, -18);
    std::array<char, 4096> buffer;
    file.read(buffer.data(), buffer.size());
    const std::string_view beginning(buffer.data(), static_cast<size_t>(file.gcount()));
    if (beginning.empty()) return FileKind::Empty;
    if (beginning.starts_with(kZipMark)) return FileKind::CutPackage;
    return beginning.starts_with(kCompoundMark) ? compoundKind(file) : textKind(beginning);
}

}  // namespace dp::tool
