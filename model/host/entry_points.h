#pragma once

#include "export.h"

// The exported functions, under their plain names: a host finds them by name after loading the
// library. A null name counts as the empty text.
namespace dp {

class IDataProvider;

// The result of OpenFile and GetWorksheets when the host ended them by its answer to a report of
// SetProgress.
inline constexpr long kCancelled = -20;

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

// Lets `provider` tell `report`, with `user`, how far an OpenFile or a GetWorksheets is: on the
// thread of the call, at its beginning, then about ten times a second, and when it has succeeded.
// `done` never falls; it is the share of the bytes that are unpacked and read, and 1 only in the
// last call. Columns that are loaded later are not reported. While the answer is 0 the work goes
// on; any other ends it with kCancelled, and an exception leaves OpenFile or GetWorksheets as it
// is. In both cases nothing is left on disk; worksheets read until then stay until ClearWorksheets.
// `report` may use other providers, but not this one. Holds from the next OpenFile or GetWorksheets
// on until it is called again; ClearWorksheets keeps it, and a null `report` switches it off.
// Returns 0; -50, and changes nothing, for a null provider and one that CreateDataProvider did not
// make; -1 without memory. Older libraries do not export it. Throws nothing.
DPXLSX_API long SetProgress(IDataProvider* provider, int (*report)(double done, void* user),
                            void* user);

}  // extern "C"

}  // namespace dp
