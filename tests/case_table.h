#pragma once

#include <cstddef>
#include <fstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "tests/paths.h"

// The rows of a table of cases in tests/cases: columns between bars, the first one the case's name.
// Lines that begin with a hash are comments; \n, \r, \t, \0, \xNN and \\ stand for the characters.
inline std::vector<std::vector<std::string>> caseTable(const std::string& name) {
    std::vector<std::vector<std::string>> rows;
    std::ifstream file(casesFile(name));
    for (std::string line; std::getline(file, line);) {
        if (line.empty() || line[0] == '#') continue;
        rows.emplace_back(1);
        for (std::size_t i = 0; i < line.size(); ++i) {
            std::string& cell = rows.back().back();
            if (line.compare(i, 3, " | ") == 0) {
                rows.back().emplace_back();
                i += 2;
            } else if (line[i] == '\\' && i + 1 < line.size()) {
                const char next = line[++i];
                if (next == 'x') {
                    cell += static_cast<char>(std::stoi(line.substr(i + 1, 2), nullptr, 16));
                    i += 2;
                    continue;
                }
                cell += next == 'n' ? '\n' : next == 'r' ? '\r' : next == 't' ? '\t' : next == '0' ? '\0' : next;
            } else {
                cell += line[i];
            }
        }
        if (line.ends_with(" |")) rows.back().back().resize(rows.back().back().size() - 2);
        if (line.ends_with(" |")) rows.back().emplace_back();
    }
    EXPECT_FALSE(rows.empty()) << name;
    return rows;
}
