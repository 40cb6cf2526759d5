#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace gw {

struct ResourceString
{
    uint32_t id;
    uint32_t language;
    std::string text; ///< UTF-8 of at most three bytes a character
};

/// The bytes of a 64-bit library that holds nothing but a string table.
std::string ResourceFile(const std::vector<ResourceString>& strings);

} // namespace gw
