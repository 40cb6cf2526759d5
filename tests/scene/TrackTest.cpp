#include "CCamera.h"
#include "CCameraControl.h"
#include "CLight.h"
#include "CLightControl.h"
#include "Rotations.h"
#include "SceneSamples.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>
#include <limits>
#include <numbers>
#include <random>
#include <tuple>

namespace gw {
namespace {

constexpr float kNaN = std::numeric_limits<float>::quiet_NaN();
constexpr float kInfinity = std::numeric_limits<float>::infinity();
constexpr float kQuarterTurn = std::numbers::pi_v<float> / 2;

// Returns the x position of the target after an update, which in a tracked node is the key time.
float PositionAt(CNode& node, float time)
{
    node.UpdateScene(time, false);
    return node.m_kMatrix.Translation().x;
}

// Returns positions or scales that differ along x.
std::vector<Vec3> Along(std::initializer_list<float> xs, const Vec3& base = kVec3Zero)
{
    std::vector<Vec3> keys;
    for (const float x : xs)
        keys.push_back({x, base.y, base.z});
    return keys;
}

CKeyframeControl& Track(CNode& node)
{
    return static_cast<CKeyframeControl&>(*node.GetControl());
}

TEST(CKeyArray, HoldsWhatAVectorWouldAndOneKeyWhileAllAreEqual)
{
    std::mt19937 random(7);
    for (int round = 0; round < 300; ++round)
    {
        CKeyArray<Vec3> keys;
        std::vector<Vec3> plain;
        const auto values = static_cast<unsigned>(random() % 3); // different ones, of both signs of zero
        for (int step = 0; step < 9; ++step)
        {
            const Vec3 key{0.0f, values && random() % 2 ? -0.0f : 0.0f,
                           static_cast<float>(random() % (values + 1))};
            if (const size_t index = random() % (plain.size() + 1); index < plain.size())
                keys.Set(index, plain[index] = key);
            else if (step == 0)
            {
                keys.assign(2, key);
                plain.assign(2, key);
            }
            else
            {
                keys.push_back(key);
                plain.push_back(key);
            }
        }
        ASSERT_EQ(keys.size(), plain.size());
        for (size_t i = 0; i < plain.size(); ++i)
            // NOLINTNEXTLINE(bugprone-suspicious-memory-comparison): the same bytes, -0 and NaN too
            ASSERT_EQ(std::memcmp(&keys[i], &plain[i], sizeof(Vec3)), 0) << round;
        EXPECT_EQ(keys[plain.size() + 5], plain.back());
        EXPECT_EQ(CKeyArray<Vec3>(plain), keys);
        EXPECT_TRUE(values || keys.Distinct().size() == 1);
    }
}

TEST(CControl, MapsTimesByFrequencyPhaseAndCycle)
{
    CTestControl control;
    const std::tuple<const char*, uint32_t, float, float, float, float, float, float> rows[] = {
        {"clamp before", 0, 1, 0, 2, 6, 1, 2},
        {"clamp behind", 0, 1, 0, 2, 6, 7, 6},
        {"phase after frequency", 0, 0.5f, 1, 0, 9, 4, 3},
        {"loop at its end is at its begin", 1, 1, 0, 2, 6, 6, 2},
        {"loop before", 1, 1, 0, 2, 6, 1, 5},
        {"reverse in period 1", 2, 1, 0, 2, 6, 7, 5},
        {"reverse in period 2", 2, 1, 0, 2, 6, 11, 3},
        {"reverse in period -1", 2, 1, 0, 2, 6, 1, 3},
        {"any other cycle reverses", 77, 1, 0, 2, 6, 7, 5},
        {"no range to loop in", 1, 1, 0, 2, 2, 9, 2},
        {"a range the wrong way round", 2, 1, 0, 6, 2, 9, 6},
        {"clamped the wrong way round", 0, 1, 0, 6, 2, 9, 2},
        {"no number", 0, 1, 0, 2, 6, kNaN, 2},
        {"frequency that is no number", 2, kNaN, 0, 2, 6, 1, 2},
        {"infinite and clamped", 0, 1, 0, 2, 6, kInfinity, 6},
        {"infinite in a loop", 1, 1, 0, 2, 6, kInfinity, 2},
        {"infinite frequency at 0", 0, kInfinity, 0, 2, 6, 0, 2},
        {"endless range", 1, 1, 0, 2, kInfinity, 9, 2},
        {"end that is no number", 0, 1, 0, 2, kNaN, 9, 2},
        {"a quotient beyond all numbers", 1, 1, 0, 0, 1e-30f, 1e30f, 0},
    };
    for (const auto& [what, cycle, frequency, phase, begin, end, time, keyTime] : rows)
    {
        control.m_iCycleType = cycle;
        control.m_fFrequency = frequency;
        control.m_fPhase = phase;
        control.m_fBeginTime = begin;
        control.m_fEndTime = end;
        EXPECT_EQ(control.MapTime(time), keyTime) << what;
    }
}

TEST(CControl, WholeFramesAreWhole)
{
    CTestControl control;
    control.m_fEndTime = 20000.0f;
    for (const float frequency : {1 / 120.0f, 0.0083333f, 1 / 60.0f, 0.0333333f, 0.04f, 0.06f, 1.0f})
    {
        control.m_fFrequency = frequency;
        for (int frame = 0; frame <= 20000; ++frame)
        {
            const auto time = static_cast<float>(frame);
            ASSERT_EQ(control.MapTime(time / frequency), time) << "at a frequency of " << frequency;
        }
    }
    EXPECT_EQ(control.MapTime(7.000002f), 7.000002f) << "four units away";
    EXPECT_EQ(control.MapTime(6.5f), 6.5f);
}

TEST(FindKeys, AnyOrderOfPlayFindsTheSameSpan)
{
    const std::vector<float> times = {0, 1, 2, 4, 8, 16, 32, 33};
    std::vector<float> play(100);
    for (size_t step = 0; step < play.size(); ++step)
        play[step] = -2.0f + 0.375f * static_cast<float>(step);
    const std::vector<float> back(play.rbegin(), play.rend());
    play.insert(play.end(), back.begin(), back.end());
    for (const float time : {17.0f, 3.0f, 40.0f, -1.0f, 8.0f, 32.0f, 1.0f, 8.0f, 8.0f})
        play.push_back(time);
    KeyCursor cursor = 0;
    for (const float time : play)
    {
        SCOPED_TRACE(time);
        const auto span = FindKeys(time, times, cursor);
        ASSERT_LT(span.b, times.size());
        ASSERT_LT(cursor, times.size());
        EXPECT_FLOAT_EQ(times[span.a] + span.fraction * (times[span.b] - times[span.a]),
                        std::clamp(time, 0.0f, 33.0f));
        EXPECT_LE(span.b - span.a, 1u);
    }
}

TEST(FindKeys, OnTheKeyWhereTheCursorStandsThereIsNoFraction)
{
    const std::vector<float> times = {0, 1, 2, 4};
    const std::tuple<const char*, float, uint32_t, uint32_t, uint32_t, uint32_t, float> rows[] = {
        {"on the cursor's key", 1, 1, 1, 1, 1, 0}, {"forward onto a key", 2, 0, 2, 3, 2, 0},
        {"backward onto a key", 1, 2, 0, 1, 1, 1}, {"at the first", 0, 2, 0, 0, 0, 0},
        {"at the last", 4, 0, 3, 3, 3, 0},         {"a cursor beyond the axis", 1, 99, 0, 1, 1, 1},
    };
    for (const auto& [what, time, cursorBefore, a, b, cursorAfter, fraction] : rows)
    {
        SCOPED_TRACE(what);
        KeyCursor cursor = cursorBefore;
        const auto span = FindKeys(time, times, cursor);
        EXPECT_EQ(span.a, a);
        EXPECT_EQ(span.b, b);
        EXPECT_EQ(span.fraction, fraction);
        EXPECT_EQ(cursor, cursorAfter);
    }
    KeyCursor cursor = 0;
    EXPECT_EQ(FindKeys(0.0f, {-kInfinity, 1.0f}, cursor).fraction, 0.0f) << "nor on a way without end";
}

TEST(CKeyframeControl, RewritesItsTargetFromAllThreeTracks)
{
    const Ref<CNode> node = TrackedNode({0, 1});
    CKeyframeControl& track = Track(*node);
    track.m_kRotationKeys = {kQuatIdentity, QuatFromMat3(Mat3FromAxisAngle(kVec3UnitZ, kQuarterTurn))};
    track.m_kScaleKeys = Along({1, 3}, {0, 5, 1});
    node->UpdateScene(0.5f, false);
    const Mat4& m = node->m_kMatrix;
    EXPECT_EQ(RowLengths(m), (Vec3{2, 5, 1}));
    EXPECT_LT(DegreesBetween(NormalizedRows(m), Mat3FromAxisAngle(kVec3UnitZ, kQuarterTurn / 2)), 1e-4);
    EXPECT_EQ(m.Translation(), (Vec3{0.5f, 0, 0}));
    EXPECT_EQ(node->m_uiChangeStamp, 1u);
    EXPECT_EQ(node->m_kWorldMatrix, m);
}

TEST(CKeyframeControl, TracksMayHaveAxesOfTheirOwn)
{
    const Ref<CNode> node = TrackedNode({});
    CKeyframeControl& track = Track(*node);
    track.m_fEndTime = 100.0f;
    track.m_kPositionKeys = Along({0, 10});
    track.m_kPositionTimes = {0, 10};
    track.m_kScaleKeys = Along({1, 9}, kVec3One);
    track.m_kScaleTimes = {0, 80};
    track.m_kRotationKeys.push_back({0, 1, 0, 0}); // keys without times are ignored
    node->UpdateScene(5.0f, false);
    EXPECT_EQ(node->m_kMatrix, Mat4Compose(kMat3Identity, {5, 0, 0}, {1.5f, 1, 1}));
    EXPECT_EQ(PositionAt(*node, 20.0f), 10.0f);
    EXPECT_EQ(node->m_kMatrix.m[0], 3.0f);
    track.m_kKeyTimes = {0, 20}; // a shared axis takes precedence
    EXPECT_EQ(PositionAt(*node, 5.0f), 2.5f);
    track.m_kKeyTimes.clear();
    track.m_kPositionTimes.clear();
    EXPECT_EQ(PositionAt(*node, 5.0f), 0.0f);
}

TEST(CKeyframeControl, AnInactiveTrackGivesItsRestMatrixOrNothing)
{
    const Ref<CNode> node = TrackedNode({0, 8});
    CKeyframeControl& track = Track(*node);
    track.m_bActive = false;
    track.m_kRestMatrix.SetTranslation({50, 0, 0});
    EXPECT_FALSE(track.UpdateTransform(3.0f));
    EXPECT_EQ(node->m_kMatrix, kMat4Identity);
    EXPECT_EQ(node->m_uiChangeStamp, 0u);
    track.m_bHasRestMatrix = true;
    EXPECT_TRUE(track.UpdateTransform(3.0f));
    EXPECT_EQ(node->m_kMatrix, track.m_kRestMatrix);
    EXPECT_EQ(node->m_uiChangeStamp, 1u);
    track.m_bActive = true;
    EXPECT_EQ(PositionAt(*node, 3.0f), 3.0f);
}

TEST(CKeyframeControl, DamagedTracksEvaluateToWhatThereIs)
{
    const std::vector<Vec3> three = Along({1, 2, 3});
    const std::tuple<const char*, std::vector<float>, std::vector<Vec3>, float, float> rows[] = {
        {"fewer keys than times", {0, 1, 2, 3}, Along({7, 8}), 3.0f, 8.0f},
        {"one key", {0, 1, 2, 3}, Along({7}), 1.5f, 7.0f},
        {"times without keys", {0, 1}, {}, 0.5f, 0.0f},
        {"more keys than times", {0}, three, 5.0f, 1.0f},
        {"time that is no number", {0, 1, 2}, three, kNaN, 1.0f},
        {"axis of no numbers", {kNaN, kNaN, kNaN}, three, 1.0f, 1.0f},
        {"equal times", {0, 1, 1, 1, 2}, three, 1.0f, 3.0f},
    };
    for (const auto& [what, times, keys, time, position] : rows)
    {
        const Ref<CNode> node = TrackedNode(times);
        Track(*node).m_kPositionKeys = keys;
        Track(*node).m_fBeginTime = 0.0f;
        Track(*node).m_fEndTime = 10.0f;
        EXPECT_EQ(PositionAt(*node, time), position) << what;
    }
}

TEST(ParentMask, UndoesTheChosenPartsOfTheParentsKeyPose)
{
    const Mat3 turn = Mat3FromAxisAngle(kVec3UnitY, 1.0f);
    const Mat4 own = Mat4Compose(Mat3FromAxisAngle(kVec3UnitX, 0.5f), {1, 2, 3}, {1, 2, 1});
    // rotation: to be undone by the child
    const std::tuple<const char*, uint32_t, Mat3, Vec3> rows[] = {
        {"nothing", 0, kMat3Identity, kVec3One},        {"rotation", 0x38, turn, kVec3One},
        {"scale", 0x1c0, kMat3Identity, {2, 4, 8}},     {"scale along y", 0x80, kMat3Identity, {1, 4, 1}},
        {"rotation and scale", 0x1f8, turn, {2, 4, 8}},
    };
    for (const auto& [what, mask, rotation, scale] : rows)
    {
        SCOPED_TRACE(what);
        const Ref<CNode> parent = TrackedNode({0});
        Track(*parent).m_kPositionKeys = Along({10}, {0, 20, 30});
        Track(*parent).m_kRotationKeys = {QuatFromMat3(turn)};
        Track(*parent).m_kScaleKeys = Along({2}, {0, 4, 8});
        const Ref<CNode> child = TrackedNode({0});
        parent->AttachChild(child.Get());
        Track(*child).m_kPositionKeys = {own.Translation()};
        Track(*child).m_kRotationKeys = {QuatFromMat3(NormalizedRows(own))};
        Track(*child).m_kScaleKeys = {RowLengths(own)};
        Track(*child).m_uiParentMask = mask;
        parent->UpdateScene(0.0f, false);
        const Mat4 undone = Mat4Compose(rotation, kVec3Zero, scale);
        Mat4 expected =
            Mat4Compose(NormalizedRows(own), kVec3Zero, RowLengths(own)) * Mat4InverseOrIdentity(undone);
        expected.SetTranslation(own.Translation());
        ExpectNear(child->m_kMatrix, expected, 1e-5);
    }
}

TEST(ParentMask, UndoesPositionsThroughTheUndoneTurn)
{
    const Ref<CNode> parent = TrackedNode({0});
    Track(*parent).m_kPositionKeys = Along({10}, {0, 20, 30});
    const Ref<CNode> child = TrackedNode({0});
    parent->AttachChild(child.Get());
    Track(*child).m_kPositionKeys = Along({1}, {0, 2, 3});
    Track(*child).m_uiParentMask = 0x5; // x and z
    parent->UpdateScene(0.0f, false);
    EXPECT_EQ(child->m_kWorldMatrix.Translation(), (Vec3{1, 22, 3}));
    Track(*parent).m_kRotationKeys = {QuatFromMat3(Mat3FromAxisAngle(kVec3UnitZ, kQuarterTurn))};
    Track(*child).m_uiParentMask = 0x3f;
    parent->UpdateScene(0.0f, false);
    // The parent's position, rotated back: (10, 20, 30) becomes (20, -10, 30).
    EXPECT_NEAR(child->m_kMatrix.Translation().x, 1.0f - 20.0f, 1e-5f);
    EXPECT_NEAR(child->m_kMatrix.Translation().y, 2.0f + 10.0f, 1e-5f);
}

TEST(ParentMask, LooksAtTheFirstTrackByItsKeysAlone)
{
    const Ref<CNode> parent = new CNode;
    parent->AttachControl(new CTestControl(false));
    const Ref<CNode> other = TrackedNode({0});
    CKeyframeControl* track = new CKeyframeClipControl;
    parent->AttachControl(track);
    track->m_kKeyTimes = {0, 10};
    track->m_kPositionKeys = Along({0, 10});
    track->m_fEndTime = 10.0f;
    track->m_bActive = false; // without rest matrix, clips or mask
    track->m_uiParentMask = 7;
    parent->AttachChild(other.Get());
    Track(*other).m_uiParentMask = 1;
    parent->UpdateScene(4.0f, false);
    EXPECT_EQ(other->m_kMatrix.Translation().x, -4.0f);
}

// Keys at 0 to 100; clips: 0 walk 10-20, 1 held 30-40, 2 idle 50-54, 3 of length 0 at 60, 4 backwards 80-70.
Ref<CKeyframeClipControl> Clips(std::vector<ClipScheduleEntry> schedule)
{
    Ref<CKeyframeClipControl> control = new CKeyframeClipControl;
    const auto clip = [](int32_t type, float begin, float end) {
        ClipRecord record;
        record.m_iType = type;
        record.m_fBegin = begin;
        record.m_fEnd = end;
        return record;
    };
    control->m_kClips = {clip(1, 10, 20), clip(0, 30, 40), clip(2, 50, 54), clip(1, 60, 60), clip(5, 80, 70)};
    control->m_kSchedule = std::move(schedule);
    control->m_fBeginTime = 3.0f;
    control->m_fEndTime = 100.0f;
    return control;
}

TEST(CKeyframeClipControl, PlaysTheScheduleAndIdlesBetween)
{
    const Ref<CKeyframeClipControl> control =
        Clips({{5, 0, 2}, {40, 1, 1}, {60, 3, 1}, {70, 4, 1}, {80, 9, 1}});
    const std::tuple<const char*, float, float> rows[] = {
        {"idle before anything is scheduled", 1, 51},
        {"idle loops", 4.5f, 50.5f},
        {"one frame early is in time", 5.0f - 0.016f, 10.0f - 0.016f},
        {"first round", 7, 12},
        {"second round", 17, 12},
        {"the end of the last round", 25, 50},
        {"idle from where the rounds ended", 27, 52},
        {"a held clip stands at its begin", 47, 30},
        {"and has an end too", 51, 51},
        {"no length", 66, 60},
        {"backwards has run out at once", 71, 53}, // 11 after its end, in a loop of 4
        {"no such clip", 85, 3},
        {"before all time", -kInfinity, 50},
        {"no number", kNaN, 3},
    };
    for (const auto& [what, time, keyTime] : rows)
        EXPECT_NEAR(control->ClipTime(time), keyTime, 1e-5f) << what;
}

TEST(CKeyframeClipControl, OddClipsComeToAnEnd)
{
    const Ref<CKeyframeClipControl> control = Clips({});
    control->m_kSchedule = {ClipScheduleEntry{0, 0, -3}, ClipScheduleEntry{10, 4, -1}};
    control->m_kClips[2].m_fEnd = 50.0f + 1e-5f; // a tiny idle clip
    EXPECT_NEAR(control->ClipTime(1.0f), 50.0f, 1e-4f) << "rounds below 0 are none";
    EXPECT_EQ(control->ClipTime(15.0f), 80.0f) << "backwards gives its begin";
    EXPECT_NEAR(control->ClipTime(1e9f), 50.0f, 1e-4f);
    control->m_kClips[2].m_fEnd = 40.0f;
    EXPECT_EQ(control->ClipTime(1.0f), 50.0f) << "an idle clip the wrong way round gives its begin";
    control->m_kClips.resize(2);
    EXPECT_EQ(control->ClipTime(1.0f), 3.0f) << "without an idle clip it stays at its begin";
}

TEST(CKeyframeClipControl, MapsItsScheduleAndEvaluatesWithItsClamp)
{
    const Ref<CNode> node = new CNode;
    const Ref<CKeyframeClipControl> control = Clips({{4, 0, 1}});
    node->AttachControl(control.Get());
    control->m_fFrequency = 2.0f;
    control->m_fPhase = 1.0f;
    control->m_kKeyTimes = {0, 100};
    control->m_kPositionKeys = Along({0, 100});
    // The start of 4 maps to 9, the time of 6 to 13: 4 into the walk from 10.
    EXPECT_FLOAT_EQ(PositionAt(*node, 6.0f), 14.0f);
    control->m_fEndTime = 12.0f;
    EXPECT_FLOAT_EQ(PositionAt(*node, 6.0f), 12.0f);
    control->m_fFrequency = 0.0f;
    EXPECT_FLOAT_EQ(PositionAt(*node, 6.0f), 3.0f);
    control->m_iCycleType = 2;
    const Ref<CKeyframeClipControl> copy = static_cast<CKeyframeClipControl*>(control->CreateClone());
    EXPECT_EQ(copy->m_iCycleType, 0u);
    EXPECT_EQ(copy->m_kClips.size(), 5u);
}

void FillKeys(CVectorKeyControl& control)
{
    control.m_fEndTime = 10.0f;
    control.m_kKeys = {kVec3UnitX, kVec3UnitY, kVec3UnitZ};
    control.m_kKeyTimes = {0.0f, 4.0f, 6.0f};
}

TEST(CCameraControl, WritesTheVectorBetweenKeysAndPointsAheadWithout)
{
    const Ref<CCamera> camera = new CCamera;
    CCameraControl* control = new CCameraControl;
    camera->AttachControl(control);
    EXPECT_FALSE(control->Update(1.0f));
    EXPECT_EQ(camera->m_kControlVector, kVec3UnitZ);
    FillKeys(*control);
    camera->UpdateScene(3.0f, false);
    EXPECT_EQ(camera->m_kControlVector, (Vec3{0.25f, 0.75f, 0}));
    EXPECT_EQ(camera->m_uiChangeStamp, 2u);
    control->m_bActive = false;
    camera->UpdateScene(5.0f, false);
    EXPECT_EQ(camera->m_kControlVector, (Vec3{0.25f, 0.75f, 0}));
    control->m_bActive = true;
    control->m_kKeyTimes.clear();
    camera->UpdateScene(3.0f, false);
    EXPECT_EQ(camera->m_kControlVector, kVec3UnitZ) << "keys without times";
}

TEST(CLightControl, WritesTheColourBetweenKeysAndNothingWithout)
{
    const Ref<CPointLight> light = new CPointLight;
    const Ref<CLightControl> control = new CLightControl;
    light->AttachControl(control.Get());
    light->m_kRGB = kVec3One;
    EXPECT_FALSE(control->Update(1.0f));
    EXPECT_EQ(light->m_kRGB, kVec3One);
    FillKeys(*control);
    light->UpdateScene(5.0f, false);
    EXPECT_EQ(light->m_kRGB, (Vec3{0, 0.5f, 0.5f}));
    EXPECT_EQ(light->m_uiChangeStamp, 2u);
    const Ref<CCamera> camera = new CCamera;
    control->SetTarget(camera.Get());
    EXPECT_FALSE(control->Update(5.0f)) << "a target of another class";
}

} // namespace
} // namespace gw
