#include <cmath>
#include <gtest/gtest.h>
#include <limits>
#include <tuple>

namespace gw {

// Results of Linux that are one unit away from the exact value rounded, as this system's library has it. Sums
// of products are fused on every processor of the last ten years.
TEST(FloatMath, HasTheResultsOfLinux)
{
    const std::tuple<float, float> sines[] = {{0x1.1035a4p-2f, 0x1.0d03dp-2f},
                                              {-0x1.5f1308p+1f, -0x1.8da7c2p-2f},
                                              {-0x1.e93b5ap+11f, 0x1.142aa6p-1f}};
    for (const auto& [angle, sine] : sines)
        EXPECT_EQ(std::sin(angle), sine);
    const std::tuple<float, float> cosines[] = {{-0x1.2a674ap+1f, -0x1.60e7fcp-1f},
                                                {-0x1.4cafcap+10f, 0x1.1d2aeap-2f},
                                                {0x1.b67bfap+8f, 0x1.d719dap-3f}};
    for (const auto& [angle, cosine] : cosines)
        EXPECT_EQ(std::cos(angle), cosine);
    const std::tuple<float, float, float> angles[] = {{0x1.eaf3a2p+0f, -0x1.7bbdfcp-5f, 0x1.984f7cp+0f},
                                                      {-0x1.f111bep+0f, -0x1.b8f69cp-1f, -0x1.fd0036p+0f},
                                                      {-0x1.f8a6cp-1f, 0x1.4e643cp+0f, -0x1.4af874p-1f}};
    for (const auto& [y, x, angle] : angles)
        EXPECT_EQ(std::atan2(y, x), angle);
    const float endless = std::numeric_limits<float>::infinity();
    EXPECT_TRUE(std::isnan(std::sin(endless)) && std::isnan(std::atan2(endless, std::nanf(""))));
    EXPECT_EQ(std::atan2(-endless, -endless), -0x1.2d97c8p+1f);
}

} // namespace gw
