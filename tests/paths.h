#pragma once

#include <string>

// The path of a table of test cases, or of a workbook, by its file name. Only the source of these
// functions is compiled with paths of this machine: a compiler cache knows all others in every clone.
std::string casesFile(const std::string& name);
std::string dataFile(const std::string& name);
