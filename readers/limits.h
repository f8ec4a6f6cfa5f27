#pragma once

#include <cstddef>
#include <cstdint>

// What a workbook may do to the machine. Every limit is far beyond what any program writes; what
// trips one is refused at once. docs/security.md explains them to users.
namespace dp {

// --- The package, while it is unpacked ---

// Entries. A workbook of 10,000 worksheets, each with drawings, comments and their relationships,
// has 60,000; each costs the file system a file, however few bytes it holds.
inline constexpr std::uint64_t kPackageEntries = 250'000;

// Bytes unpacked per byte of the package. Single parts of honest workbooks reach 121, whole
// packages stay far below; deflate cannot exceed 1,032, overlapping entries can.
inline constexpr std::uint64_t kUnpackedGrowth = 200;
// Bytes that count for nothing in that: what every machine can spare for a moment.
inline constexpr std::uint64_t kUnpackedAllowance = 256ULL << 20;

// The part of the temporary directory's free space that is left to others, as a divisor.
inline constexpr std::uint64_t kSpareSpaceDivisor = 16;
// Bytes written between two looks at the free space, which others use too.
inline constexpr std::uint64_t kSpaceCheckInterval = 16ULL << 20;

// --- The parts, while they are read ---

// Elements one in the other. libxml2 has this limit itself, but 2.9 stops one element later; parts
// nest about ten.
inline constexpr int kXmlDepth = 256;

// Bytes of the different names in a document, beyond which libxml2 takes no new pool for them. It
// stops there itself in 2.9, and in 2.15 only at ten times as many.
inline constexpr std::size_t kXmlNames = 10'000'000;

// Bytes of one tag, comment, CDATA section or other markup, beside what libxml2 reads ahead. Lists
// of thousands of cell ranges stand in one attribute; but libxml2 compares every attribute of an
// element with every other, and copies a whole comment for every error in it.
inline constexpr std::size_t kMarkupSize = 256 << 10;
// Bytes from which markup is looked at more closely, and how many attributes or hyphens it may have
// then. CDATA sections are text and hold any number, as far as the encoding lets us tell them
// apart.
inline constexpr std::size_t kLongMarkup = 16 << 10;
inline constexpr std::size_t kLongMarkupMarks = 4096;

// Bytes without an element among them, which libxml2 keeps all at once and comments twentyfold. It
// allows texts of 10 MB.
inline constexpr std::int64_t kRunSize = 12 << 20;

// Bytes read of worksheet parts that were read before, each time as many as a page of memory at
// least: every worksheet has a part of its own, but any number of sheets may name the same one.
inline constexpr std::uint64_t kRepeatedReading = 64ULL << 20;
inline constexpr std::uint64_t kLeastReading = 4096;

// Bytes of the path in a relationship, as long as the system's own may be. Every sheet that names
// the relationship resolves it.
inline constexpr std::size_t kTargetSize = 4096;

// Bytes of a number-format code. Spreadsheet programs allow 255 characters; every decimal of a code
// is one of each text that is rendered with it.
inline constexpr std::size_t kFormatCodeSize = 1024;

// --- The texts, while they are copied into the store ---

// Bytes copied per byte unpacked. One shared string is stored for every cell that shows it: an
// honest workbook stays far below, one of a long string and many cells would fill the memory.
inline constexpr std::uint64_t kTextGrowth = 64;
// Bytes that count for nothing in that, so that small workbooks may repeat what they like.
inline constexpr std::uint64_t kTextAllowance = 64ULL << 20;

}  // namespace dp
