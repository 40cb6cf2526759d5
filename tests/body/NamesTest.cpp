#include "BodyJoints.h"
#include "FindBodyByNames.h"
#include "Skeleton.h"
#include "Text.h"

#include <algorithm>
#include <functional>
#include <gtest/gtest.h>

namespace gw {

namespace {

// How a maker of skeletons names joints. Lists go upward or outward, with "|" in between and "-" for a joint
// that is not there. In names of a side, * stands for the side as the second column has it, + for its letter.
struct Convention
{
    const char* what;
    const char* sides;
    const char* above; // a joint above the hip
    const char* hip;
    const char* spine;
    const char* neck;
    const char* head;
    const char* arm; // clavicle, upper arm, forearm, hand
    const char* leg; // a helper above the thigh, thigh, shin, foot, toe
};

// clang-format off
constexpr Convention kConventions[] = {
    {"cmu-mb", "Left/Right", "", "Hips", "LowerBack|Spine|Spine1", "Neck|Neck1", "Head", "*Shoulder|*Arm|*ForeArm|*Hand", "+HipJoint|*UpLeg|*Leg|*Foot|*ToeBase"},
    {"cmu-max", "Left/Right", "", "Hips", "lowerback|Chest|Chest2", "lowerneck|Neck", "Head", "*Collar|*Shoulder|*Elbow|*Wrist", "+HipJoint|*Hip|*Knee|*Ankle|*Toe"},
    {"cmu-daz", "l/r", "", "hip", "abdomen|chest", "neck", "head", "*Collar|*Shldr|*ForeArm|*Hand", "*Buttock|*Thigh|*Shin|*Foot|-"},
    {"cmu-asf", "l/r", "", "root", "lowerback|upperback|thorax", "lowerneck|upperneck", "head", "*clavicle|*humerus|*radius|*wrist", "*hipjoint|*femur|*tibia|*foot|*toes"},
    {"accad", "Left/Right", "", "Hips", "ToSpine|Spine|Spine1", "Neck", "Head", "*Shoulder|*Arm|*ForeArm|*Hand", "-|*UpLeg|*Leg|*Foot|*ToeBase"},
    {"motionbuilder", "Left/Right", "Reference", "Hips", "Spine|Spine1|Spine2", "Neck|Neck1", "Head", "*Shoulder|*Arm|*ForeArm|*Hand", "-|*UpLeg|*Leg|*Foot|*ToeBase"},
    {"poser", "l/r", "", "hip", "abdomen|chest", "neck", "head", "*Collar|*Shldr|*ForeArm|*Hand", "*Buttock|*Thigh|*Shin|*Foot|*Toe"},
    {"daz-g1g2", "l/r", "", "hip", "abdomen|abdomen2|chest", "neck", "head", "*Collar|*Shldr|*ForeArm|*Hand", "-|*Thigh|*Shin|*Foot|*Toe"},
    {"daz-g3g8", "l/r", "", "hip", "abdomenLower|abdomenUpper|chestLower|chestUpper", "neckLower|neckUpper", "head", "*Collar|*ShldrBend|*ForearmBend|*Hand", "-|*ThighBend|*Shin|*Foot|*Toe"},
    {"daz-g9", "l/r", "", "hip", "spine1|spine2|spine3|spine4", "neck1|neck2", "head", "*_shoulder|*_upperarm|*_forearm|*_hand", "-|*_thigh|*_shin|*_foot|*_toes"},
    {"max-bvh", "Left/Right", "", "Hips", "Chest|Chest2|Chest3", "Neck", "Head", "*Collar|*Shoulder|*Elbow|*Wrist", "-|*Hip|*Knee|*Ankle|*Toe"},
    {"biped", "L/R", "Bip01", "Bip01 Pelvis", "Bip01 Spine|Bip01 Spine1|Bip01 Spine2|Bip01 Spine3", "Bip01 Neck", "Bip01 Head", "Bip01 * Clavicle|Bip01 * UpperArm|Bip01 * Forearm|Bip01 * Hand", "-|Bip01 * Thigh|Bip01 * Calf|Bip01 * Foot|Bip01 * Toe0"},
    {"mixamo", "Left/Right", "", "Hips", "Spine|Spine1|Spine2", "Neck", "Head", "*Shoulder|*Arm|*ForeArm|*Hand", "-|*UpLeg|*Leg|*Foot|*ToeBase"},
    {"lafan1", "Left/Right", "", "Hips", "Spine|Spine1|Spine2", "Neck", "Head", "*Shoulder|*Arm|*ForeArm|*Hand", "-|*UpLeg|*Leg|*Foot|*Toe"},
    {"100style", "Left/Right", "", "Hips", "Chest|Chest2|Chest3|Chest4", "Neck", "Head", "*Collar|*Shoulder|*Elbow|*Wrist", "-|*Hip|*Knee|*Ankle|*Toe"},
    {"xsens-bvh", "Left/Right", "", "Hips", "Chest|Chest2|Chest3|Chest4", "Neck", "Head", "*Collar|*Shoulder|*Elbow|*Wrist", "-|*Hip|*Knee|*Ankle|*Toe"},
    {"xsens-mvn", "Left/Right", "", "Pelvis", "L5|L3|T12|T8", "Neck", "Head", "*Shoulder|*UpperArm|*ForeArm|*Hand", "-|*UpperLeg|*LowerLeg|*Foot|*Toe"},
    {"neuron", "Left/Right", "", "Hips", "Spine|Spine1|Spine2|Spine3", "Neck", "Head", "*Shoulder|*Arm|*ForeArm|*Hand", "-|*UpLeg|*Leg|*Foot|-"},
    {"axis-studio", "Left/Right", "", "Hips", "Spine|Spine1|Spine2", "Neck|Neck1", "Head", "*Shoulder|*Arm|*ForeArm|*Hand", "-|*UpLeg|*Leg|*Foot|-"},
    {"rokoko-newton", "Left/Right", "Root", "Hips", "Spine1|Spine2|Spine3|Spine4", "Neck", "Head", "*Shoulder|*Arm|*ForeArm|*Hand", "-|*Thigh|*Shin|*Foot|*Toe"},
    {"rokoko-hik", "Left/Right", "", "Hips", "Spine|Spine1|Spine2|Spine3", "Neck", "Head", "*Shoulder|*Arm|*ForeArm|*Hand", "-|*UpLeg|*Leg|*Foot|*ToeBase"},
    {"ipi", "L/R", "", "Hip", "LowerSpine|MiddleSpine|Chest", "Neck", "Head", "*Clavicle|*Shoulder|*Forearm|*Hand", "-|*Thigh|*Shin|*Foot|*Toe"},
    {"optitrack", "L/R", "", "Hip", "Ab|Chest", "Neck", "Head", "*Shoulder|*UArm|*FArm|*Hand", "-|*Thigh|*Shin|*Foot|*Toe"},
    {"optitrack-hik", "Left/Right", "", "Hips", "Spine|Spine1", "Neck", "Head", "*Shoulder|*Arm|*ForeArm|*Hand", "-|*UpLeg|*Leg|*Foot|*ToeBase"},
    {"kinect-v1", "Left/Right", "", "HipCenter", "Spine|ShoulderCenter", "", "Head", "-|Shoulder*|Elbow*|Wrist*", "-|Hip*|Knee*|Ankle*|Foot*"},
    {"kinect-v2", "Left/Right", "", "SpineBase", "SpineMid|SpineShoulder", "Neck", "Head", "-|Shoulder*|Elbow*|Wrist*", "-|Hip*|Knee*|Ankle*|Foot*"},
    {"kinect-azure", "LEFT/RIGHT", "", "PELVIS", "SPINE_NAVEL|SPINE_CHEST", "NECK", "HEAD", "CLAVICLE_*|SHOULDER_*|ELBOW_*|WRIST_*", "-|HIP_*|KNEE_*|ANKLE_*|FOOT_*"},
    {"brekel", "Left/Right", "", "Hips", "Spine|Spine1|Spine2", "Neck", "Head", "*Shoulder|*Arm|*ForeArm|*Hand", "-|*UpLeg|*Leg|*Foot|*ToeBase"},
    {"smpl", "L/R", "", "Pelvis", "Spine1|Spine2|Spine3", "Neck", "Head", "*_Collar|*_Shoulder|*_Elbow|*_Wrist", "-|*_Hip|*_Knee|*_Ankle|*_Foot"},
    {"smplx", "left/right", "", "pelvis", "spine1|spine2|spine3", "neck", "head", "*_collar|*_shoulder|*_elbow|*_wrist", "-|*_hip|*_knee|*_ankle|*_foot"},
    {"h36m", "Left/Right", "", "Hip", "Spine|Thorax", "Neck", "HeadEndSite", "-|*Shoulder|*Elbow|*Wrist", "-|*Hip|*Knee|*Ankle|-"},
    {"secondlife-bvh", "l/r", "", "hip", "abdomen|chest", "neck", "head", "*Collar|*Shldr|*ForeArm|*Hand", "-|*Thigh|*Shin|*Foot|-"},
    {"secondlife-rig", "Left/Right", "", "mPelvis", "mTorso|mChest", "mNeck", "mHead", "mCollar*|mShoulder*|mElbow*|mWrist*", "-|mHip*|mKnee*|mAnkle*|mToe*"},
    {"bandai-namco", "L/R", "joint_Root", "Hips", "Spine|Chest", "Neck", "Head", "Shoulder_*|UpperArm_*|LowerArm_*|Hand_*", "-|UpperLeg_*|LowerLeg_*|Foot_*|Toes_*"},
    {"unreal", "l/r", "root", "pelvis", "spine_01|spine_02|spine_03|spine_04|spine_05", "neck_01|neck_02", "head", "clavicle_*|upperarm_*|lowerarm_*|hand_*", "-|thigh_*|calf_*|foot_*|ball_*"},
    {"unity-humanoid", "Left/Right", "Root", "Hips", "Spine|Chest|UpperChest", "Neck", "Head", "*Shoulder|*UpperArm|*LowerArm|*Hand", "-|*UpperLeg|*LowerLeg|*Foot|*Toes"},
    {"rigify", "L/R", "", "spine", "spine.001|spine.002|spine.003", "spine.004|spine.005", "spine.006", "shoulder.*|upper_arm.*|forearm.*|hand.*", "-|thigh.*|shin.*|foot.*|toe.*"},
    {"endorphin", "Left/Right", "", "root", "LowerSpineJoint|MiddleSpineJoint|UpperSpineJoint", "LowerNeckJoint", "UpperNeckJoint", "*ClavicleJoint|*ShoulderJoint|*ElbowJoint|*WristJoint", "-|*HipJoint|*KneeJoint|*AnkleJoint|*ToesJoint"},
    {"mega", "Left/Right", "", "Hips", "UpperBack|Chest", "Neck", "Neck1", "+Collar|*UpArm|*LowArm|*Hand", "-|*UpLeg|*LowLeg|*Foot|*Toes"},
    {"gesture", "Left/Right", "", "Hips", "Spine|Spine1|Spine2|Spine3", "Neck|Neck1", "Head", "*Shoulder|*Arm|*ForeArm|*Hand", "-|*UpLeg|*Leg|*Foot|*ToeBase"},
};
// clang-format on

std::vector<std::string> Split(std::string_view list)
{
    std::vector<std::string> names;
    for (std::string_view name = NextToken(list, "|"); !name.empty(); name = NextToken(list, "|"))
        names.emplace_back(name);
    return names;
}

std::string OfSide(std::string name, const Convention& convention, EBodySide side)
{
    std::string_view sides = convention.sides;
    const std::string left(NextToken(sides, "/"));
    const std::string right(NextToken(sides, "/"));
    const bool isLeft = side == EBodySide::Left;
    if (const size_t star = name.find('*'); star != name.npos)
        return name.replace(star, 1, isLeft ? left : right);
    if (const size_t plus = name.find('+'); plus != name.npos)
        return name.replace(plus, 1, 1, isLeft ? 'L' : 'R');
    return name;
}

enum ELetters
{
    AsTheyAre,
    Upper,
    Lower,
};

// A change that every name of a skeleton goes through, and what else hangs in its tree.
struct Variant
{
    const char* what;
    const char* prefix;
    ELetters letters;
    bool toes;
    bool extras; // fingers, twist joints, ends, things in the hand

    std::string Rename(const std::string& name) const
    {
        const std::string whole = prefix + name;
        return letters == Upper ? UpperCase(whole) : letters == Lower ? LowerCase(whole) : whole;
    }
};

constexpr const char* kHandExtras[] = {"*Hand_End", "*InHandIndex", "*HandThumb1", "*HandMiddle1",
                                       "Props_*Arm"};
constexpr const char* kArmExtras[] = {"*ArmRoll", "*_upperarm_twist_01", "*ShldrTwist", "*ArmNub"};
constexpr const char* kToeExtras[] = {"*Toe_End", "*BigToe", "toe1-1.*", "*ToeTip"};
constexpr const char* kHeadExtras[] = {"HeadTop_End", "leftEye", "Jaw", "HeadNub"};

// A skeleton of a convention and the body that it ought to be taken for.
struct NamedSkeleton
{
    NamedSkeleton(const Convention& row, const Variant& change) : convention(row), variant(change)
    {
        CNode* top = nullptr;
        if (*row.above)
            top = Add(nullptr, row.above);
        body.hip = top = Add(top, row.hip);
        for (const EBodySide side : kBodySides)
            AddLeg(side);
        for (const std::string& name : Split(row.spine))
            body.spine.push_back(top = Add(top, name));
        for (const EBodySide side : kBodySides)
            AddArm(top, side);
        for (const std::string& name : Split(row.neck))
            body.neck.push_back(top = Add(top, name));
        body.head = Add(top, row.head);
        AddExtras(body.head, kHeadExtras, EBodySide::Left);
    }

    CNode* Add(CNode* parent, const std::string& name)
    {
        auto* const node = new CNode;
        node->SetName(variant.Rename(name).c_str());
        if (parent)
            parent->AttachChild(node);
        else
            root = node;
        return node;
    }
    // Hangs a chain of a side's names; null for those that are not there.
    std::vector<CNode*> AddChain(CNode* top, const char* list, EBodySide side)
    {
        std::vector<CNode*> chain;
        for (const std::string& name : Split(list))
        {
            chain.push_back(name == "-" ? nullptr : Add(top, OfSide(name, convention, side)));
            top = chain.back() ? chain.back() : top;
        }
        return chain;
    }
    void AddArm(CNode* top, EBodySide side)
    {
        const std::vector<CNode*> chain = AddChain(top, convention.arm, side);
        body.Arm(side) = {chain[0], chain[1], chain[2], chain[3]};
        AddExtras(chain[1], kArmExtras, side);
        AddExtras(chain[3], kHandExtras, side);
    }
    void AddLeg(EBodySide side)
    {
        std::string list = convention.leg;
        if (!variant.toes)
        {
            list.resize(list.rfind('|') + 1);
            list += '-';
        }
        const std::vector<CNode*> chain = AddChain(body.hip, list.c_str(), side);
        body.Leg(side) = {chain[1], chain[2], chain[3], chain[4]};
        AddExtras(chain[4] ? chain[4] : chain[3], kToeExtras, side);
    }
    template <size_t count>
    void AddExtras(CNode* joint, const char* const (&names)[count], EBodySide side)
    {
        for (const char* name : names)
        {
            if (variant.extras)
                Add(joint, OfSide(name, convention, side));
        }
    }

    const Convention& convention;
    const Variant& variant;
    Ref<CNode> root;
    CBodyMap body;
};

std::string NameOf(const CNode* node)
{
    return node ? node->GetName() : "(none)";
}

std::string NamesOf(const std::vector<CNode*>& nodes)
{
    std::string names;
    for (const CNode* node : nodes)
        names += NameOf(node) + ' ';
    return names;
}

void ExpectSameBody(const CBodyMap& found, const CBodyMap& body)
{
    for (const BodyPlace& place : BodyPlaces())
        EXPECT_EQ(NameOf(JointAt(found, place)), NameOf(JointAt(body, place)));
    EXPECT_EQ(NamesOf(found.spine), NamesOf(body.spine));
    EXPECT_EQ(NamesOf(found.neck), NamesOf(body.neck));
}

TEST(FindBodyByNames, EveryConventionHasAllItsRoles)
{
    const Variant variants[] = {
        {"as it is",                               "",              AsTheyAre, true,  false},
        {"a namespace",                            "Skeleton 002:", AsTheyAre, true,  false},
        {"a prefix with an underscore",            "Model_",        AsTheyAre, true,  false},
        {"a prefix with a dash",                   "DEF-",          AsTheyAre, true,  false},
        {"a prefix and nothing behind it",         "mixamorig",     AsTheyAre, true,  false},
        {"two prefixes",                           "J_Bip_",        AsTheyAre, true,  false},
        {"capital letters",                        "",              Upper,     true,  false},
        {"small letters",                          "",              Lower,     true,  false},
        {"no toes",                                "",              AsTheyAre, false, false},
        {"fingers, twists and ends",               "",              AsTheyAre, true,  true },
        {"fingers, twists and ends with a prefix", "avg_",          AsTheyAre, true,  true },
    };
    for (const Convention& convention : kConventions)
    {
        for (const Variant& variant : variants)
        {
            SCOPED_TRACE(std::string(convention.what) + ", " + variant.what);
            const NamedSkeleton skeleton(convention, variant);
            ExpectSameBody(FindBodyByNames(*skeleton.root), skeleton.body);
        }
    }
}

// A tree as text: "Hips(Spine(Head) LeftLeg)".
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
            last = new CNode;
            last->SetName(std::string(text.substr(0, length)).c_str());
            if (open)
                open->AttachChild(last);
            else
                root = last;
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

TEST(FindBodyByNames, WordsAreUnderstoodInTheirCompany)
{
    const struct
    {
        const char* what;
        const char* tree;
        EBodyJoint joint;
        const char* name;
    } rows[] = {
        {"a shoulder beside an arm is a clavicle",               "Hips(LeftShoulder(LeftArm(LeftForeArm)))",
         EBodyJoint::Clavicle,                                                                                                               "LeftShoulder"},
        {"a shoulder without one is the upper arm",              "Hips(LeftCollar(LeftShoulder(LeftElbow)))",
         EBodyJoint::UpperArm,                                                                                                               "LeftShoulder"},
        {"a shoulder between clavicle and upper arm is neither",
         "Hips(clavicle.L(shoulder01.L(upperarm01.L(upperarm02.L))))",                                                 EBodyJoint::UpperArm, "upperarm01.L"},
        {"a leg below an up leg is the shin",                    "Hips(LeftUpLeg(LeftLeg))",                           EBodyJoint::Shin,     "LeftLeg"     },
        {"a leg above a knee is the thigh",                      "Hips(LeftLeg(LeftKnee))",                            EBodyJoint::Thigh,    "LeftLeg"     },
        {"a hip of a side is the thigh",                         "Hips(LHipJoint(LeftHip(LeftKnee)))",                 EBodyJoint::Thigh,    "LeftHip"     },
        {"a hip of a side above an up leg is no thigh",          "Hips(LeftHip(LeftUpLeg))",                           EBodyJoint::Thigh,
         "LeftUpLeg"                                                                                                                                       },
        {"a foot below an ankle is the toe",                     "Hips(AnkleLeft(FootLeft))",                          EBodyJoint::Toe,      "FootLeft"    },
        {"a helper with the same words",                         "Hips(__UpLeg_L(UpLeg_L(LoLeg_L)))",                  EBodyJoint::Thigh,    "UpLeg_L"     },
        {"a hand below a wrist",                                 "Hips(LeftWrist(lhand(LThumb)))",                     EBodyJoint::Hand,     "LeftWrist"   },
        {"one toe of five is none",                              "Hips(foot.L(toe1-1.L toe2-1.L))",                    EBodyJoint::Toe,      "(none)"      },
        {"a hip that does not carry the trunk",                  "Root(Hips(LeftThigh RightThigh) Spine(Neck(Head)))",
         EBodyJoint::Hip,                                                                                                                    "Root"        },
        {"words of one letter more are others",                  "Hips(Handle(Headband) Legend Armature)",             EBodyJoint::Head,
         "(none)"                                                                                                                                          },
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.what);
        const Ref<CNode> root = Tree(row.tree);
        EXPECT_EQ(NameOf(JointAt(FindBodyByNames(*root), {row.joint})), row.name);
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
