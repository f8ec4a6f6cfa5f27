#include "tests/paths.h"

std::string casesFile(const std::string& name) { return DPXLSX_TEST_CASES "/" + name; }
std::string dataFile(const std::string& name) { return DPXLSX_TEST_DATA "/" + name; }
