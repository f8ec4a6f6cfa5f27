#pragma once

#include <set>
#include <string>
#include <vector>

#include <nlohmann/json_fwd.hpp>

#include "tools/explain/trait.h"
#include "tools/host/exit_code.h"
#include "tools/host/library.h"
#include "tools/options/options.h"
#include "tools/views/output.h"

namespace dp::tool {

// What an import of the book does that its user may not expect. Imports the book. Throws a Failure
// when the file cannot be read at all.
std::vector<Trait> findTraits(const Library& library, const Options& options);

// The traits as --explain writes them with --json.
nlohmann::ordered_json explanationJson(const std::string& book, const std::vector<Trait>& traits);

// Writes, trait by trait, what an import of the book does that its user may not expect. Throws a
// Failure when the file cannot be read at all.
void explain(const Library& library, const Options& options, Output& output);

// One line about the worst traits of a book that was imported without failure; empty when it has
// none of them. `folder` is the directory into which the library has unpacked the open book,
// `leftOut` the titles of worksheets that are not imported.
std::string importNote(const Options& options, const std::string& folder,
                       const std::set<std::string>& leftOut);

// The failure of an import, with the reason that an inspection of the book finds, if any.
Failure explained(const Failure& failure, const Options& options);

}  // namespace dp::tool
