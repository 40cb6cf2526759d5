#include "BodyStance.h"
#include "BodyTree.h"
#include "CMadeSkeleton.h"
#include "CheckBody.h"
#include "FindBody.h"
#include "FindBodyByNames.h"
#include "FindBodyByShape.h"
#include "JointSteps.h"
#include "Paths.h"
#include "TempFolder.h"

#include <algorithm>
#include <gtest/gtest.h>

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

void TakeArmsForLegs(CBodyMap& body)
{
    for (const EBodySide side : kBodySides)
    {
        const BodyArm arm = body.Arm(side);
        const BodyLeg leg = body.Leg(side);
        body.Leg(side) = {arm.upperArm, arm.forearm, arm.hand, nullptr};
        body.Arm(side) = {nullptr, leg.thigh, leg.shin, leg.foot};
    }
    std::swap(body.hip, body.spine.back());
}

TEST(CheckBody, DoubtsMapsThatAreWrong)
{
    const struct
    {
        const char* what;
        void (*spoil)(CBodyMap&);
        EDoubt doubt;
        EBodyJoint joint;
    } rows[] = {
        {"left and right swapped", SwapAll, EDoubt::SidesSwapped, EBodyJoint::Thigh},
        {"arms swapped", [](CBodyMap& body) { std::swap(body.arms[0], body.arms[1]); }, EDoubt::SidesSwapped,
         EBodyJoint::UpperArm},
        {"clavicles as upper arms", MoveArmsInward, EDoubt::ArmIsClavicle, EBodyJoint::UpperArm},
        {"upper arms as clavicles", MoveArmsOutward, EDoubt::ClavicleIsArm, EBodyJoint::UpperArm},
        {"shins as thighs", MoveLegsOutward, EDoubt::OddLength, EBodyJoint::Thigh},
        {"a hand that is the other one", [](CBodyMap& body) { body.arms[0].hand = body.arms[1].hand; },
         EDoubt::NotBelow, EBodyJoint::Hand},
        {"arms as legs", TakeArmsForLegs, EDoubt::NotBelow, EBodyJoint::Spine},
    };
    for (const char* recipe : {"fingers", "fingers apose zup", "fingers nopose walk rightfirst"})
    {
        const CMadeSkeleton made(recipe, 1);
        for (const auto& row : rows)
        {
            SCOPED_TRACE(std::string(row.what) + ", \"" + recipe + '"');
            CBodyMap body = FindBodyByShape(made.Root());
            row.spoil(body);
            const std::vector<BodyDoubt> doubts = CheckBody(body);
            EXPECT_TRUE(std::ranges::any_of(doubts, [&](const BodyDoubt& doubt) {
                return doubt.kind == row.doubt && doubt.place.joint == row.joint;
            }));
        }
    }
}

TEST(CheckBody, LegsGoAwayFromTheHead)
{
    // Hip, spine and head in the wrong order along a chain: the branches at the hip go up with the trunk.
    Ref<CNode> hip = new CNode;
    const auto hang = [](CNode* parent, const Vec3& offset) {
        auto* const node = new CNode;
        node->m_kMatrix.SetTranslation(offset);
        parent->AttachChild(node);
        return node;
    };
    CBodyMap body;
    body.hip = hip.Get();
    body.spine = {hang(body.hip, {0.0f, 30.0f, 0.0f})};
    body.head = hang(body.spine.back(), {0.0f, 40.0f, 0.0f});
    for (const EBodySide side : kBodySides)
    {
        BodyLeg& leg = body.Leg(side);
        leg.thigh = hang(body.hip, {side == Left ? 10.0f : -10.0f, 0.0f, 0.0f});
        leg.shin = hang(leg.thigh, {0.0f, 40.0f, 0.0f});
    }
    const auto legsUp = [&] {
        const std::vector<BodyDoubt> doubts = CheckBody(body);
        return std::ranges::count(doubts, EDoubt::LegsUp, &BodyDoubt::kind);
    };
    EXPECT_EQ(legsUp(), 2);
    for (const BodyLeg& leg : body.legs)
        leg.shin->m_kMatrix.SetTranslation({0.0f, -40.0f, 0.0f});
    EXPECT_EQ(legsUp(), 0);
}

TEST(CheckBody, AskedOfNothingDoubtsNothing)
{
    EXPECT_TRUE(CheckBody({}).empty());
    const CMadeSkeleton made("", 1);
    CBodyMap body;
    body.hip = &made.Root();
    EXPECT_TRUE(CheckBody(body).empty());
}

// Gives the joints of a made body ordinary names.
void NameBody(const CBodyMap& body, const char* left, const char* right)
{
    body.hip->SetName("Hips");
    for (size_t i = 0; i < body.spine.size(); ++i)
        body.spine[i]->SetName(("Spine" + std::to_string(i)).c_str());
    body.neck.front()->SetName("Neck");
    body.head->SetName("Head");
    for (const EBodySide side : kBodySides)
    {
        const std::string name = side == Left ? left : right;
        const BodyArm& arm = body.Arm(side);
        const BodyLeg& leg = body.Leg(side);
        arm.clavicle->SetName((name + "Shoulder").c_str());
        arm.upperArm->SetName((name + "Arm").c_str());
        arm.forearm->SetName((name + "ForeArm").c_str());
        arm.hand->SetName((name + "Hand").c_str());
        leg.thigh->SetName((name + "UpLeg").c_str());
        leg.shin->SetName((name + "Leg").c_str());
        leg.foot->SetName((name + "Foot").c_str());
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
    const CMadeSkeleton made("fingers", 1);
    const CBodyMap shaped = FindBodyByShape(made.Root());
    NameBody(shaped, "Left", "Right");
    const FoundBody found = FindBody(made.Root());
    EXPECT_TRUE(found.doubts.empty());
    EXPECT_TRUE(found.sidesAreSure);
    EXPECT_EQ(found.Evidence({EBodyJoint::Thigh, Left}), EBodyEvidence::Both);
    // The toe's name says nothing; its foot is the same by name and by shape.
    EXPECT_EQ(found.Evidence({EBodyJoint::Toe, Right}), EBodyEvidence::Shape);
    EXPECT_EQ(found.body.legs[1].toe, shaped.legs[1].toe);
}

TEST(FindBody, NamesThatThePlacesContradictGiveWay)
{
    const CMadeSkeleton made("", 1);
    const CBodyMap shaped = FindBodyByShape(made.Root());
    NameBody(shaped, "Right", "Left");
    ASSERT_EQ(FindBodyByNames(made.Root()).legs[0].thigh, shaped.legs[1].thigh);
    const FoundBody found = FindBody(made.Root());
    EXPECT_EQ(found.body.legs[0].thigh, shaped.legs[0].thigh);
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
    const struct
    {
        const char* what;
        int chain; // joints below each other
        int fan;   // joints beside each other at its end
        float bone;
    } rows[] = {
        {"one joint", 1, 0, 1.0f},    {"a long chain", 20'000, 0, 1.0f},
        {"a fan", 1, 20'000, 1.0f},   {"a chain with a fan", 100, 100, 1.0f},
        {"no lengths", 10, 10, 0.0f}, {"endless lengths", 10, 10, 3e38f},
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.what);
        Ref<CNode> root = new CNode;
        CNode* end = root.Get();
        const auto hang = [&](CNode* parent) {
            auto* const node = new CNode;
            node->m_kMatrix.SetTranslation({0.0f, row.bone, 0.0f});
            parent->AttachChild(node);
            return node;
        };
        for (int i = 1; i < row.chain; ++i)
            end = hang(end);
        for (int i = 0; i < row.fan; ++i)
            hang(end);
        EXPECT_FALSE(FindBody(*root).body.DrivesBody());
    }
}

// Recordings from many sources: their names and shapes agree.
TEST(FindBody, NamesAndShapesOfRealFilesAgree)
{
    if (SharedDataFolder().empty())
        GTEST_SKIP() << "no shared data here";
    const std::string folder = SharedDataFolder() + "bvh/";
    for (const std::string& name : FilesInFolder(folder, ".bvh"))
    {
        SCOPED_TRACE(name);
        CMotionFile motion;
        if (!motion.Load(folder + name)) // one has a blank line that is not allowed
            continue;
        const CBodyMap named = FindBodyByNames(*motion.motionRoot);
        if (!named.DrivesBody()) // two are not bodies
            continue;
        EXPECT_TRUE(CheckBody(named).empty());
        const CBodyMap shaped = FindBodyByShape(*motion.motionRoot);
        for (const BodyPlace& place : BodyPlaces())
        {
            const bool mayDiffer = place.joint == EBodyJoint::Toe && !JointAt(named, place);
            EXPECT_TRUE(mayDiffer || JointAt(named, place) == JointAt(shaped, place));
        }
    }
}

} // namespace
} // namespace gw
