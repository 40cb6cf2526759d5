#include "WritePng.h"

#include "CSafeFile.h"

#include <png.h>

#include <span>

namespace gw {

namespace {

// The file's bytes; none on failure.
std::vector<std::byte> EncodePng(const RgbPicture& picture)
{
    png_image image{};
    image.version = PNG_IMAGE_VERSION;
    image.width = static_cast<png_uint_32>(picture.width);
    image.height = static_cast<png_uint_32>(picture.height);
    image.format = PNG_FORMAT_RGB;
    png_alloc_size_t byteCount = PNG_IMAGE_PNG_SIZE_MAX(image);
    std::vector<std::byte> bytes(byteCount);
    if (!png_image_write_to_memory(&image, bytes.data(), &byteCount, 0, picture.rgb.data(), 0, nullptr))
        byteCount = 0;
    bytes.resize(byteCount);
    return bytes;
}

} // namespace

bool WritePng(const std::string& path, const RgbPicture& picture)
{
    const std::vector<std::byte> bytes = EncodePng(picture);
    CSafeFile file;
    return !bytes.empty() && file.Open(path) && file.Write(std::span(bytes)) && file.Commit();
}

} // namespace gw
