#pragma once

#include "CPicture.h"

#include <span>
#include <string_view>

namespace gw {

/// A driver for one kind of picture files, as a record of its operations. A picture comes from `open` and
/// goes by `close`. Nothing is thrown: failures answer false or null, and some are told on standard error.
struct PicProcs
{
    CPicture* (*open)(const char* fileName, const char* mode);
    bool (*close)(CPicture* picture);
    const char* (*getName)(const CPicture* picture);
    void (*clear)(CPicture* picture, uint8_t pixel);              ///< does nothing
    void (*clearRGBA)(CPicture* picture, const PixelRGBA& pixel); ///< does nothing
    bool (*setChannelCount)(CPicture* picture, int count);
    bool (*setSize)(CPicture* picture, const PictureBox& box);
    void (*writePixel)(CPicture* picture, int x, int y, uint8_t pixel); ///< no driver can
    void (*writePixelRGBA)(CPicture* picture, int x, int y, const PixelRGBA& pixel);
    bool (*writeRow)(CPicture* picture, int y, int x, int count, const uint8_t* pixels);
    bool (*writeRowRGBA)(CPicture* picture, int y, int x, int count, const PixelRGBA* pixels);
    int (*getChannelCount)(const CPicture* picture);
    PictureBox (*getBox)(const CPicture* picture);
    uint8_t (*readPixel)(CPicture* picture, int x, int y); ///< no driver can
    PixelRGBA (*readPixelRGBA)(CPicture* picture, int x, int y);
    bool (*readRow)(CPicture* picture, int y, int x, int count, uint8_t* pixels);
    bool (*readRowRGBA)(CPicture* picture, int y, int x, int count, PixelRGBA* pixels);
    bool (*nextPicture)(CPicture* picture);
    const char* name;
};

/// The drivers that there are: "bmp" and "gif".
std::span<const PicProcs> PictureDrivers();
/// The driver of a name, or null: not every file type has one.
const PicProcs* FindPictureDriver(std::string_view name);

} // namespace gw
