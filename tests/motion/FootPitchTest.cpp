#include "FootPitch.h"

#include "Directions.h"
#include "SettleFoot.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <vector>

namespace gw {
namespace {

constexpr double kDegree = 0.0174532925;

Vec3 Pitched(double degrees, double length)
{
    return {0.0f, static_cast<float>(length * std::sin(degrees * kDegree)),
            static_cast<float>(length * std::cos(degrees * kDegree))};
}

double PitchOf(const Vec3& toe)
{
    return std::atan2(static_cast<double>(toe.y), static_cast<double>(toe.z)) / kDegree;
}

TEST(FootPitch, TurnsTowardTheWantedPlaceSoftlyAndNoFartherThanItsLimit)
{
    const auto turned = [](double degrees, const ToePlace& wanted) {
        const Vec3 toe = Pitched(degrees, 100.0);
        return PitchOf(Turned(toe, PitchFoot(toe, wanted))) - degrees;
    };
    EXPECT_NEAR(turned(-20.0, ToePlaceOf(Pitched(-18.0, 100.0))), 2.0, 0.05) << "nearly all of a little";
    EXPECT_NEAR(turned(-20.0, ToePlaceOf(Pitched(25.0, 100.0))), 8.6, 0.05) << "little of a lot";
    EXPECT_NEAR(turned(-20.0, {0.0, -300.0}), -8.6, 0.05) << "a place that no foot reaches";
    EXPECT_NEAR(turned(-90.0, ToePlaceOf(Pitched(-85.0, 100.0))), 0.0, 0.01) << "an upright foot";
    EXPECT_NEAR(turned(-20.0, {0.0, std::numeric_limits<double>::quiet_NaN()}), 0.0, 1e-4);
}

TEST(FootPitch, LowersTheToeAndKeepsHeadingAndLength)
{
    const Vec3 toe{60.0f, -50.0f, 80.0f};
    const Vec3 lowered = Turned(toe, LoweredToe(toe, 5.0));
    EXPECT_NEAR(lowered.y, -55.0f, 1e-3f);
    EXPECT_NEAR(lowered.x / lowered.z, toe.x / toe.z, 1e-4f);
    EXPECT_NEAR(Vec3Length(lowered), Vec3Length(toe), 1e-3f);
    EXPECT_EQ(LoweredToe({0.0f, -100.0f, 0.0f}, 5.0), kMat3Identity) << "an upright foot";
}

// A foot whose heel is 60 mm too high, then one that is off by 5 mm, and a swinging one between them.
TEST(SettleFoot, TakesDownAHeelThatIsClearlyTooHigh)
{
    std::vector<ToeWish> wishes(300, {Pitched(-60.0, 144.0), 64.7, 1.0});
    std::fill(wishes.begin() + 100, wishes.begin() + 200, ToeWish{Pitched(-60.0, 144.0), 64.7, 0.0});
    std::fill(wishes.begin() + 200, wishes.end(), ToeWish{Pitched(-60.0, 144.0), 119.7, 1.0});
    const std::vector<double> drops = SettleFoot(wishes, 1.0 / 60.0);
    EXPECT_LT(drops[50], -40.0);
    EXPECT_GT(drops[50], -60.0) << "softly limited";
    EXPECT_NEAR(drops[150], 0.0, 1.0);
    EXPECT_NEAR(drops[250], 0.0, 0.5);
}

} // namespace
} // namespace gw
