// The table of filters: kernels must have the properties that its columns promise.

#include "CFilter.h"

#include <cmath>
#include <gtest/gtest.h>
#include <limits>
#include <string>
#include <tuple>

namespace gw {
namespace {

constexpr double kTiny = 1e-12;

// A copy of a filter, with parameters if it has any.
CFilter Ready(std::string_view name)
{
    CFilter filter = *FindFilter(name);
    if (filter.init)
        filter.init(filter, name == "kaiser" ? 6.5 : 1.0 / 3.0, 1.0 / 3.0);
    return filter;
}

TEST(CFilter, StandInOrderWithTheirSupports)
{
    std::string names;
    for (const CFilter& filter : Filters())
    {
        names.append(filter.name).append(filter.m_bNeedsWindow ? "* " : " ");
        EXPECT_EQ(filter.blur, 1.0) << filter.name;
        EXPECT_EQ(FindFilter(filter.name), &filter);
    }
    EXPECT_EQ(names,
              "point box triangle quadratic cubic catrom mitchell gaussian sinc* bessel* hanning hamming "
              "blackman kaiser ");
    EXPECT_EQ(FindFilter("Box"), nullptr);
    EXPECT_EQ(FindFilter("bessel")->support, 3.2383);
    EXPECT_EQ(FindFilter("point")->support, 0.0);
    for (const char* name : {"mitchell", "kaiser"})
        EXPECT_EQ((*FindFilter(name))(0.0), 0.0) << "no parameters yet";
}

TEST(CFilter, KeepWhatTheirColumnsPromise)
{
    for (const CFilter& named : Filters())
    {
        const CFilter filter = Ready(named.name);
        SCOPED_TRACE(filter.name);
        double least = 1.0;
        double most = 0.0;
        const int steps = static_cast<int>(2.0 * filter.support * 128.0);
        for (int step = 0; step < steps; ++step)
        {
            const double x = step / 128.0 - filter.support;
            least = std::min(least, filter(x));
            most = std::max(most, filter(x));
            EXPECT_NEAR(filter(x), filter.name.ends_with("box") ? 1.0 : filter(-x), 1e-9) << x;
        }
        EXPECT_EQ(filter.m_bUnitRange, least >= -kTiny && most <= 1.0 + kTiny) << least << " " << most;
        bool interpolates = std::fabs(filter(0.0) - 1.0) < 1e-6;
        for (int i = 1; i < filter.support; ++i)
            interpolates = interpolates && std::fabs(filter(i)) < 1e-9;
        EXPECT_EQ(filter.m_bCardinal, interpolates);
    }
}

TEST(CFilter, HaveKnownValues)
{
    const std::tuple<std::string_view, double, double> rows[] = {
        {"box", -0.5, 1.0},
        {"triangle", 0.25, 0.75},
        {"quadratic", 0.0, 0.75},
        {"quadratic", 0.5, 0.5},
        {"cubic", 0.0, 2.0 / 3.0},
        {"cubic", 1.0, 1.0 / 6.0},
        {"catrom", 0.5, 0.5625},
        {"catrom", -1.5, -0.0625},
        {"gaussian", 1.25, 0.0350566009871371},
        {"sinc", -1.5, -0.212206590789194},
        {"bessel", 0.0, 0.7853981633974483},
        {"bessel", -1.0, 0.142307671589876},
        {"hanning", 0.5, 0.5},
        {"hamming", 1.0, 0.08},
        {"blackman", 0.5, 0.34},
        {"mitchell", 0.5, 0.534722222222222},
        {"mitchell", 1.5, -0.034722222222222},
        {"kaiser", 0.6, std::cyl_bessel_i(0.0, 6.5 * 0.8) / std::cyl_bessel_i(0.0, 6.5)},
        {"kaiser", 1.0, 1.0 / std::cyl_bessel_i(0.0, 6.5)},
    };
    for (const auto& [name, x, value] : rows)
        EXPECT_NEAR(Ready(name)(x), value, 1e-8) << name << " " << x;
    EXPECT_EQ(BesselI0(6e-4), 1.0) << "too little to count";
    EXPECT_FALSE(std::isfinite(BesselI0(1e200)));
    EXPECT_FALSE(std::isfinite(BesselI0(std::numeric_limits<double>::quiet_NaN())));
}

} // namespace
} // namespace gw
