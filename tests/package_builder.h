#pragma once

#include <cstdlib>
#include <string>
#include <utility>
#include <vector>

#include <minizip/zip.h>

// Builds .xlsx packages from literal parts. Parts that a case does not give are valid.
struct PackageBuilder {
    using Part = std::pair<std::string, std::string>;

    // A package with worksheets S1, S2 ..., whose sheetData elements have these contents.
    static PackageBuilder of(const std::vector<std::string>& sheets) {
        PackageBuilder package;
        std::string list;
        std::string relations;
        for (std::size_t i = 1; i <= sheets.size(); ++i) {
            const std::string n = std::to_string(i);
            list += "<sheet name='S" + n + "' sheetId='" + n + "' r:id='r" + n + "'/>";
            relations += relation("r" + n, "worksheet", "worksheets/sheet" + n + ".xml");
            package.set("xl/worksheets/sheet" + n + ".xml", worksheet(sheets[i - 1]));
        }
        package.set("xl/workbook.xml", workbook(list));
        package.set("xl/_rels/workbook.xml.rels", relationships(relations));
        package.set("xl/styles.xml",
                    "<styleSheet><cellXfs count='1'><xf numFmtId='0'/></cellXfs>"
                    "</styleSheet>");
        return package;
    }

    static std::string worksheet(const std::string& data) {
        return "<worksheet><sheetData>" + data + "</sheetData></worksheet>";
    }
    static std::string workbook(const std::string& sheets) {
        return "<workbook xmlns:r='r'><bookViews/><sheets>" + sheets + "</sheets></workbook>";
    }
    static std::string relationships(const std::string& list) { return "<Relationships>" + list + "</Relationships>"; }
    static std::string relation(const std::string& id, const std::string& type, const std::string& target) {
        return "<Relationship Id='" + id + "' Type='http://x/relationships/" + type + "' Target='" + target + "'/>";
    }

    // Adds a part or replaces the one of that name; empty content removes it.
    PackageBuilder& set(const std::string& name, const std::string& content) {
        std::erase_if(parts, [&](const Part& part) { return part.first == name; });
        if (!content.empty()) parts.emplace_back(name, content);
        return *this;
    }
    // Adds an entry, even if there is one of that name.
    PackageBuilder& add(const std::string& name, const std::string& content) {
        parts.emplace_back(name, content);
        return *this;
    }

    void write(const std::string& path) const {
        const zipFile zip = zipOpen64(path.c_str(), APPEND_STATUS_CREATE);
        for (const auto& [name, content] : parts) {
            zip_fileinfo info{};
            zipOpenNewFileInZip(zip, name.c_str(), &info, nullptr, 0, nullptr, 0, nullptr, Z_DEFLATED, Z_BEST_SPEED);
            zipWriteInFileInZip(zip, content.data(), static_cast<unsigned>(content.size()));
            zipCloseFileInZip(zip);
        }
        if (zipClose(zip, nullptr) != ZIP_OK) std::abort();
    }

    std::vector<Part> parts;
};
