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

CFilter Named(std::string_view name, double first = 0.0, double second = 0.0)
{
    const CFilter* found = FindFilter(name);
    EXPECT_TRUE(found) << name;
    CFilter filter = *found;
    if (filter.init)
        filter.init(filter, first, second);
    return filter;
}

// Returns a copy of each filter, with parameters if it has any.
std::vector<CFilter> ReadyFilters()
{
    std::vector<CFilter> filters;
    for (const CFilter& filter : Filters())
        filters.push_back(Named(filter.name, filter.name == "kaiser" ? 6.5 : 1.0 / 3.0, 1.0 / 3.0));
    return filters;
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
    EXPECT_EQ(FindFilter("point")->function, FindFilter("box")->function);
}

TEST(CFilter, KeepWhatTheirColumnsPromise)
{
    for (const CFilter& filter : ReadyFilters())
    {
        SCOPED_TRACE(filter.name);
        double least = 1.0;
        double most = 0.0;
        for (double x = -filter.support; x < filter.support; x += 1.0 / 128)
        {
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
        {"box", 0.5, 0.0},
        {"triangle", -1.0, 0.0},
        {"triangle", 0.25, 0.75},
        {"quadratic", 0.0, 0.75},
        {"quadratic", 0.5, 0.5},
        {"quadratic", 1.5, 0.0},
        {"cubic", 0.0, 2.0 / 3.0},
        {"cubic", 1.0, 1.0 / 6.0},
        {"cubic", 2.0, 0.0},
        {"catrom", 0.0, 1.0},
        {"catrom", 1.0, 0.0},
        {"catrom", 0.5, 0.5625},
        {"catrom", -1.5, -0.0625},
        {"gaussian", 0.0, 0.7978845608028654},
        {"gaussian", 1.25, 0.0350566009871371},
        {"gaussian", -3.0, 1.2151765699646e-8},
        {"sinc", 0.0, 1.0},
        {"sinc", 0.5, 0.6366197723675814},
        {"sinc", -1.5, -0.212206590789194},
        {"bessel", 0.0, 0.7853981633974483},
        {"bessel", 0.5, 0.5668240889058739},
        {"bessel", -1.0, 0.142307671589876},
        {"hanning", 0.5, 0.5},
        {"hanning", 1.0, 0.0},
        {"hamming", 1.0, 0.08},
        {"blackman", 0.5, 0.34},
    };
    for (const auto& [name, x, value] : rows)
        EXPECT_NEAR((*FindFilter(name))(x), value, 1e-10) << name << " " << x;
}

// Two members of its family are other filters, so all seven coefficients can be compared.
TEST(CFilter, MitchellHoldsCubicAndCatrom)
{
    const CFilter cubic = Named("mitchell", 1.0, 0.0);
    const CFilter catrom = Named("mitchell", 0.0, 0.5);
    for (double x = -2.25; x < 2.25; x += 1.0 / 32)
    {
        EXPECT_NEAR(cubic(x), (*FindFilter("cubic"))(x), kTiny) << x;
        EXPECT_NEAR(catrom(x), (*FindFilter("catrom"))(x), kTiny) << x;
    }
    EXPECT_EQ((*FindFilter("mitchell"))(0.0), 0.0) << "no parameters yet";
}

TEST(CFilter, KaiserFallsFromOneAsBesselDoes)
{
    const CFilter kaiser = Named("kaiser", 6.5);
    EXPECT_NEAR(kaiser(0.0), 1.0, kTiny);
    EXPECT_NEAR(kaiser(0.6), std::cyl_bessel_i(0.0, 6.5 * 0.8) / std::cyl_bessel_i(0.0, 6.5), 1e-8);
    EXPECT_NEAR(kaiser(1.0), 1.0 / std::cyl_bessel_i(0.0, 6.5), 1e-8);
    EXPECT_EQ((*FindFilter("kaiser"))(0.0), 0.0) << "no parameter yet";

    EXPECT_EQ(BesselI0(0.0), 1.0);
    EXPECT_EQ(BesselI0(6e-4), 1.0) << "too little to count";
    for (const double x : {-3.0, 0.5, 1.0, 4.0, 10.0})
        EXPECT_NEAR(BesselI0(x) / std::cyl_bessel_i(0.0, std::fabs(x)), 1.0, 1e-7) << x;
    EXPECT_FALSE(std::isfinite(BesselI0(1e200)));
    EXPECT_FALSE(std::isfinite(BesselI0(std::numeric_limits<double>::quiet_NaN())));
}

} // namespace
} // namespace gw
