#pragma once

#include <string>
#include <utility>
#include <vector>

namespace testkit {

// Builds .xlsx packages from literal parts. Parts that a case does not give are valid.
struct PackageBuilder {
    using Part = std::pair<std::string, std::string>;

    // A package with worksheets S1, S2 ..., whose sheetData elements have these contents.
    static PackageBuilder of(const std::vector<std::string>& sheets);
    // A small package of two worksheets, with shared strings and styles.
    static const PackageBuilder& small();

    static std::string worksheet(const std::string& data);
    static std::string workbook(const std::string& sheets);
    static std::string relationships(const std::string& list);
    static std::string relation(const std::string& id, const std::string& type,
                                const std::string& target);

    // Adds a part or replaces the one of that name; empty content removes it.
    PackageBuilder& set(const std::string& name, const std::string& content);
    // Adds an entry, even if there is one of that name.
    PackageBuilder& add(const std::string& name, const std::string& content);

    // The package as the bytes of a file.
    std::string bytes() const;
    void write(const std::string& path) const;
    // Writes each part as a file of its own, as unpacking does.
    void unpackTo(const std::string& directory) const;

    std::vector<Part> parts;
};

}  // namespace testkit
