#pragma once

#include <cstdint>
#include <string>

namespace gw {

/// Appends a code point as UTF-8; half of a surrogate pair and what is no code point become U+FFFD.
void AppendUtf8(std::string& text, uint32_t point);

} // namespace gw
