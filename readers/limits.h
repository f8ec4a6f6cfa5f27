#pragma once

#include <cstdint>

// What a workbook may do to the machine. Every limit is far beyond what any program writes; what
// trips one is refused at once. docs/security.md explains them to users.
namespace dp {

// --- The texts, while they are copied into the store ---

// Bytes copied per byte unpacked. One shared string is stored for every cell that shows it: an
// honest workbook stays far below, one of a long string and many cells would fill the memory.
inline constexpr std::uint64_t kTextGrowth = 64;
// Bytes that count for nothing in that, so that small workbooks may repeat what they like.
inline constexpr std::uint64_t kTextAllowance = 64ULL << 20;

}  // namespace dp
