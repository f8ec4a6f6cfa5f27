#pragma once

#include "model/host/export.h"

// The exported functions, under their plain names: a host finds them by name after loading the
// library.
namespace dp {

class IDataProvider;

extern "C" {

// "xlsx" when the name is that of a workbook, else the empty text. The text is shared by all calls
// of the process and valid until the next one.
DPXLSX_API const char* GetDataProviderFiletype(const char* fileName);

// True when the name ends in ".xlsx" in any letter case. The file itself is not looked at.
DPXLSX_API bool IsMicrosoftXLSXFile(const char* fileName);

// Makes a provider for the type "xlsx" (exactly so written) with a reference count of 0.
// Returns 0, -22 for another type name, -1 when it cannot be made or `provider` is null. *provider
// is null unless the result is 0.
DPXLSX_API long CreateDataProvider(const char* typeName, IDataProvider** provider);

}  // extern "C"

}  // namespace dp
