#include "tools/options/similar_option.h"

#include <algorithm>
#include <numeric>
#include <vector>

#include "tools/options/option_table.h"

namespace dp::tool {

namespace {

// Letters to insert, delete or replace to make one text of the other.
size_t distance(std::string_view from, std::string_view to) {
    std::vector<size_t> row(to.size() + 1);
    std::iota(row.begin(), row.end(), size_t{0});
    for (size_t i = 0; i < from.size(); ++i) {
        size_t diagonal = row[0]++;
        for (size_t j = 0; j < to.size(); ++j) {
            const size_t replaced = diagonal + (from[i] == to[j] ? 0 : 1);
            diagonal = row[j + 1];
            row[j + 1] = std::min({replaced, diagonal + 1, row[j] + 1});
        }
    }
    return row.back();
}

}  // namespace

std::string similarOption(std::string_view word) {
    constexpr size_t kMostTypos = 2;
    word = word.substr(0, word.find('='));
    const bool longer = word.starts_with("--") && word.size() > 3;
    std::string best;
    size_t fewest = kMostTypos + 1;
    for (const OptionGroup& group : optionGroups()) {
        for (const OptionRow& row : group.rows) {
            const std::string_view names = row.names;
            const std::string_view name = names.substr(names.rfind(' ') + 1);  // the long one
            const size_t typos = longer && name.starts_with(word) ? 0 : distance(word, name);
            if (typos >= fewest) continue;
            fewest = typos;
            best = name;
        }
    }
    return longer ? best : std::string();
}

}  // namespace dp::tool
