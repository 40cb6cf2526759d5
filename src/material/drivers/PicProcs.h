#pragma once

#include "CPicture.h"

#include <span>
#include <string_view>

namespace gw {

/// A driver for one picture type, as a table of operations. `open` creates a picture, `close` destroys it.
/// Nothing throws: failures return false or null, some with a message on standard error.
struct PicProcs
{
    CPicture* (*open)(const char* fileName, const char* mode);
    bool (*close)(CPicture* picture);
    const char* (*getName)(const CPicture* picture);
    void (*clear)(CPicture* picture, uint8_t pixel);              ///< does nothing
    void (*clearRGBA)(CPicture* picture, const PixelRGBA& pixel); ///< does nothing
    bool (*setChannelCount)(CPicture* picture, int count);
    bool (*setSize)(CPicture* picture, const PictureBox& box);
    void (*writePixel)(CPicture* picture, int x, int y, uint8_t pixel); ///< not supported by any driver
    void (*writePixelRGBA)(CPicture* picture, int x, int y, const PixelRGBA& pixel);
    bool (*writeRow)(CPicture* picture, int y, int x, int count, const uint8_t* pixels);
    bool (*writeRowRGBA)(CPicture* picture, int y, int x, int count, const PixelRGBA* pixels);
    int (*getChannelCount)(const CPicture* picture);
    PictureBox (*getBox)(const CPicture* picture);
    uint8_t (*readPixel)(CPicture* picture, int x, int y); ///< not supported by any driver
    PixelRGBA (*readPixelRGBA)(CPicture* picture, int x, int y);
    bool (*readRow)(CPicture* picture, int y, int x, int count, uint8_t* pixels);
    bool (*readRowRGBA)(CPicture* picture, int y, int x, int count, PixelRGBA* pixels);
    bool (*nextPicture)(CPicture* picture);
    const char* name;
};

/// Returns the drivers: "bmp" and "gif".
std::span<const PicProcs> PictureDrivers();
/// Returns the driver with a name, or null: not every file type has one.
const PicProcs* FindPictureDriver(std::string_view name);

} // namespace gw
