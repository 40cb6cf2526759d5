#include "ThinCurve.h"
#include "CAxis.h"

#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>
#include <limits>
#include <tuple>

namespace gw {

TEST(ThinCurve, KeepsEveryPeakInFewPoints)
{
    std::vector<float> values(100000);
    for (size_t f = 0; f < values.size(); ++f)
        values[f] = static_cast<float>(std::sin(static_cast<double>(f) * 0.01));
    values[31415] = 90.0f;
    values[92653] = -80.0f;
    const std::vector<CurvePoint> points = ThinCurve(values, 2000);
    EXPECT_LE(points.size(), 2000u);
    EXPECT_GE(points.size(), 1000u);
    EXPECT_TRUE(std::ranges::is_sorted(points, std::ranges::less(), &CurvePoint::frame));
    const auto holds = [&](int frame, float value) {
        return std::ranges::any_of(points,
                                   [=](const CurvePoint& p) { return p.frame == frame && p.value == value; });
    };
    EXPECT_TRUE(holds(31415, 90.0f));
    EXPECT_TRUE(holds(92653, -80.0f));
}

TEST(ThinCurve, TakesAShortCurveWholeAndLeavesOutWhatIsNoNumber)
{
    const float nan = std::numeric_limits<float>::quiet_NaN();
    const std::vector<float> values{1.0f, nan, 3.0f, -std::numeric_limits<float>::infinity(), 5.0f};
    const std::vector<CurvePoint> points = ThinCurve(values, 2000);
    ASSERT_EQ(points.size(), 3u);
    EXPECT_EQ(points[1].frame, 2);
    EXPECT_EQ(points[2].value, 5.0f);
    EXPECT_TRUE(ThinCurve({}, 2000).empty());
}

TEST(Axis, HoldsItsNumbersBetweenRoundOnes)
{
    const std::tuple<const char*, double, double, std::vector<double>> rows[] = {
        {"degrees", 0.0, 47.0, {0.0, 20.0, 40.0, 60.0}},
        {"below and above", -13.0, 188.0, {-100.0, 0.0, 100.0, 200.0}},
        {"small", 0.0, 0.02, {0.0, 0.01, 0.02}},
        {"far from nothing", 901.0, 904.5, {900.0, 902.0, 904.0, 906.0}},
    };
    for (const auto& [what, least, largest, marks] : rows)
    {
        SCOPED_TRACE(what);
        const std::vector<double> ticks = CAxis(least, largest, 3).Ticks();
        ASSERT_EQ(ticks.size(), marks.size());
        for (size_t i = 0; i < ticks.size(); ++i)
            EXPECT_NEAR(ticks[i], marks[i], 1e-9);
    }
    for (const double still : {0.0, 42.0, -1e30, 1e-30})
    {
        const CAxis axis(still, still, 3);
        EXPECT_TRUE(axis.Share(still) >= 0.0 && axis.Share(still) <= 1.0) << still;
        EXPECT_LE(axis.Ticks().size(), 8u) << still;
    }
}

} // namespace gw
