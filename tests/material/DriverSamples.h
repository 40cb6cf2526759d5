#pragma once

#include "PicProcs.h"

#include <gtest/gtest.h>
#include <string>

namespace gw {

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
