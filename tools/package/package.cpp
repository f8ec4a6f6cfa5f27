#include "tools/package/package.h"

namespace dp::tool {

namespace {

// A workbook has some dozens of entries. Larger archives are not listed, which would only fill the
// memory.
constexpr size_t kMostEntries = 100000;

std::string folded(const std::string& name) {
    std::string result;
    for (const char c : name) {
        if (c == '\\') {
            result += '/';
        } else {
            result += c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
        }
    }
    return result.erase(0, result.find_first_not_of('/'));
}

}  // namespace

Package::Package(const std::string& path) : archive_(unzOpen64(path.c_str())) {
    if (isOpen()) list();
}

Package::~Package() {
    if (isOpen()) unzClose(archive_);
}

std::string Package::similarTo(const std::string& name) const {
    const auto found = byFoldedName_.find(folded(name));
    return found == byFoldedName_.end() ? std::string() : found->second;
}

void Package::list() {
    char name[256] = {};
    for (int result = unzGoToFirstFile(archive_);
         result == UNZ_OK && entries_.size() < kMostEntries; result = unzGoToNextFile(archive_)) {
        unz64_file_pos position = {};
        const bool known = unzGetCurrentFileInfo64(archive_, nullptr, name, sizeof name - 1,
                                                   nullptr, 0, nullptr, 0) == UNZ_OK &&
                           unzGetFilePos64(archive_, &position) == UNZ_OK;
        if (!known) return;
        entries_[name] = position;
        byFoldedName_[folded(name)] = name;
    }
}

Entry::Entry(Package& package, const std::string& name) : archive_(package.archive_) {
    const auto found = package.entries_.find(name);
    if (found == package.entries_.end()) return;
    open_ = unzGoToFilePos64(archive_, &found->second) == UNZ_OK &&
            unzOpenCurrentFile(archive_) == UNZ_OK;
}

Entry::~Entry() {
    if (open_) unzCloseCurrentFile(archive_);
}

int Entry::read(char* buffer, unsigned size) {
    return open_ ? unzReadCurrentFile(archive_, buffer, size) : UNZ_INTERNALERROR;
}

}  // namespace dp::tool
