#include "MeshSamples.h"
#include "Rotations.h"

#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

// A system at (0, 10, 0) whose particles start at its center.
struct System
{
    explicit System(int32_t capacity, float rate)
    {
        particles->m_iParticleCount = capacity;
        particles->m_kMatrix = Moved(0, 10, 0);
        particles->AttachControl(control);
        control->m_uiCapacity = static_cast<uint32_t>(capacity);
        control->m_fRate = rate;
        control->m_fEndTime = 1000.0f;
        control->Seed(1);
    }
    int32_t ActiveAt(float time)
    {
        particles->UpdateScene(time, false);
        return particles->m_iActiveCount;
    }

    Ref<CParticles> particles = new CParticles;
    CParticleControl* control = new CParticleControl;
};

} // namespace

TEST(Particles, SlowRatesDoNotStarveAndTimeThatStandsDoesNothing)
{
    System system(10, 0.5f);
    const std::tuple<const char*, float, int32_t> rows[] = {
        {"no time has gone", 0, 0}, {"half a particle", 1, 0},   {"a whole one", 2, 1},
        {"half again", 3, 1},       {"time stands still", 3, 1}, {"the second", 4, 2},
        {"time goes back", 1, 2},   {"and on from there", 3, 3},
    };
    for (const auto& [what, seconds, active] : rows)
        EXPECT_EQ(system.ActiveAt(seconds), active) << what;
    system.control->m_bActive = false;
    EXPECT_EQ(system.ActiveAt(50.0f), 3);
}

TEST(Particles, AFullSystemEmitsNoneAndKeepsTheFraction)
{
    System system(3, 1.25f);
    EXPECT_EQ(system.ActiveAt(4.0f), 3);
    EXPECT_EQ(system.ActiveAt(6.0f), 3); // two and a half: the half is carried over
    system.particles->m_iParticleCount = 8;
    system.control->m_uiCapacity = 8;
    system.control->m_fRate = 0.5f;
    EXPECT_EQ(system.ActiveAt(7.0f), 4);
}

TEST(Particles, AParticleMovesGrowsAndDies)
{
    System system(1, 1.0f);
    CParticleControl& control = *system.control;
    control.m_kPlace.Set({1, 0, 0}, {1, 0, 0});
    control.m_kSpread.Set({0, 2, 0}, {0, 2, 0});
    control.m_kVelocity.Set({7, 0, 0}, {7, 0, 0});
    control.m_kForceDirection = kVec3UnitY;
    control.m_fForceStrength = 14.0f;
    control.m_fGrowth = 3.5f;
    control.m_fLife = 2.5f;
    control.m_afFirstColor = control.m_afSecondColor = {0.1f, 0.2f, 0.3f, 0.4f};
    system.ActiveAt(1.0f);
    const Vec3& point = system.particles->WorldXYZBuffer()[0];
    const Particle& particle = system.particles->Particles()[0];
    ExpectNear(point, {2, 12, 0}, 1e-4); // moved in the step that created it
    EXPECT_FLOAT_EQ(particle.m_fSize, 30.5f);
    EXPECT_FLOAT_EQ(particle.m_fLife, 1.5f);
    EXPECT_EQ(particle.m_afColor[3], 0.4f);
    control.m_fRate = 0.0f;
    system.ActiveAt(2.0f);
    ExpectNear(point, {3, 12 + 2.0f / 7, 0}, 1e-4);
    const uint32_t stamp = system.particles->m_uiChangeStamp;
    EXPECT_EQ(system.ActiveAt(3.0f), 0);
    ExpectNear(point, kVec3Zero, 1e-4);
    EXPECT_EQ(particle.m_fSize, 0.0f);
    EXPECT_EQ(particle.m_kVelocity, kVec3Zero);
    EXPECT_EQ(particle.m_afColor[3], 0.0f);
    EXPECT_EQ(system.particles->m_uiChangeStamp, stamp + 1);
}

TEST(Particles, StartsFallInStepsOfOnePercentAndAreTheSameForTheSameSeed)
{
    const auto places = [] {
        System system(500, 500.0f);
        system.control->m_kPlace.Set({0, -1, 5}, {100, -1, -5});
        system.ActiveAt(1.0f);
        const std::span<Vec3> points = system.particles->WorldXYZBuffer();
        return std::vector<Vec3>(points.begin(), points.end());
    };
    const std::vector<Vec3> first = places();
    ASSERT_EQ(first.size(), 500u);
    EXPECT_EQ(places(), first);
    EXPECT_NE(first[0], first[1]);
    for (const Vec3& point : first)
    {
        EXPECT_NEAR(point.x, std::round(point.x), 1e-4f);
        EXPECT_LE(point.x, 99.001f);
        EXPECT_GE(point.x, 0.0f);
        EXPECT_FLOAT_EQ(point.y, 9.0f);
        EXPECT_LT(point.z, 5.0f);
    }
}

TEST(Particles, CapacitiesWithoutBytesBehindThemTakeNoMoreThanTheCeiling)
{
    System first(0x7fffffff, 1e30f);
    EXPECT_EQ(first.particles->Particles().size(), 0u);
    EXPECT_EQ(first.ActiveAt(1.0f), static_cast<int32_t>(CParticles::kMostSlots));
    System second(1000, 1e30f);
    EXPECT_EQ(second.ActiveAt(1.0f), 0) << "the ceiling is for all systems together";
    first.particles->DetachControls();
    first.particles = nullptr;
    EXPECT_EQ(second.ActiveAt(2.0f), 1000);
    for (const float rate : {-5.0f, std::numeric_limits<float>::quiet_NaN()})
    {
        System odd(10, rate);
        EXPECT_EQ(odd.ActiveAt(1.0f), 0);
    }
}

TEST(Particles, AControlOnAnythingElseDoesNothing)
{
    const Ref<CNode> node = new CNode;
    CParticleControl* control = new CParticleControl;
    node->AttachControl(control);
    control->m_uiCapacity = 10;
    node->UpdateScene(5.0f, false);
    EXPECT_EQ(node->m_uiChangeStamp, 0u);
}

} // namespace gw
