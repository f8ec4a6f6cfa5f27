#pragma once

#include <cstddef>
#include <cstdint>

// What a workbook may cost the machine while it is read. Every limit is far beyond what any program
// writes; a workbook that exceeds one is refused at once. docs/security.md explains the limits to
// users.
namespace dp {

// --- The parts, while they are read ---

// Depth of nested elements. libxml2 has this limit itself, but 2.9 stops one element later; the
// parts of a workbook nest about ten levels deep.
inline constexpr int kXmlDepth = 256;

// Bytes of the distinct names in a document, after which libxml2 may not allocate more memory for
// them. libxml2 2.9 has this limit itself, 2.15 has ten times as much.
inline constexpr std::size_t kXmlNames = 10'000'000;

// Bytes of one tag, comment, CDATA section or other markup, not counting what libxml2 reads ahead.
// An attribute may hold a list of thousands of cell ranges; but libxml2 compares every attribute of
// an element with every other, and copies a whole comment for every error in it.
inline constexpr std::size_t kMarkupSize = 256 << 10;
// Markup longer than this many bytes may have at most this many equal signs (one for each
// attribute) and hyphens beyond them. CDATA sections are text and may have any number.
inline constexpr std::size_t kLongMarkup = 16 << 10;
inline constexpr std::size_t kLongMarkupMarks = 4096;

// Bytes between two elements. libxml2 keeps all of them in memory at once, and takes twenty times
// their size for comments. A single text may have 10 MB, libxml2's own limit.
inline constexpr std::int64_t kRunSize = 12 << 20;

// Bytes of worksheet parts that may be read again, where each repetition counts as kLeastReading
// bytes at least. Worksheets normally have parts of their own, but any number of sheets may name
// the same part.
inline constexpr std::uint64_t kRepeatedReading = 64ULL << 20;
inline constexpr std::uint64_t kLeastReading = 4096;

// Bytes of the path in a relationship: the limit of the system's own paths. The path is resolved
// for every sheet that names the relationship.
inline constexpr std::size_t kTargetSize = 4096;

// Bytes of a number-format code; longer codes are ignored. Spreadsheet programs allow 255
// characters; every decimal place of a code is a character of each text rendered with it.
inline constexpr std::size_t kFormatCodeSize = 1024;

// Bytes of all number-format codes of a workbook that is read by the standard, where each counts as
// kLeastFormatCode bytes at least; further codes are ignored. Spreadsheet programs have at most
// 65,490 cell formats.
inline constexpr std::size_t kFormatCodes = 4 << 20;
inline constexpr std::size_t kLeastFormatCode = 64;

// Different number formats of its own in such a workbook; cells in further ones have no format. A
// column of texts keeps a formatter of ICU, some 55 KB, for each date format. Spreadsheet programs
// have about 250.
inline constexpr std::size_t kNumberFormats = 4096;

// --- The texts, while they are copied into the store ---

// Bytes copied per byte unpacked. A shared string counts for every cell that shows it: honest
// workbooks stay far below the limit, but a long string in many cells would fill the memory.
inline constexpr std::uint64_t kTextGrowth = 64;
// Bytes that are always allowed, so that small workbooks may repeat texts as often as they like.
inline constexpr std::uint64_t kTextAllowance = 64ULL << 20;

}  // namespace dp
