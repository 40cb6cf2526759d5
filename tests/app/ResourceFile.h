#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace gw {

struct ResourceString
{
    uint32_t id;
    uint32_t language;
    std::u16string text;
};

/// Returns the bytes of a 64-bit library that contains only a string table.
std::string ResourceFile(const std::vector<ResourceString>& strings);

} // namespace gw
