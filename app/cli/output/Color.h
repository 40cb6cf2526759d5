#pragma once

#include <cstdint>
#include <cstdio>
#include <string>
#include <string_view>

namespace gw {

enum class EColor : uint8_t
{
    Red,    ///< errors
    Yellow, ///< warnings
};

/// Returns a text in a color, if the stream is a terminal that shows colors and NO_COLOR is not set;
/// otherwise the text as it is.
std::string Colored(std::FILE* stream, EColor color, std::string_view text);

} // namespace gw
