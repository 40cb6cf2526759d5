// One motion expressed relative to many rest poses, and re-expressed relative to a T-pose.

#include "AlignMotion.h"
#include "BoneMeshQueries.h"
#include "CHingeMeter.h"
#include "CMadeBody.h"
#include "CPoseSampler.h"
#include "Directions.h"
#include "Rotations.h"
#include "Skeleton.h"
#include "UpAxis.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

using Telling = CMadeBody::Telling;
using Turn = CMadeBody::Turn;

const Mat3 kZUp = TurnAbout(kVec3UnitX, 90.0);

Turn Everywhere(const Mat3& turn)
{
    return [=](const std::string&) { return turn; };
}

Turn Both(const char* part, const char* other, const Mat3& turn)
{
    return [=](const std::string& joint) { return IsOneOf(joint, {part, other}) ? turn : kMat3Identity; };
}

// Each bone along X, rotated about it by its own angle.
Mat3 AlongX(const std::string& joint)
{
    const bool isLeg = IsOneOf(joint, {"Thigh", "Calf", "Foot", "Toe"});
    const Vec3 left = joint[0] == 'L' ? kVec3UnitX : -kVec3UnitX;
    const bool isArm = IsOneOf(joint, {"Collar", "UpperArm", "Forearm", "Hand"});
    const Vec3 bone = isLeg ? -kVec3UnitY : isArm ? left : kVec3UnitY;
    const double twist = 37.0 * static_cast<double>(joint.size() + static_cast<size_t>(joint[1] % 5));
    return LeastSwing(bone, kVec3UnitX) * TurnAbout(kVec3UnitX, twist);
}

// A rest pose does not always show how hands are held.
Mat3 RolledHand(const std::string& joint)
{
    return joint == "LHand" ? TurnAbout(kVec3UnitX, 55.0) : kMat3Identity;
}

struct TellingRow
{
    const char* what;
    Turn turn;
    bool zUp;       ///< of the motion
    double degrees; ///< by how much frames may differ from those that the motion was made with
};

// A pose of the motion is not accurate to a degree; a rest pose is.
std::vector<TellingRow> Tellings()
{
    const Turn straight = Everywhere(kMat3Identity);
    const Turn standing = Everywhere(kZUp);
    const Turn back = Everywhere(TurnAbout(kVec3UnitY, 180.0));
    // Shins and thighs lean by a degree or two, which is enough to rotate their frames.
    const Turn slanted = Both("Thigh", "Calf", LeastSwing(-kVec3UnitY, {0, -40, 1}));
    const Turn turnedKnees = Both("Thigh", "Calf", TurnAbout(kVec3UnitY, 70.0));
    const Turn hangingFeet = Both("Foot", "Toe", TurnAbout(kVec3UnitX, 35.0));
    return {
        {"a T-pose already", straight, false, 0.1},
        {"an A-pose", ArmsDown(45.0), false, 0.1},
        {"arms that hang", ArmsDown(88.0), false, 0.1},
        {"a rest pose with Z up", standing, false, 0.1},
        {"a motion with Z up", standing, true, 0.1},
        {"Z up in the motion alone", straight, true, 0.1},
        {"a rest pose that faces back", back, false, 0.1},
        {"bones along X", AlongX, false, 12.0},
        {"bones along X, with Z up", AlongX, true, 12.0},
        {"slanted shins", slanted, false, 0.1},
        {"knees that bend to the side", turnedKnees, false, 2.0},
        {"a hand rolled at rest", RolledHand, false, 0.1},
        {"feet that hang at rest", hangingFeet, false, 1.0},
    };
}

CMadeBody Made(const TellingRow& row, int frameCount = 40, int tumbling = 0)
{
    return CMadeBody({.turn = row.turn,
                      .world = row.zUp ? kZUp : kMat3Identity,
                      .tumbling = tumbling,
                      .frameCount = frameCount});
}

AlignedMotion Align(const CMadeBody& body, Corrections* corrections = nullptr)
{
    const BodyMotion motion = body.Motion();
    Alignment alignment;
    EXPECT_TRUE(PlanAlignment(motion, alignment));
    if (corrections)
        *corrections = alignment.corrections;
    return AlignMotion(motion, alignment);
}

// Returns how far the joints of two motions of the same skeleton are apart at a frame.
double LargestDistance(CNode& a, CNode& b, const BodyMotion& motion, int frame)
{
    const std::vector<Mat4> first = WorldsAt(a, motion.frequency, frame);
    const std::vector<Mat4> second = WorldsAt(b, motion.frequency, frame);
    double largest = first.size() == second.size() ? 0.0 : 1e9;
    for (size_t i = 0; i < std::min(first.size(), second.size()); ++i)
        largest = std::max(largest, Vec3Length(first[i].Translation() - second[i].Translation()));
    return largest;
}

size_t CountOf(const Corrections& corrections, ECorrection kind)
{
    return static_cast<size_t>(std::ranges::count(corrections.list, kind, &Correction::kind));
}

TEST(AlignMotion, KeepsPlacesAndFindsTheFramesThatTheMotionWasMadeWith)
{
    const CMadeBody truth{Telling()};
    CNode& meant = *truth.Motion().root;
    for (const TellingRow& row : Tellings())
    {
        SCOPED_TRACE(row.what);
        const CMadeBody told = Made(row);
        const BodyMotion motion = told.Motion();
        const AlignedMotion aligned = Align(told);
        for (int frame = 0; frame < motion.frameCount; ++frame)
            EXPECT_LT(LargestDistance(*aligned.root, meant, motion, frame), 0.001) << frame;
        const std::vector<Mat4> found = WorldsAt(*aligned.root, motion.frequency, 7);
        const std::vector<Mat4> made = WorldsAt(meant, motion.frequency, 7);
        for (size_t i = 0; i < made.size(); ++i)
        {
            const std::string& name = truth.Names()[i];
            if (IsOneOf(name, {"Thumb", "Index", "Middle", "Little"}))
                continue; // fingers follow their hand's zero pose
            EXPECT_LT(DegreesBetween(NormalizedRows(found[i]), NormalizedRows(made[i])), row.degrees) << name;
        }
    }
}

TEST(AlignMotion, LaysEveryLimbAlongItsAxisAtRest)
{
    for (const TellingRow& row : Tellings())
    {
        SCOPED_TRACE(row.what);
        const CMadeBody told = Made(row);
        const AlignedMotion aligned = Align(told);
        const std::tuple<const char*, const char*, Vec3> bones[] = {
            {"LowerTorso", "Waist", kVec3UnitY},   {"UpperTorso", "Neck", kVec3UnitY},
            {"Neck", "Head", kVec3UnitY},          {"LCollar", "LUpperArm", kVec3UnitX},
            {"LUpperArm", "LForearm", kVec3UnitX}, {"LForearm", "LHand", kVec3UnitX},
            {"LHand", "LMiddle", kVec3UnitX},      {"RUpperArm", "RForearm", -kVec3UnitX},
            {"RForearm", "RHand", -kVec3UnitX},    {"LThigh", "LCalf", -kVec3UnitY},
            {"LCalf", "LFoot", -kVec3UnitY},       {"RCalf", "RFoot", -kVec3UnitY},
        };
        for (const auto& [from, to, axis] : bones)
        {
            const Vec3 way = RestWorld(*FindNode(aligned.root.Get(), to)).Translation() -
                             RestWorld(*FindNode(aligned.root.Get(), from)).Translation();
            EXPECT_LT(AngleBetween(way, axis), 0.1) << from;
        }
        const Vec3 toe = RestLocal(*FindNode(aligned.root.Get(), "RToe")).Translation();
        EXPECT_NEAR(toe.x, 0.0f, 0.1f) << "heads along +Z";
        EXPECT_GT(toe.z, 12.0f);
        EXPECT_NEAR(toe.y, -6.0f, 0.5f) << "with a level sole";
    }
}

TEST(AlignMotion, TellsPositionsThatRepeatOffsetsOnce)
{
    const CMadeBody told({.doubled = true});
    const CMadeBody truth{Telling()};
    Corrections corrections;
    const AlignedMotion aligned = Align(told, &corrections);
    EXPECT_EQ(CountOf(corrections, ECorrection::DoubledPositions), told.Names().size() - 1);
    EXPECT_LT(LargestDistance(*aligned.root, *truth.Motion().root, told.Motion(), 9), 0.001);
}

TEST(AlignMotion, KeepsPositionsThatVary)
{
    const CMadeBody told({.turn = ArmsDown(60.0)});
    CKeyframeControl& track = told.Track("LHand");
    for (size_t frame = 3; frame < track.m_kPositionKeys.size(); ++frame)
        track.m_kPositionKeys.Expand()[frame].y += 0.1f * static_cast<float>(frame);
    const AlignedMotion aligned = Align(told);
    for (const int frame : {0, 2, 3, 39})
        EXPECT_LT(LargestDistance(*told.Motion().root, *aligned.root, told.Motion(), frame), 0.001) << frame;
}

TEST(AlignMotion, WorksOnBodiesThatLackJointsAndOnSinglePoses)
{
    const std::tuple<const char*, std::vector<std::string>, int> rows[] = {
        {"no hands", {"LHand", "RHand"}, 40},
        {"no fingers", {"LThumb", "LIndex", "LMiddle", "LLittle"}, 40},
        {"no toes", {"LToe", "RToe"}, 40},
        {"no neck and no head", {"Neck"}, 40},
        {"one pose", {}, 1},
        {"no pose", {}, 0},
    };
    for (const auto& [what, without, frameCount] : rows)
    {
        SCOPED_TRACE(what);
        const CMadeBody told({.turn = ArmsDown(45.0), .frameCount = frameCount, .without = without});
        const AlignedMotion aligned = Align(told);
        EXPECT_LT(LargestDistance(*told.Motion().root, *aligned.root, told.Motion(), 0),
                  frameCount > 0 ? 0.001 : 100.0);
        const Vec3 arm = RestLocal(*FindNode(aligned.root.Get(), "LForearm")).Translation();
        EXPECT_LT(AngleBetween(arm, kVec3UnitX), 0.1);
    }
}

TEST(FootTurn, SolesAreLevelWhetherOrNotAFootIsSeenToStand)
{
    const CMadeBody rolling{{}};
    for (size_t frame = 0; frame < 10; ++frame) // a quarter of the time, which says nothing
    {
        Quat& key = rolling.Track("LFoot").m_kRotationKeys[frame];
        key = QuatFromMat3(TurnAbout(kVec3UnitZ, 40.0) * QuatToMat3(key));
    }
    const AlignedMotion level = Align(rolling);
    level.root->UpdateScene(20.0f / rolling.Motion().frequency, true);
    const Mat4& foot = FindNode(level.root.Get(), "LFoot")->m_kWorldMatrix;
    EXPECT_LT(DegreesBetween(NormalizedRows(foot), kMat3Identity), 0.1);
    const CMadeBody hanging({.turn = AlongX, .frameCount = 1});
    const Mat3 axes = AlongX("LFoot");
    Quat& key = hanging.Track("LFoot").m_kRotationKeys[0];
    key = QuatFromMat3(Mat3Transpose(axes) * TurnAbout(kVec3UnitX, 35.0) * axes * QuatToMat3(key));
    const AlignedMotion sloping = Align(hanging);
    EXPECT_NEAR(RestLocal(*FindNode(sloping.root.Get(), "LToe")).Translation().y, -6.0f, 0.5f);
}

TEST(CHingeMeter, FramesThatHardlyBendHaveNoSay)
{
    const CNode bone;
    CHingeMeter hinge;
    const auto bend = [&](const Vec3& axis, double degrees, int frames) {
        for (int frame = 0; frame < frames; ++frame)
            hinge.Add(-kVec3UnitY, Turned(-kVec3UnitY, TurnAbout(axis, degrees)), bone);
    };
    bend(kVec3UnitX, 60.0, 4);
    EXPECT_FALSE(hinge.Axis()) << "too few";
    bend(kVec3UnitZ, 10.0, 20);
    EXPECT_FALSE(hinge.Axis());
    bend(kVec3UnitX, 60.0, 1);
    ASSERT_TRUE(hinge.Axis());
    EXPECT_LT(AngleBetween(*hinge.Axis(), kVec3UnitX), 0.1);
    bend(kVec3UnitZ, 60.0, 5);
    EXPECT_FALSE(hinge.Axis()) << "about two axes";
}

TEST(PlanAlignment, NamesWhatItMends)
{
    const auto findings = [](const TellingRow& row) {
        Corrections corrections;
        Align(Made(row), &corrections);
        return corrections;
    };
    const std::vector<TellingRow> rows = Tellings();
    EXPECT_TRUE(findings(rows[0]).list.empty()) << rows[0].what;
    EXPECT_EQ(CountOf(findings(rows[1]), ECorrection::RestPose), 4u) << rows[1].what;
    EXPECT_EQ(CountOf(findings(rows[4]), ECorrection::UpAxis), 1u) << rows[4].what;
    EXPECT_EQ(CountOf(findings(rows[9]), ECorrection::BoneFrames), 4u) << rows[9].what;
    EXPECT_GE(findings(rows[7]).referenceFrame, 0) << rows[7].what;
}

TEST(PlanAlignment, LeavesABodyThatLiesOnTheGroundLying)
{
    const CMadeBody told({.world = TurnAbout(kVec3UnitX, -90.0)});
    CKeyframeControl& root = told.Track("LowerTorso");
    root.m_kRestMatrix.SetTranslation({0, 90, 0});
    for (Vec3& place : root.m_kPositionKeys.Expand())
        place = place + Vec3{150, 0, 220};
    Corrections corrections;
    Align(told, &corrections);
    EXPECT_EQ(CountOf(corrections, ECorrection::UpAxis), 0u);
}

// The same, but the body walks: each foot stays in place for half of the steps.
TEST(UpAxis, IsThatOfABodyThatWalksFarFromTheOrigin)
{
    constexpr double kReach = 0.15; // of a foot's angle, in radians
    const Mat3 world = TurnAbout(kVec3UnitX, -90.0);
    const CMadeBody told({.world = world});
    Vec3* const places = told.Track("LowerTorso").m_kPositionKeys.Expand().data();
    for (int frame = 0; frame < 40; ++frame)
    {
        const double swing = kReach * (std::abs(frame % 20 - 10) / 5.0 - 1.0);
        places[frame] = Turned({0.0f, 84.0f, static_cast<float>(78.0 * kReach / 5.0 * frame)}, world) +
                        Vec3{150, 90, 220};
        for (const auto& [thigh, calf, angle] :
             {std::tuple{"LThigh", "LCalf", swing}, std::tuple{"RThigh", "RCalf", -swing}})
        {
            told.Track(thigh).m_kRotationKeys[static_cast<size_t>(frame)] =
                QuatFromMat3(TurnAbout(kVec3UnitX, -angle * kRadiansToDegrees64));
            told.Track(calf).m_kRotationKeys[static_cast<size_t>(frame)] = QuatFromMat3(kMat3Identity);
        }
    }
    EXPECT_EQ(FindUpAxis(told.Motion().body, told.Motion().frequency, 40), -kVec3UnitZ);
}

TEST(PlanAlignment, FindsOffsetsThatAreOnlyInTheMotionIfBonesAreAimed)
{
    const CMadeBody told{Telling()};
    for (const std::string& name : told.Names())
    {
        if (name == told.Names().front())
            continue;
        CKeyframeControl& track = told.Track(name);
        track.m_kPositionKeys.assign(1, track.m_kRestMatrix.Translation());
        track.m_kRestMatrix.SetTranslation(kVec3Zero);
    }
    BodyMotion motion = told.Motion();
    for (const auto& [limbs, length] :
         {std::tuple{ELimbWays::Offsets, 0.0f}, std::tuple{ELimbWays::Mean, 40.0f}})
    {
        motion.limbs = limbs;
        Alignment alignment;
        ASSERT_TRUE(PlanAlignment(motion, alignment));
        const AlignedMotion aligned = AlignMotion(motion, alignment);
        EXPECT_LT(LargestDistance(*motion.root, *aligned.root, motion, 20), 0.001);
        const Vec3 calf = RestLocal(*FindNode(aligned.root.Get(), "LCalf")).Translation();
        EXPECT_LT(Vec3Length(calf - Vec3{0.0f, -length, 0.0f}), 0.5f);
    }
}

TEST(PlanAlignment, RefusesWhatIsNoBody)
{
    const CMadeBody told{Telling()};
    Alignment alignment;
    BodyMotion motion = told.Motion();
    motion.body.Leg(EBodySide::Left).thigh = nullptr;
    EXPECT_FALSE(PlanAlignment(motion, alignment)) << "one leg";
    motion = told.Motion();
    motion.body.hip = nullptr;
    EXPECT_FALSE(PlanAlignment(motion, alignment)) << "no hip";
    EXPECT_FALSE(PlanAlignment(BodyMotion(), alignment)) << "nothing";
}

TEST(UpAxis, IsThatOfABodyThatIsUpsideDownForPartOfTheMotion)
{
    for (const TellingRow& row : Tellings())
    {
        const CMadeBody made = Made(row, 60, 35);
        EXPECT_EQ(FindUpAxis(made.Motion().body, made.Motion().frequency, 60),
                  row.zUp ? kVec3UnitZ : kVec3UnitY)
            << row.what;
    }
}

} // namespace
} // namespace gw
