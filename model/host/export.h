#pragma once

// Everything is hidden by default; this marks what hosts may link to by name.
#define DPXLSX_API __attribute__((visibility("default")))
