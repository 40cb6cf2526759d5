#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <string>
#include <string_view>

namespace gw {

/// A kind of picture files: the driver that reads it, if there is one, an extension, and the number that such
/// files begin with.
struct PicFileType
{
    std::string_view driver;
    std::string_view extension; ///< without its dot
    uint16_t magic;             ///< the first byte is the high one
    bool magicOffset;           ///< the number stands one byte further on
    uint8_t magicSize;          ///< bytes of the number, 0 for none
};

/// All known kinds, also those without a driver.
std::span<const PicFileType> PictureTypes();
/// The kind of a file name by its extension: as it stands, since "Z" and "z" differ, then without regard to
/// case. Null for an unknown one.
const PicFileType* FindPictureType(std::string_view fileName);
/// The kind by the bytes that a file begins with, or null.
const PicFileType* FindPictureTypeOfBytes(std::span<const std::byte> bytes);
/// The same for a regular file.
const PicFileType* FindPictureTypeOfFile(const std::string& fileName);

} // namespace gw
