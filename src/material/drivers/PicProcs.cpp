#include "PicProcs.h"

#include "CBMPPicture.h"
#include "CGIFPicture.h"
#include "PicFileType.h"

#include <algorithm>
#include <cstdio>
#include <iterator>

namespace gw {

namespace {

bool Close(CPicture* picture)
{
    const bool closed = picture->Close();
    delete picture;
    return closed;
}

void TellUnsupported(const CPicture* picture, const char* operation)
{
    std::fprintf(stderr, "?%s_%s\n", picture->MessageName(), operation);
}

// All drivers have the same operations; only the class of the picture differs.
constexpr PicProcs ProcsOf(const char* name, CPicture* (*open)(const char* fileName, const char* mode))
{
    return {
        .open = open,
        .close = Close,
        .getName = [](const CPicture* picture) { return picture->Name().c_str(); },
        .clear = [](CPicture*, uint8_t) {},
        .clearRGBA = [](CPicture*, const PixelRGBA&) {},
        .setChannelCount = [](CPicture* picture, int count) { return picture->SetChannelCount(count); },
        .setSize = [](CPicture* picture, const PictureBox& box) { return picture->SetSize(box); },
        .writePixel = [](CPicture* picture, int, int, uint8_t) { TellUnsupported(picture, "write_pixel"); },
        .writePixelRGBA = [](CPicture* picture, int, int,
                             const PixelRGBA&) { TellUnsupported(picture, "write_pixel_rgba"); },
        .writeRow = [](CPicture* picture, int y, int x, int count,
                       const uint8_t* pixels) { return picture->WriteRow(y, x, count, pixels); },
        .writeRowRGBA = [](CPicture* picture, int y, int x, int count,
                           const PixelRGBA* pixels) { return picture->WriteRowRGBA(y, x, count, pixels); },
        .getChannelCount = [](const CPicture* picture) { return picture->ChannelCount(); },
        .getBox = [](const CPicture* picture) { return picture->Box(); },
        .readPixel =
            [](CPicture* picture, int, int) {
                TellUnsupported(picture, "read_pixel");
                return uint8_t{0};
            },
        .readPixelRGBA =
            [](CPicture* picture, int, int) {
                TellUnsupported(picture, "read_pixel_rgba");
                return PixelRGBA{};
            },
        .readRow = [](CPicture* picture, int y, int x, int count,
                      uint8_t* pixels) { return picture->ReadRow(y, x, count, pixels); },
        .readRowRGBA = [](CPicture* picture, int y, int x, int count,
                          PixelRGBA* pixels) { return picture->ReadRowRGBA(y, x, count, pixels); },
        .nextPicture = [](CPicture* picture) { return picture->NextPicture(); },
        .name = name,
    };
}

constexpr PicProcs kDrivers[] = {
    ProcsOf("bmp", CBMPPicture::Open),
    ProcsOf("gif", CGIFPicture::Open),
};

} // namespace

std::span<const PicProcs> PictureDrivers()
{
    return kDrivers;
}

const PicProcs* FindPictureDriver(std::string_view name)
{
    const auto fits = [=](const PicProcs& driver) { return driver.name == name; };
    const auto* found = std::ranges::find_if(kDrivers, fits);
    return found == std::end(kDrivers) ? nullptr : found;
}

std::unique_ptr<CPicture> OpenPicture(const std::string& fileName, const char* mode)
{
    const PicFileType* type = FindPictureType(fileName);
    if (!type && *mode == 'r')
        type = FindPictureTypeOfFile(fileName);
    const PicProcs* driver = type ? FindPictureDriver(type->driver) : nullptr;
    return std::unique_ptr<CPicture>(driver ? driver->open(fileName.c_str(), mode) : nullptr);
}

} // namespace gw
