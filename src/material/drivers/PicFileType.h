#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <string>
#include <string_view>

namespace gw {

/// A picture file type: its driver, if any, its extension, and the number at the start of its files.
struct PicFileType
{
    std::string_view driver;
    std::string_view extension; ///< without the dot
    uint16_t magic;             ///< first byte is the high byte
    bool magicOffset;           ///< the number is one byte later
    uint8_t magicSize;          ///< size in bytes, 0 without one
};

/// Returns all known types, including those without a driver.
std::span<const PicFileType> PictureTypes();
/// Returns the type of a file name by extension: exact case first, since "Z" and "z" differ, then ignoring
/// case. Null if unknown.
const PicFileType* FindPictureType(std::string_view fileName);
/// Returns the type by the first bytes of a file, or null.
const PicFileType* FindPictureTypeOfBytes(std::span<const std::byte> bytes);
/// Same for a regular file.
const PicFileType* FindPictureTypeOfFile(const std::string& fileName);

} // namespace gw
