#pragma once

#include <map>
#include <string>

#include <minizip/unzip.h>

namespace dp::tool {

// The parts of a workbook's package, by the names that programs give them.
inline constexpr const char* kWorkbook = "xl/workbook.xml";
inline constexpr const char* kStyles = "xl/styles.xml";
inline constexpr const char* kStrings = "xl/sharedStrings.xml";

// The entries of a ZIP archive, read one at a time; nothing is unpacked to disk. Names are cut to
// 255 bytes; of several entries with one name the last counts.
class Package {
  public:
    explicit Package(const std::string& path);
    ~Package();
    Package(const Package&) = delete;
    Package& operator=(const Package&) = delete;

    // Whether the file is a ZIP archive at all. A package that is not open has no entries.
    bool isOpen() const { return archive_ != nullptr; }
    bool has(const std::string& name) const { return entries_.count(name) != 0; }
    // The name of an entry that equals `name` but for letter case and the direction of slashes;
    // empty when there is none.
    std::string similarTo(const std::string& name) const;

  private:
    friend class Entry;

    void list();

    unzFile archive_;
    std::map<std::string, unz64_file_pos> entries_;
    std::map<std::string, std::string> byFoldedName_;
};

// An entry that is being read. Only one for a package may exist at a time.
class Entry {
  public:
    Entry(Package& package, const std::string& name);
    ~Entry();
    Entry(const Entry&) = delete;
    Entry& operator=(const Entry&) = delete;

    // The number of bytes read, 0 at the end, negative when there is no such entry or it is
    // damaged.
    int read(char* buffer, unsigned size);

  private:
    unzFile archive_;
    bool open_ = false;
};

}  // namespace dp::tool
