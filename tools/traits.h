#pragma once

#include <map>
#include <string>
#include <vector>

#include "tools/findings.h"
#include "tools/style_probe.h"

namespace dp::tool {

// A trait of a file that an import reads otherwise than a spreadsheet program shows it.
struct Trait {
    std::string key;        // for programs, such as "iso-dates"
    std::string found;      // what was found, and where
    std::string effect;     // what the import does with it
    std::string advice;     // what the user can do
    bool fatal = false;     // the import fails
    std::string note = {};  // one of the worst: the effect in words that stand alone
};

// The traits behind the findings, the most frequent in real workbooks first.
std::vector<Trait> traitsOf(const Findings& findings,
                            const std::map<int, StyleAnswer>& styleAnswers);

// Those that a quick look finds.
std::vector<Trait> quickTraitsOf(const Findings& findings);

// The trait of a file whose import fails with this exit code for a reason that nothing else
// explains.
Trait unreadableTrait(const Findings& findings, int code);

}  // namespace dp::tool
