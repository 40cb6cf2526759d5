#include "BodyStance.h"
#include "BodyTree.h"
#include "CNamedBody.h"
#include "CheckBody.h"
#include "FindBody.h"
#include "FindBodyByNames.h"
#include "FindBodyByShape.h"
#include "JointSteps.h"
#include "MotionNode.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

using enum EBodySide;

void MoveArmsInward(CBodyMap& body)
{
    for (BodyArm& arm : body.arms)
        arm = {nullptr, arm.clavicle, arm.upperArm, arm.forearm};
}

void MoveArmsOutward(CBodyMap& body)
{
    for (BodyArm& arm : body.arms)
        arm = {arm.upperArm, arm.forearm, arm.hand, ChildNodes(*arm.hand).front()};
}

void MoveLegsOutward(CBodyMap& body)
{
    for (BodyLeg& leg : body.legs)
        leg = {leg.shin, leg.foot, leg.toe, nullptr};
}

void SwapAll(CBodyMap& body)
{
    std::swap(body.arms[0], body.arms[1]);
    std::swap(body.legs[0], body.legs[1]);
}

TEST(FindBodyByShape, FindsTheBodyOfEveryMadeSkeletonWithoutDoubts)
{
    for (const std::string& recipe : SkeletonRecipes())
    {
        for (unsigned seed = 1; seed <= 2; ++seed)
        {
            SCOPED_TRACE("\"" + recipe + "\", seed " + std::to_string(seed));
            const CMadeSkeleton made(recipe, seed);
            const CBodyMap body = FindBodyByShape(made.Root());
            EXPECT_TRUE(CheckBody(body).empty());
            for (const BodyPlace& place : BodyPlaces())
                EXPECT_EQ(JointAt(body, place), JointAt(made.Body(), place)) << IndexOf(place);
        }
    }
}

TEST(CheckBody, DoubtsMapsThatAreWrong)
{
    const std::tuple<const char*, void (*)(CBodyMap&), EDoubt, EBodyJoint> rows[] = {
        {"left and right swapped", SwapAll, EDoubt::SidesSwapped, EBodyJoint::Thigh},
        {"arms swapped", [](CBodyMap& body) { std::swap(body.arms[0], body.arms[1]); }, EDoubt::SidesSwapped,
         EBodyJoint::UpperArm},
        {"clavicles as upper arms", MoveArmsInward, EDoubt::ArmIsClavicle, EBodyJoint::UpperArm},
        {"upper arms as clavicles", MoveArmsOutward, EDoubt::ClavicleIsArm, EBodyJoint::UpperArm},
        {"shins as thighs", MoveLegsOutward, EDoubt::OddLength, EBodyJoint::Thigh},
        {"a hand that is the other one", [](CBodyMap& body) { body.arms[0].hand = body.arms[1].hand; },
         EDoubt::NotBelow, EBodyJoint::Hand},
        {"a leg that goes up with the spine",
         [](CBodyMap& body) {
             body.legs[0] = {body.spine[0], body.spine[1], nullptr, nullptr};
         },
         EDoubt::LegsUp, EBodyJoint::Thigh},
    };
    for (const char* recipe : {"fingers", "fingers apose zup", "fingers nopose walk rightfirst"})
    {
        const CMadeSkeleton made(recipe, 1);
        for (const auto& [what, spoil, kind, joint] : rows)
        {
            SCOPED_TRACE(std::string(what) + ", \"" + recipe + '"');
            CBodyMap body = FindBodyByShape(made.Root());
            spoil(body);
            const std::vector<BodyDoubt> doubts = CheckBody(body);
            EXPECT_TRUE(std::ranges::any_of(doubts, [kind = kind, joint = joint](const BodyDoubt& doubt) {
                return doubt.kind == kind && doubt.place.joint == joint;
            }));
        }
    }
}

TEST(JointSteps, PlacesApartAreMoreThanRounding)
{
    EXPECT_TRUE(ArePlacedApart({0, 900, 0}, {0, 900.01f, 0}));
    EXPECT_FALSE(ArePlacedApart({0, 900, 0}, {0, 900.0005f, 0}));
}

TEST(BodyStance, VerdictsHaveTheirLimits)
{
    constexpr std::optional<double> kNone;
    const std::tuple<const char*, std::optional<double>, std::optional<double>, std::optional<double>,
                     ERestPose>
        rows[] = {
            {"arms aside", 32.0, 58.0, 5.0, ERestPose::TPose},
            {"arms half down", 33.0, 57.0, 5.0, ERestPose::APose},
            {"nearly down", 59.0, 31.0, 5.0, ERestPose::APose},
            {"down", 60.0, 30.0, 5.0, ERestPose::ArmsDown},
            {"forward and half up", 66.0, 80.0, 5.0, ERestPose::Other},
            {"legs that just stand", 10.0, 80.0, 45.0, ERestPose::TPose},
            {"legs that sit", 10.0, 80.0, 46.0, ERestPose::None},
            {"legs that are not there", 10.0, 80.0, kNone, ERestPose::TPose},
            {"arms that are not there", kNone, kNone, 5.0, ERestPose::Unknown},
        };
    for (const auto& [what, side, down, thighs, verdict] : rows)
    {
        BodyStance stance;
        stance.armsSide = side;
        stance.armsDown = down;
        stance.thighs = thighs;
        EXPECT_EQ(stance.Verdict(), verdict) << what;
    }
}

TEST(FindBody, NamesAndShapeTogether)
{
    const CNamedBody named(kHumanIK, {"as it is"});
    named.Body().legs[1].toe->SetName("nothing");
    const FoundBody found = FindBody(named.Root());
    EXPECT_TRUE(found.doubts.empty());
    EXPECT_TRUE(found.sidesAreSure);
    EXPECT_EQ(found.Evidence({EBodyJoint::Thigh, Left}), EBodyEvidence::Both);
    // The toe's name says nothing; its foot is the same by name and by shape.
    EXPECT_EQ(found.Evidence({EBodyJoint::Toe, Right}), EBodyEvidence::Shape);
    EXPECT_EQ(found.body.legs[1].toe, named.Body().legs[1].toe);
}

TEST(FindBody, NamesThatThePlacesContradictGiveWay)
{
    BodyChange change{"sides swapped"};
    change.names = BodyChange::SidesSwapped;
    const CNamedBody named(kHumanIK, change);
    ASSERT_EQ(FindBodyByNames(named.Root()).legs[0].thigh, named.Body().legs[1].thigh);
    const FoundBody found = FindBody(named.Root());
    EXPECT_EQ(found.body.legs[0].thigh, named.Body().legs[0].thigh);
    EXPECT_EQ(found.Evidence({EBodyJoint::Thigh, Left}), EBodyEvidence::ShapeOnly);
    EXPECT_EQ(found.Evidence({EBodyJoint::Hip}), EBodyEvidence::Both);
}

TEST(FindBody, SaysWhenNoPoseShowsTheSides)
{
    EXPECT_TRUE(FindBody(CMadeSkeleton("", 1).Root()).sidesAreSure);
    // Feet without toes or tips, and straight knees, show no direction.
    const FoundBody found = FindBody(CMadeSkeleton("notoes bare", 1).Root());
    EXPECT_TRUE(found.body.DrivesBody());
    EXPECT_FALSE(found.sidesAreSure);
}

// A name such as "arm_L_2" does not say which joint of the arm it is, but it agrees with a forearm.
TEST(FindBody, NumberedChainsAgreeWithTheShape)
{
    constexpr const char* kArms = "arm_joint_+_1 arm_joint_+_2 arm_joint_+_3 arm_joint_+_4";
    constexpr const char* kLegs = "- leg_joint_+_1 leg_joint_+_2 leg_joint_+_3 leg_joint_+_5";
    const std::tuple<const char*, const char*, const char*, bool> rows[] = {
        {"numbered outward", kArms, kLegs, true},
        {"the first without a number", "Arm.+ Arm.+.001 Arm.+.002 Arm.+.003",
         "- Leg.+ Leg.+.001 Leg.+.002 Leg.+.003", true},
        {"numbered inward, with a named foot", "Clav_+ *Arm__3_ *Arm__2_ *Hand", "- Leg2+ Leg1+ Foot+ Toe+",
         true},
        {"no numbers in order", "arm_+_2 arm_+_4 arm_+_1 arm_+_3", "- leg_+_1 leg_+_3 leg_+_2 toe_+", false},
        {"other limbs", "leg_+_1 leg_+_2 leg_+_3 leg_+_4", "- arm_+_1 arm_+_2 arm_+_3 arm_+_4", false},
        {"no limb", "chain_+_1 chain_+_2 chain_+_3 chain_+_4", "- rope_+_1 rope_+_2 rope_+_3 rope_+_4",
         false},
    };
    for (const auto& [what, arm, leg, agrees] : rows)
    {
        SCOPED_TRACE(what);
        const Convention names{what, "Left Right", "torso_1 torso_2 torso_3 torso_4", "Neck Head", arm, leg};
        const CNamedBody named(names, {"as it is"});
        const FoundBody found = FindBody(named.Root());
        for (const EBodySide side : {Left, Right})
        {
            for (const EBodyJoint joint : {EBodyJoint::Forearm, EBodyJoint::Hand, EBodyJoint::Shin})
                EXPECT_EQ(found.Evidence({joint, side}) == EBodyEvidence::Both, agrees);
            EXPECT_EQ(found.body.Leg(side).shin, named.Body().Leg(side).shin);
        }
        EXPECT_EQ(found.Evidence({EBodyJoint::Hip}), EBodyEvidence::Both);
    }
}

// Joints of all limbs as "arm_L_1" and so on, from the upper arm or thigh to the end.
void NumberLimbs(const CBodyMap& body, const char* sides)
{
    for (const EBodySide side : {Left, Right})
    {
        for (const bool isArm : {true, false})
        {
            int number = 0;
            CNode* joint = isArm ? body.Arm(side).upperArm : body.Leg(side).thigh;
            const std::string stem = std::string(isArm ? "arm_" : "leg_") + sides[side == Left ? 0 : 1] + '_';
            for (; joint; joint = FirstChild(*joint))
                joint->SetName((stem + std::to_string(++number)).c_str());
        }
    }
}

// Between elbow and wrist, a joint that twists has a number too.
TEST(FindBody, AJointThatTheShapeLeavesOutBreaksAChain)
{
    const CMadeSkeleton made("twist", 1);
    NumberLimbs(made.Body(), "LR");
    const FoundBody found = FindBody(made.Root());
    EXPECT_EQ(found.body.Arm(Left).forearm, made.Body().Arm(Left).forearm);
    EXPECT_NE(found.Evidence({EBodyJoint::Forearm, Left}), EBodyEvidence::Both);
}

TEST(FindBody, NamesShowTheSidesThatNoPoseShows)
{
    for (const char* sides : {"LR", "RL"})
    {
        const CMadeSkeleton made("notoes bare", 1);
        NumberLimbs(made.Body(), sides);
        const FoundBody found = FindBody(made.Root());
        EXPECT_TRUE(found.sidesAreSure);
        EXPECT_EQ(found.body.Arm(Left).hand->NameView(), "arm_L_3");
        EXPECT_EQ(found.Evidence({EBodyJoint::Shin, Right}), EBodyEvidence::Both);
    }
}

TEST(FindBody, LeavesThePoseAsItWas)
{
    const CMadeSkeleton made("walk", 1);
    CNode& root = made.Root();
    root.UpdateTransform(0.2f);
    const Mat4 before = FindBodyByShape(root).head->m_kWorldMatrix;
    FindBody(root);
    EXPECT_EQ(FindBodyByShape(root).head->m_kWorldMatrix, before);
}

// Trees that a careless or hostile file can contain.
TEST(FindBody, FindsNoneWhereNoneIs)
{
    // Joints below each other, joints beside each other at the end of those, and the length of all bones.
    const std::tuple<const char*, int, int, float> rows[] = {
        {"one joint", 1, 0, 1.0f},    {"a long chain", 20'000, 0, 1.0f},
        {"a fan", 1, 20'000, 1.0f},   {"a chain with a fan", 100, 100, 1.0f},
        {"no lengths", 10, 10, 0.0f}, {"endless lengths", 10, 10, 3e38f},
    };
    for (const auto& [what, chain, fan, bone] : rows)
    {
        SCOPED_TRACE(what);
        Ref<CNode> root = new CNode;
        CNode* end = root.Get();
        const auto hang = [bone = bone](CNode* parent) {
            CNode& node = AttachNode(*parent);
            node.m_kMatrix.SetTranslation({0.0f, bone, 0.0f});
            return &node;
        };
        for (int i = 1; i < chain; ++i)
            end = hang(end);
        for (int i = 0; i < fan; ++i)
            hang(end);
        EXPECT_FALSE(FindBody(*root).body.DrivesBody());
    }
}

} // namespace
} // namespace gw
