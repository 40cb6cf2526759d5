#include "BodyJoints.h"
#include "CNamedBody.h"
#include "FindBodyByNames.h"
#include "MotionNode.h"
#include "Skeleton.h"
#include "Text.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <tuple>
#include <utility>

namespace gw {
namespace {

// Its legs are attached to helpers with a side letter.
constexpr Convention kHelpers{"cmu-mb",
                              "Left Right",
                              "Hips LowerBack Spine Spine1",
                              "Neck Neck1 Head",
                              "*Shoulder *Arm *ForeArm *Hand",
                              "+HipJoint *UpLeg *Leg *Foot *ToeBase"};
// Other things that can be attached to joints.
constexpr std::pair<const char*, const char*> kExtras[] = {
    {"LeftHand", "LeftHand_End LeftInHandIndex LeftHandThumb1 LeftHandMiddle1 Props_LeftArm"},
    {"RightHand", "RightHand_End RightInHandIndex RightHandThumb1 RightHandMiddle1 Props_RightArm"},
    {"LeftArm", "LeftArmRoll Left_upperarm_twist_01 LeftShldrTwist LeftArmNub"},
    {"RightToeBase", "RightToe_End RightBigToe toe1-1.R RightToeTip"},
    {"Head", "HeadTop_End leftEye Jaw HeadNub"},
};

std::string NameOf(const CNode* node)
{
    return node ? node->GetName() : "(none)";
}

// Builds a tree from text: "Hips(Spine(Head) LeftLeg)".
Ref<CNode> Tree(std::string_view text)
{
    Ref<CNode> root;
    CNode* open = nullptr;
    CNode* last = nullptr;
    while (!text.empty())
    {
        const size_t length = text.find_first_of("() ");
        if (length > 0)
        {
            last = open ? &AttachNode(*open) : (root = new CNode).Get();
            last->SetName(std::string(text.substr(0, length)).c_str());
        }
        text.remove_prefix(std::min(length, text.size()));
        if (text.starts_with('('))
            open = last;
        else if (text.starts_with(')'))
            open = open->GetParentNode();
        text.remove_prefix(std::min<size_t>(1, text.size()));
    }
    return root;
}

TEST(FindBodyByNames, ABodyKeepsItsJointsWhateverIsDoneToItsNames)
{
    const BodyChange changes[] = {
        {"as it is"},
        {"a namespace", "Skeleton 002:"},
        {"a prefix with an underscore", "Model_"},
        {"a prefix with a dash", "DEF-"},
        {"a prefix and nothing behind it", "mixamorig"},
        {"two prefixes", "J_Bip_"},
        {"capital letters", "", BodyChange::Upper},
        {"small letters", "", BodyChange::Lower},
        {"fingers, twists and ends", "", BodyChange::AsTheyAre, true, true},
        {"fingers, twists and ends with a prefix", "avg_", BodyChange::AsTheyAre, true, true},
    };
    for (const BodyChange& change : changes)
    {
        const CNamedBody body(kHelpers, change);
        for (const auto& [joint, names] : kExtras)
        {
            for (std::string_view list = names; change.fingers && !list.empty();)
            {
                CNode& extra =
                    AttachNode(*FindNode(&body.Root(), (std::string(change.prefix) + joint).c_str()));
                extra.SetName((change.prefix + std::string(NextToken(list, " "))).c_str());
            }
        }
        EXPECT_TRUE(FindBodyByNames(body.Root()) == body.Body()) << change.what;
    }
}

TEST(FindBodyByNames, APrefixMayStandBeforeHalfOfTheNames)
{
    const CNamedBody body(kHelpers, {"as it is"});
    bool every2nd = false;
    for (CNode* node : NodesOf(body.Root()))
    {
        every2nd = !every2nd;
        if (every2nd)
            node->SetName(("mixamorig" + std::string(node->NameView())).c_str());
    }
    EXPECT_TRUE(FindBodyByNames(body.Root()) == body.Body());
}

TEST(FindBodyByNames, WordsAreUnderstoodInTheirCompany)
{
    const std::tuple<const char*, const char*, EBodyJoint, const char*> rows[] = {
        {"a shoulder beside an arm is a clavicle", "Hips(LeftShoulder(LeftArm(LeftForeArm)))",
         EBodyJoint::Clavicle, "LeftShoulder"},
        {"a shoulder without one is the upper arm", "Hips(LeftCollar(LeftShoulder(LeftElbow)))",
         EBodyJoint::UpperArm, "LeftShoulder"},
        {"a shoulder between clavicle and upper arm is neither",
         "Hips(clavicle.L(shoulder01.L(upperarm01.L(upperarm02.L))))", EBodyJoint::UpperArm, "upperarm01.L"},
        {"a leg below an up leg is the shin", "Hips(LeftUpLeg(LeftLeg))", EBodyJoint::Shin, "LeftLeg"},
        {"a leg above a knee is the thigh", "Hips(LeftLeg(LeftKnee))", EBodyJoint::Thigh, "LeftLeg"},
        {"a hip of a side is the thigh", "Hips(LHipJoint(LeftHip(LeftKnee)))", EBodyJoint::Thigh, "LeftHip"},
        {"a hip of a side above an up leg is no thigh", "Hips(LeftHip(LeftUpLeg))", EBodyJoint::Thigh,
         "LeftUpLeg"},
        {"a foot below an ankle is the toe", "Hips(AnkleLeft(FootLeft))", EBodyJoint::Toe, "FootLeft"},
        {"a helper with the same words", "Hips(__UpLeg_L(UpLeg_L(LoLeg_L)))", EBodyJoint::Thigh, "UpLeg_L"},
        {"a hand below a wrist", "Hips(LeftWrist(lhand(LThumb)))", EBodyJoint::Hand, "LeftWrist"},
        {"one toe of five is none", "Hips(foot.L(toe1-1.L toe2-1.L))", EBodyJoint::Toe, "(none)"},
        {"a hip that does not carry the trunk", "Root(Hips(LeftThigh RightThigh) Spine(Neck(Head)))",
         EBodyJoint::Hip, "Root"},
        {"words of one letter more are others", "Hips(Handle(Headband) Legend Armature)", EBodyJoint::Head,
         "(none)"},
    };
    for (const auto& [what, tree, joint, name] : rows)
    {
        SCOPED_TRACE(what);
        const Ref<CNode> root = Tree(tree);
        EXPECT_EQ(NameOf(JointAt(FindBodyByNames(*root), {joint})), name);
    }
}

TEST(FindBodyByNames, SaysNothingOfNamesThatSayNothing)
{
    const char* const trees[] = {"a(b(c(d)) e)", "Hips", "Hips(Tail1(Tail2(Tail3)))", "L5(T12)", "_(-(.))"};
    for (const char* tree : trees)
    {
        const Ref<CNode> root = Tree(tree);
        EXPECT_FALSE(FindBodyByNames(*root).DrivesBody()) << tree;
    }
}

} // namespace
} // namespace gw
