#pragma once

#include <set>
#include <string>

#include "tools/exit_code.h"
#include "tools/library.h"
#include "tools/options.h"
#include "tools/output.h"

namespace dp::tool {

// Says, trait by trait, what an import of the book does that its user may not expect. Throws a
// Failure for a book that cannot be reached.
void explain(const Library& library, const Options& options, Output& output);

// One line about an import that went well but for some of the worst traits; empty when it has none
// of them. `folder` is where the library has unpacked the open book, `leftOut` has the titles of
// worksheets that are not imported.
std::string importNote(const std::string& book, const std::string& folder,
                       const std::set<std::string>& leftOut);

// The failure of an import with the reason that a look into the book finds, if it finds one.
Failure explained(const Failure& failure, const std::string& book);

}  // namespace dp::tool
