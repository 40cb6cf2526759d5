#pragma once

#include "PicProcs.h"

#include <cstdint>
#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace gw {

/// A BMP file under construction. Rows are given as stored in the file.
struct MadeBMP
{
    int32_t width = 0;
    int32_t height = 0;
    uint16_t depth = 24;
    std::vector<uint32_t> palette;
    std::string rows;
    uint32_t compression = 0;
    uint32_t headerBytes = 40;
    uint32_t gap = 0; // before the pixels

    std::string Bytes() const
    {
        const auto paletteBytes = static_cast<uint32_t>(4 * palette.size());
        std::string bytes = "BM";
        const auto add = [&](auto value) {
            bytes.append(reinterpret_cast<const char*>(&value), sizeof value);
        };
        add(uint32_t{0});
        add(uint32_t{0});
        add(14 + headerBytes + paletteBytes + gap);
        add(headerBytes);
        add(width);
        add(height);
        add(uint16_t{1});
        add(depth);
        add(compression);
        bytes.append(20 + headerBytes - 40, '\0');
        for (const uint32_t color : palette)
            add(color);
        return bytes + std::string(gap, '\x55') + rows;
    }
};

inline const std::string kThreeRows("\x01\x01\x01\0\x02\x02\x02\0\x03\x03\x03\0", 12);

/// What a driver writes to standard error when it is asked for single pixels, which none supports.
inline std::string WordsOfSinglePixels(const PicProcs& driver, CPicture* picture)
{
    testing::internal::CaptureStderr();
    driver.clear(picture, 1);
    driver.clearRGBA(picture, {});
    driver.writePixel(picture, 0, 0, 1);
    driver.writePixelRGBA(picture, 0, 0, {});
    EXPECT_EQ(driver.readPixel(picture, 0, 0), 0);
    EXPECT_EQ(driver.readPixelRGBA(picture, 0, 0), PixelRGBA{});
    return testing::internal::GetCapturedStderr();
}

} // namespace gw
