#include "PicFileType.h"

#include "CMappedFile.h"
#include "Paths.h"
#include "Text.h"

#include <algorithm>
#include <iterator>

namespace gw {

namespace {

constexpr PicFileType kTypes[] = {
    {"bmp",  "bmp",   0x424d, false, 2},
    {"jpg",  "jpg",   0,      false, 0},
    {"jpg",  "jpeg",  0,      false, 0},
    {"jpg",  "pjpg",  0,      false, 0},
    {"jpg",  "pjpeg", 0,      false, 0},
    {"png",  "png",   0,      false, 0},
    {"gif",  "gif",   0,      false, 0},
    {"tif",  "tif",   0,      false, 0},
    {"tif",  "tiff",  0,      false, 0},
    {"pnm",  "pbm",   0,      false, 0},
    {"pnm",  "pgm",   0,      false, 0},
    {"pnm",  "ppm",   0,      false, 0},
    {"pnm",  "pnm",   0,      false, 0},
    {"dump", "dump",  0x5088, false, 2},
    {"iris", "iris",  0,      false, 0},
    {"rle",  "rle",   0xcc52, true,  2},
    {"rle",  "Z",     0x1f9d, false, 2},
    {"rle",  "z",     0x1f8b, false, 2},
};

const PicFileType* Found(const PicFileType* row)
{
    return row == std::end(kTypes) ? nullptr : row;
}

bool HasMagic(const PicFileType& type, std::span<const std::byte> bytes)
{
    const size_t offset = type.magicOffset ? 1 : 0;
    if (type.magicSize == 0 || bytes.size() < offset + type.magicSize)
        return false;
    const auto high = std::to_integer<uint16_t>(bytes[offset]);
    const auto low = std::to_integer<uint16_t>(bytes[offset + 1]);
    return type.magic == (high << 8 | low);
}

} // namespace

std::span<const PicFileType> PictureTypes()
{
    return kTypes;
}

const PicFileType* FindPictureType(std::string_view fileName)
{
    const std::string dotted = SplitPath(fileName).extension;
    const std::string_view extension = std::string_view(dotted).substr(dotted.empty() ? 0 : 1);
    if (const PicFileType* exact = Found(std::ranges::find(kTypes, extension, &PicFileType::extension)))
        return exact;
    const auto fits = [=](const PicFileType& type) { return EqualNoCase(type.extension, extension); };
    return Found(std::ranges::find_if(kTypes, fits));
}

const PicFileType* FindPictureTypeOfBytes(std::span<const std::byte> bytes)
{
    return Found(
        std::ranges::find_if(kTypes, [=](const PicFileType& type) { return HasMagic(type, bytes); }));
}

const PicFileType* FindPictureTypeOfFile(const std::string& fileName)
{
    CMappedFile file;
    return file.Open(fileName) == EFailure::None ? FindPictureTypeOfBytes(file.Bytes()) : nullptr;
}

} // namespace gw
