#pragma once

#include "export.h"

// The exported functions, under their plain names: a host finds them by name after loading the
// library. A null name counts as the empty text.
namespace dp {

class IDataProvider;

extern "C" {

// "xlsx" when IsMicrosoftXLSXFile is true of the name, else the empty text; never null. The text
// belongs to the library, is shared by all calls of a thread and valid until the next one.
DPXLSX_API const char* GetDataProviderFiletype(const char* fileName);

// True when the last element of the path has the extension ".xlsx" in any letter case. The file
// itself is not looked at and need not exist.
DPXLSX_API bool IsMicrosoftXLSXFile(const char* fileName);

// Makes a provider for the type "xlsx" (exactly so written) with a reference count of 0: the caller
// takes the first reference. Returns 0, -22 for another type name, -1 when it cannot be made or
// `provider` is null; `*provider` is null unless the result is 0. Throws nothing.
DPXLSX_API long CreateDataProvider(const char* typeName, IDataProvider** provider);

// Chooses by which rules `provider` reads workbooks: 0, the default rules, in force until this is
// called; 1, the standard ISO/IEC 29500 as spreadsheet programs practise it. Holds from the next
// OpenFile or GetWorksheets on until it is called again; ClearWorksheets keeps it. Returns 0, or
// -50, and changes nothing, for another number, a null provider and one that CreateDataProvider did
// not make. Older libraries do not export it. Throws nothing.
DPXLSX_API long SetReadingRules(IDataProvider* provider, int rules);

}  // extern "C"

}  // namespace dp
