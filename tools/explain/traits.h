#pragma once

#include <vector>

#include "tools/explain/format_traits.h"
#include "tools/explain/trait.h"

namespace dp::tool {

// The traits behind the findings, the most frequent in real workbooks first.
std::vector<Trait> traitsOf(const Findings& findings, const StyleAnswers& answers);

// The traits that inspectQuickly() finds.
std::vector<Trait> quickTraitsOf(const Findings& findings);

// The traits as they concern an import by the rules that were chosen: by the standard (`standard`)
// those are left out that it cures, otherwise their advice names the option.
std::vector<Trait> underRules(std::vector<Trait> traits, bool standard);

// The trait of a file whose import fails with this exit code for a reason that nothing else
// explains.
Trait unreadableTrait(const Findings& findings, int code);

}  // namespace dp::tool
