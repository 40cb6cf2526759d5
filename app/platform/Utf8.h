#pragma once

#include <cstdint>
#include <string>

namespace gw {

/// Appends a code point as UTF-8; surrogates and invalid code points become U+FFFD.
void AppendUtf8(std::string& text, uint32_t point);

} // namespace gw
