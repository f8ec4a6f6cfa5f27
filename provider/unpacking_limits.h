#pragma once

#include <cstdint>

// What a package may cost the machine while it is unpacked. Every limit is far beyond what any
// program writes; a package that exceeds one is refused at once. docs/security.md explains them to
// users.
namespace dp {

// Entries. A workbook of 10,000 worksheets, each with drawings, comments and their relationships,
// has 60,000; each costs the file system a file, however few bytes it holds.
inline constexpr std::uint64_t kPackageEntries = 250'000;

// Bytes unpacked per byte of the package. Single parts of honest workbooks reach 121, whole
// packages stay far below; deflate cannot exceed 1,032, overlapping entries can.
inline constexpr std::uint64_t kUnpackedGrowth = 200;
// Unpacked bytes that are always allowed: every machine can spare them for a moment.
inline constexpr std::uint64_t kUnpackedAllowance = 256ULL << 20;

// The share of the temporary directory's free space that is left to other processes, as a divisor.
inline constexpr std::uint64_t kSpareSpaceDivisor = 16;
// Bytes written between two checks of the free space, which other processes use too.
inline constexpr std::uint64_t kSpaceCheckInterval = 16ULL << 20;

}  // namespace dp
