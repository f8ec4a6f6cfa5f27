#pragma once

namespace dp {

// The decimal symbol that the host has set for the whole process, '.' by default. Formats need it
// for rendering, but the setting belongs to the provider, in a layer above. This function is
// therefore declared here and defined beside the setting; formats see nothing else of the provider.
char inputDecimal() noexcept;

}  // namespace dp
