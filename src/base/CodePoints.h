#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace gw {

enum class EEncoding : uint8_t
{
    UTF8,
    Big5, ///< with the additions for Hong Kong, where the system has them
};

/// Decodes a text into code points; no value if its bytes are not valid in the encoding.
std::optional<std::u32string> CodePoints(std::string_view text, EEncoding encoding);

} // namespace gw
