// One motion expressed relative to many rest poses, and re-expressed relative to a T-pose.

#include "AlignMotion.h"
#include "BoneMeshQueries.h"
#include "CHingeMeter.h"
#include "CKeyframeControl.h"
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
using Turn = std::function<Mat3(const std::string&)>;

bool IsOneOf(const std::string& joint, std::initializer_list<const char*> parts)
{
    return std::ranges::any_of(parts, [&](const char* part) { return joint.substr(1) == part; });
}

// Lowers the arms from the T-pose, with the hands.
Turn ArmsDown(double degrees)
{
    return [=](const std::string& joint) {
        const bool isArm =
            IsOneOf(joint, {"UpperArm", "Forearm", "Hand", "Thumb", "Index", "Middle", "Little"});
        return isArm ? TurnAbout(kVec3UnitZ, joint[0] == 'L' ? -degrees : degrees) : kMat3Identity;
    };
}

Turn Everywhere(const Mat3& turn)
{
    return [=](const std::string&) { return turn; };
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

// Shins and thighs lean by a degree or two, which is enough to rotate their frames.
Mat3 Slanted(const std::string& joint)
{
    if (IsOneOf(joint, {"Thigh", "Calf"}))
        return LeastSwing(-kVec3UnitY, {0, -40, 1});
    return kMat3Identity;
}

Mat3 TurnedKnees(const std::string& joint)
{
    return IsOneOf(joint, {"Thigh", "Calf"}) ? TurnAbout(kVec3UnitY, 70.0) : kMat3Identity;
}

// A rest pose does not always show how hands are held and feet stand.
Mat3 RolledHand(const std::string& joint)
{
    return joint == "LHand" ? TurnAbout(kVec3UnitX, 55.0) : kMat3Identity;
}

Mat3 HangingFeet(const std::string& joint)
{
    return IsOneOf(joint, {"Foot", "Toe"}) ? TurnAbout(kVec3UnitX, 35.0) : kMat3Identity;
}

struct TellingRow
{
    const char* what;
    Turn turn;
    Mat3 world;
    double degrees; ///< by how much frames may differ from those that the motion was made with
};

// A pose of the motion is not accurate to a degree; a rest pose is.
std::vector<TellingRow> Tellings()
{
    const Mat3 none = kMat3Identity;
    const Mat3 zUp = TurnAbout(kVec3UnitX, 90.0);
    const Turn straight = Everywhere(none);
    const Turn spread = ArmsDown(45.0);
    const Turn down = ArmsDown(88.0);
    const Turn standing = Everywhere(zUp);
    const Turn back = Everywhere(TurnAbout(kVec3UnitY, 180.0));
    return {
        {"a T-pose already", straight, none, 0.1},
        {"an A-pose", spread, none, 0.1},
        {"arms that hang", down, none, 0.1},
        {"a rest pose with Z up", standing, none, 0.1},
        {"a motion with Z up", standing, zUp, 0.1},
        {"Z up in the motion alone", straight, zUp, 0.1},
        {"a rest pose that faces back", back, none, 0.1},
        {"bones along X", AlongX, none, 12.0},
        {"bones along X, with Z up", AlongX, zUp, 12.0},
        {"slanted shins", Slanted, none, 0.1},
        {"knees that bend to the side", TurnedKnees, none, 2.0},
        {"a hand rolled at rest", RolledHand, none, 0.1},
        {"feet that hang at rest", HangingFeet, none, 1.0},
    };
}

CMadeBody Made(const TellingRow& row)
{
    Telling telling;
    telling.turn = row.turn;
    telling.world = row.world;
    return CMadeBody(telling);
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

double LargestDistance(const std::vector<Mat4>& a, const std::vector<Mat4>& b)
{
    double largest = a.size() == b.size() ? 0.0 : 1e9;
    for (size_t i = 0; i < std::min(a.size(), b.size()); ++i)
        largest = std::max(largest, Vec3Length(a[i].Translation() - b[i].Translation()));
    return largest;
}

size_t CountOf(const Corrections& corrections, ECorrection kind)
{
    return static_cast<size_t>(std::ranges::count(corrections.list, kind, &Correction::kind));
}

TEST(AlignMotion, KeepsEveryJointWhereItIsAtEveryFrame)
{
    const CMadeBody truth{Telling()};
    for (const TellingRow& row : Tellings())
    {
        SCOPED_TRACE(row.what);
        const CMadeBody told = Made(row);
        const AlignedMotion aligned = Align(told);
        for (int frame = 0; frame < told.Motion().frameCount; ++frame)
        {
            const float frequency = told.Motion().frequency;
            EXPECT_LT(LargestDistance(WorldsAt(*aligned.root, frequency, frame),
                                      WorldsAt(*truth.Motion().root, frequency, frame)),
                      0.001)
                << "frame " << frame;
        }
    }
}

TEST(AlignMotion, FindsTheFramesThatTheMotionWasMadeWith)
{
    const CMadeBody truth{Telling()};
    for (const TellingRow& row : Tellings())
    {
        SCOPED_TRACE(row.what);
        const CMadeBody told = Made(row);
        const AlignedMotion aligned = Align(told);
        const float frequency = told.Motion().frequency;
        const std::vector<Mat4> found = WorldsAt(*aligned.root, frequency, 7);
        const std::vector<Mat4> made = WorldsAt(*truth.Motion().root, frequency, 7);
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

TEST(AlignMotion, ChangesNothingOfWhatIsAligned)
{
    for (const TellingRow& row : Tellings())
    {
        SCOPED_TRACE(row.what);
        const CMadeBody told = Made(row);
        const AlignedMotion once = Align(told);
        BodyMotion again = told.Motion();
        const std::vector<CNode*> joints = NodesOf(*again.root);
        const auto follow = [&](CNode*& joint) {
            const auto found = std::ranges::find(joints, joint);
            joint =
                found == joints.end() ? nullptr : once.joints[static_cast<size_t>(found - joints.begin())];
        };
        again.root = once.root.Get();
        for (CNode** joint : {&again.body.hip, &again.body.spine[0], &again.body.spine[1],
                              &again.body.neck[0], &again.body.head})
            follow(*joint);
        for (BodyArm& arm : again.body.arms)
        {
            for (CNode** joint : {&arm.clavicle, &arm.upperArm, &arm.forearm, &arm.hand})
                follow(*joint);
        }
        for (BodyLeg& leg : again.body.legs)
        {
            for (CNode** joint : {&leg.thigh, &leg.shin, &leg.foot, &leg.toe})
                follow(*joint);
        }
        Alignment alignment;
        ASSERT_TRUE(PlanAlignment(again, alignment));
        EXPECT_TRUE(alignment.corrections.list.empty());
        EXPECT_EQ(alignment.corrections.referenceFrame, -1);
        for (const JointAlignment& joint : alignment.joints)
            EXPECT_LT(AngleOf(joint.turn), 0.1) << joint.node->GetName();
    }
}

TEST(AlignMotion, TellsPositionsThatRepeatOffsetsOnce)
{
    Telling telling;
    telling.doubled = true;
    const CMadeBody told(telling);
    const CMadeBody truth{Telling()};
    Corrections corrections;
    const AlignedMotion aligned = Align(told, &corrections);
    EXPECT_EQ(CountOf(corrections, ECorrection::DoubledPositions), told.Names().size() - 1);
    EXPECT_LT(LargestDistance(WorldsAt(*aligned.root, told.Motion().frequency, 9),
                              WorldsAt(*truth.Motion().root, told.Motion().frequency, 9)),
              0.001);
}

TEST(AlignMotion, KeepsPositionsThatVary)
{
    Telling telling;
    telling.turn = ArmsDown(60.0);
    const CMadeBody told(telling);
    auto& track = static_cast<CKeyframeControl&>(*told.Joint("LHand").GetControl());
    for (size_t frame = 3; frame < track.m_kPositionKeys.size(); ++frame)
        track.m_kPositionKeys.Expand()[frame].y += 0.1f * static_cast<float>(frame);
    const AlignedMotion aligned = Align(told);
    for (const int frame : {0, 2, 3, 39})
    {
        const std::vector<Mat4> before = WorldsAt(*told.Motion().root, told.Motion().frequency, frame);
        EXPECT_LT(LargestDistance(before, WorldsAt(*aligned.root, told.Motion().frequency, frame)), 0.001);
    }
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
        Telling telling;
        telling.turn = ArmsDown(45.0);
        telling.without = without;
        telling.frameCount = frameCount;
        const CMadeBody told(telling);
        const AlignedMotion aligned = Align(told);
        EXPECT_LT(LargestDistance(WorldsAt(*told.Motion().root, told.Motion().frequency, 0),
                                  WorldsAt(*aligned.root, told.Motion().frequency, 0)),
                  frameCount > 0 ? 0.001 : 100.0);
        const Vec3 arm = RestLocal(*FindNode(aligned.root.Get(), "LForearm")).Translation();
        EXPECT_LT(AngleBetween(arm, kVec3UnitX), 0.1);
    }
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
    Telling telling;
    telling.world = TurnAbout(kVec3UnitX, -90.0);
    const CMadeBody told(telling);
    auto& root = static_cast<CKeyframeControl&>(*told.Joint("LowerTorso").GetControl());
    root.m_kRestMatrix.SetTranslation({0, 90, 0});
    for (Vec3& place : root.m_kPositionKeys.Expand())
        place = place + Vec3{150, 0, 220};
    Corrections corrections;
    Align(told, &corrections);
    EXPECT_EQ(CountOf(corrections, ECorrection::UpAxis), 0u);
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
    const Mat3 zUp = TurnAbout(kVec3UnitX, 90.0);
    const struct
    {
        const char* what;
        Turn turn;
        Mat3 world;
        Vec3 up;
    } rows[] = {
        {"Y up", Everywhere(kMat3Identity), kMat3Identity, kVec3UnitY},
        {"Z up, with a rest pose too", Everywhere(zUp), zUp, kVec3UnitZ},
        {"Z up in the motion alone", Everywhere(kMat3Identity), zUp, kVec3UnitZ},
        {"bones along X, with Z up", AlongX, zUp, kVec3UnitZ},
        {"bones along X", AlongX, kMat3Identity, kVec3UnitY},
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.what);
        CMadeBody::Telling telling;
        telling.turn = row.turn;
        telling.world = row.world;
        telling.frameCount = 60;
        telling.tumbling = 35;
        const CMadeBody made(telling);
        const BodyMotion motion = made.Motion();
        EXPECT_EQ(FindUpAxis(motion.body, motion.frequency, motion.frameCount), row.up);
    }
}

} // namespace
} // namespace gw
