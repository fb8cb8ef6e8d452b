// Whether there is memory for what comes next.
#pragma once

#include <cstdint>

/// Throws std::bad_alloc if so many bytes are not available in one piece. The library's text
/// conversions give an empty text if they get no memory, so that has to be known before.
void RequireMemory(std::uint64_t bytes);
