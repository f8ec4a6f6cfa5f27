#pragma once

namespace dp {

// The decimal symbol that the host has set for the whole process, '.' by default. Formats render
// with it although the setting belongs to the provider, two layers up: this one function, defined
// beside the setting, is the only way by which they see it.
char inputDecimal() noexcept;

}  // namespace dp
