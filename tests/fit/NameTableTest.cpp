#include "CNamedBody.h"
#include "ChooseProfile.h"
#include "FindBone.h"
#include "Paths.h"

#include <algorithm>
#include <gtest/gtest.h>

namespace gw {
namespace {

// GAITWRIGHT_ASSETS is the folder of the stock profiles.
constexpr std::string_view kAssets = GAITWRIGHT_ASSETS;

// The names of the programs and collections that motions come from.
// clang-format off
constexpr Convention kConventions[] = {
    {"100style", "Left Right", "Hips Chest Chest2 Chest3 Chest4", "Neck Head", "*Collar *Shoulder *Elbow *Wrist", "- *Hip *Knee *Ankle *Toe"},
    {"accad", "Left Right", "Hips ToSpine Spine Spine1", "Neck Head", "*Shoulder *Arm *ForeArm *Hand", "- *UpLeg *Leg *Foot *ToeBase"},
    {"axis-studio", "Left Right", "Hips Spine Spine1 Spine2", "Neck Neck1 Head", "*Shoulder *Arm *ForeArm *Hand", "- *UpLeg *Leg *Foot -"},
    {"bandai-namco", "L R", "Hips Spine Chest", "Neck Head", "Shoulder_* UpperArm_* LowerArm_* Hand_*", "- UpperLeg_* LowerLeg_* Foot_* Toes_*"},
    {"biped", "L R", "Bip01_Pelvis Bip01_Spine Bip01_Spine1 Bip01_Spine2 Bip01_Spine3", "Bip01_Neck Bip01_Head", "Bip01_*_Clavicle Bip01_*_UpperArm Bip01_*_Forearm Bip01_*_Hand", "- Bip01_*_Thigh Bip01_*_Calf Bip01_*_Foot Bip01_*_Toe0"},
    {"biped, blanks dropped", "L R", "Bip001Pelvis Bip001Spine Bip001Spine1 Bip001Spine2", "Bip001Neck Bip001Head", "Bip001*Clavicle Bip001*UpperArm Bip001*Forearm Bip001*Hand", "- Bip001*Thigh Bip001*Calf Bip001*Foot Bip001*Toe0"},
    {"cmu-asf", "l r", "root lowerback upperback thorax", "lowerneck upperneck head", "*clavicle *humerus *radius *wrist", "*hipjoint *femur *tibia *foot *toes"},
    {"cmu-daz", "l r", "hip abdomen chest", "neck head", "*Collar *Shldr *ForeArm *Hand", "*Buttock *Thigh *Shin *Foot -"},
    {"cmu-max", "Left Right", "Hips lowerback Chest Chest2", "lowerneck Neck Head", "*Collar *Shoulder *Elbow *Wrist", "+HipJoint *Hip *Knee *Ankle *Toe"},
    {"cmu-mb", "Left Right", "Hips LowerBack Spine Spine1", "Neck Neck1 Head", "*Shoulder *Arm *ForeArm *Hand", "+HipJoint *UpLeg *Leg *Foot *ToeBase"},
    {"daz-g1g2", "l r", "hip abdomen abdomen2 chest", "neck head", "*Collar *Shldr *ForeArm *Hand", "- *Thigh *Shin *Foot *Toe"},
    {"daz-g3g8", "l r", "hip abdomenLower abdomenUpper chestLower chestUpper", "neckLower neckUpper head", "*Collar *ShldrBend *ForearmBend *Hand", "- *ThighBend *Shin *Foot *Toe"},
    {"daz-g9", "l r", "hip spine1 spine2 spine3 spine4", "neck1 neck2 head", "*_shoulder *_upperarm *_forearm *_hand", "- *_thigh *_shin *_foot *_toes"},
    {"endorphin", "Left Right", "root LowerSpineJoint MiddleSpineJoint UpperSpineJoint", "LowerNeckJoint UpperNeckJoint", "*ClavicleJoint *ShoulderJoint *ElbowJoint *WristJoint", "- *HipJoint *KneeJoint *AnkleJoint *ToesJoint"},
    {"gesture", "Left Right", "Hips Spine Spine1 Spine2 Spine3", "Neck Neck1 Head", "*Shoulder *Arm *ForeArm *Hand", "- *UpLeg *Leg *Foot *ToeBase"},
    {"h36m", "Left Right", "Hip Spine Thorax", "Neck HeadEndSite", "- *Shoulder *Elbow *Wrist", "- *Hip *Knee *Ankle -"},
    {"ipi", "L R", "Hip LowerSpine MiddleSpine Chest", "Neck Head", "*Clavicle *Shoulder *Forearm *Hand", "- *Thigh *Shin *Foot *Toe"},
    {"kinect-azure", "LEFT RIGHT", "PELVIS SPINE_NAVEL SPINE_CHEST", "NECK HEAD", "CLAVICLE_* SHOULDER_* ELBOW_* WRIST_*", "- HIP_* KNEE_* ANKLE_* FOOT_*"},
    {"kinect-v1", "Left Right", "HipCenter Spine ShoulderCenter", "Head", "- Shoulder* Elbow* Wrist*", "- Hip* Knee* Ankle* Foot*"},
    {"kinect-v2", "Left Right", "SpineBase SpineMid SpineShoulder", "Neck Head", "- Shoulder* Elbow* Wrist*", "- Hip* Knee* Ankle* Foot*"},
    {"lafan1", "Left Right", "Hips Spine Spine1 Spine2", "Neck Head", "*Shoulder *Arm *ForeArm *Hand", "- *UpLeg *Leg *Foot *Toe"},
    {"max-bvh", "Left Right", "Hips Chest Chest2", "Neck Head", "*Collar *Shoulder *Elbow *Wrist", "- *Hip *Knee *Ankle *Toe"},
    {"max-bvh, one chest", "Left Right", "Hips Chest", "Neck Head", "*Collar *UpArm *LowArm *Hand", "- *UpLeg *LowLeg *Foot -"},
    {"max-bvh, seven chests", "Left Right", "Hips Chest Chest2 Chest3 Chest4 Chest5 Chest6 Chest7", "Neck Head", "*Collar *Shoulder *Elbow *Wrist", "- *Hip *Knee *Ankle *Toe"},
    {"mega", "Left Right", "Hips UpperBack Chest", "Neck Neck1", "+Collar *UpArm *LowArm *Hand", "- *UpLeg *LowLeg *Foot *Toes"},
    {"mixamo", "Left Right", "mixamorig:Hips mixamorig:Spine mixamorig:Spine1 mixamorig:Spine2", "mixamorig:Neck mixamorig:Head", "mixamorig:*Shoulder mixamorig:*Arm mixamorig:*ForeArm mixamorig:*Hand", "- mixamorig:*UpLeg mixamorig:*Leg mixamorig:*Foot mixamorig:*ToeBase"},
    {"mixamo, no colon", "Left Right", "mixamorigHips mixamorigSpine mixamorigSpine1 mixamorigSpine2", "mixamorigNeck mixamorigHead", "mixamorig*Shoulder mixamorig*Arm mixamorig*ForeArm mixamorig*Hand", "- mixamorig*UpLeg mixamorig*Leg mixamorig*Foot mixamorig*ToeBase"},
    {"motionbuilder, one spine", "Left Right", "Hips Spine", "Neck Head", "*Shoulder *Arm *ForeArm *Hand", "- *UpLeg *Leg *Foot *ToeBase"},
    {"motionbuilder, ten spines", "Left Right", "Hips Spine Spine1 Spine2 Spine3 Spine4 Spine5 Spine6 Spine7 Spine8 Spine9", "Neck Neck1 Head", "*Shoulder *Arm *ForeArm *Hand", "- *UpLeg *Leg *Foot *ToeBase"},
    {"neuron", "Left Right", "Hips Spine Spine1 Spine2 Spine3", "Neck Head", "*Shoulder *Arm *ForeArm *Hand", "- *UpLeg *Leg *Foot -"},
    {"optitrack", "L R", "Hip Ab Chest", "Neck Head", "*Shoulder *UArm *FArm *Hand", "- *Thigh *Shin *Foot *Toe"},
    {"poser", "l r", "hip abdomen chest", "neck head", "*Collar *Shldr *ForeArm *Hand", "*Buttock *Thigh *Shin *Foot *Toe"},
    {"rigify", "L R", "spine spine.001 spine.002 spine.003", "spine.004 spine.005 spine.006", "shoulder.* upper_arm.* forearm.* hand.*", "- thigh.* shin.* foot.* toe.*"},
    {"rokoko-newton", "Left Right", "Hips Spine1 Spine2 Spine3 Spine4", "Neck Head", "*Shoulder *Arm *ForeArm *Hand", "- *Thigh *Shin *Foot *Toe"},
    {"secondlife-bvh", "l r", "hip abdomen chest", "neck head", "*Collar *Shldr *ForeArm *Hand", "- *Thigh *Shin *Foot -"},
    {"secondlife-rig", "Left Right", "mPelvis mTorso mChest", "mNeck mHead", "mCollar* mShoulder* mElbow* mWrist*", "- mHip* mKnee* mAnkle* mToe*"},
    {"smpl", "L R", "Pelvis Spine1 Spine2 Spine3", "Neck Head", "*_Collar *_Shoulder *_Elbow *_Wrist", "- *_Hip *_Knee *_Ankle *_Foot"},
    {"smplx", "left right", "pelvis spine1 spine2 spine3", "neck head", "*_collar *_shoulder *_elbow *_wrist", "- *_hip *_knee *_ankle *_foot"},
    {"unity-humanoid", "Left Right", "Hips Spine Chest UpperChest", "Neck Head", "*Shoulder *UpperArm *LowerArm *Hand", "- *UpperLeg *LowerLeg *Foot *Toes"},
    {"unreal", "l r", "pelvis spine_01 spine_02 spine_03 spine_04 spine_05", "neck_01 neck_02 head", "clavicle_* upperarm_* lowerarm_* hand_*", "- thigh_* calf_* foot_* ball_*"},
    {"unreal, version 4", "l r", "pelvis spine_01 spine_02 spine_03", "neck_01 head", "clavicle_* upperarm_* lowerarm_* hand_*", "- thigh_* calf_* foot_* ball_*"},
    {"vroid", "L R", "J_Bip_C_Hips J_Bip_C_Spine J_Bip_C_Chest J_Bip_C_UpperChest", "J_Bip_C_Neck J_Bip_C_Head", "J_Bip_*_Shoulder J_Bip_*_UpperArm J_Bip_*_LowerArm J_Bip_*_Hand", "- J_Bip_*_UpperLeg J_Bip_*_LowerLeg J_Bip_*_Foot J_Bip_*_ToeBase"},
    {"xsens-mvn", "Left Right", "Pelvis L5 L3 T12 T8", "Neck Head", "*Shoulder *UpperArm *ForeArm *Hand", "- *UpperLeg *LowerLeg *Foot *Toe"},
};

constexpr BodyChange kChanges[] = {
    {"as it is"},
    {"a prefix", "Model_"},
    {"a namespace", "Skeleton:"},
    {"capitals", "", BodyChange::Upper},
    {"small letters", "", BodyChange::Lower},
    {"no toes", "", BodyChange::AsTheyAre, false},
    {"fingers", "", BodyChange::AsTheyAre, true, true},
    {"fingers and a prefix", "m_avg_", BodyChange::Lower, true, true},
    {"sides swapped", "", BodyChange::AsTheyAre, true, false, BodyChange::SidesSwapped},
    {"sides swapped, no toes", "", BodyChange::AsTheyAre, false, false, BodyChange::SidesSwapped},
    {"sides swapped, a prefix", "Model_", BodyChange::AsTheyAre, true, true, BodyChange::SidesSwapped},
    {"clavicle and arm exchanged", "", BodyChange::AsTheyAre, true, false, BodyChange::ArmsExchanged},
    {"clavicle names an arm", "", BodyChange::AsTheyAre, true, false, BodyChange::ArmsShifted},
};
// clang-format on

enum class EOutcome
{
    Right,
    Refused, // doubtful, or nothing fits
    Warned,  // used, with a doubt about a joint's role
    Silent,  // wrong without a warning
};

// The original stock profiles come before all others if they fit.
const ProfileChoice& Taken(const std::vector<ProfileChoice>& choices, bool& isOld)
{
    for (const char* old : {"PoserBVH.prf", "MaxBVH.prf"})
    {
        const auto found = std::ranges::find(choices, std::string(kAssets) + old, &ProfileChoice::path);
        isOld = found != choices.end() && found->match.IsWhole() && !found->adapted;
        if (isOld)
            return *found;
    }
    return choices.front();
}

bool SaysWhichIsWhich(const ProfileVerdict& verdict)
{
    return std::ranges::any_of(verdict.doubts,
                               [](const ProfileDoubt& doubt) { return IsOfRoles(doubt.kind); });
}

bool IsRight(const ProfileChoice& choice, const CNamedBody& body)
{
    const CMapRowTable& rows = choice.profile.rows;
    for (int row = 0; row < rows.RowCount(); ++row)
    {
        const CNode* const joint = FindBone(&body.Root(), rows.Text(row, kSourceColumn));
        if (joint && !body.MayDrive(rows.Text(row, kTargetColumn), joint->NameView()))
            return false;
    }
    return true;
}

// Matches all profiles with a skeleton and rates the chosen one.
EOutcome Outcome(const CNamedBody& body, const std::vector<std::string>& paths, CNode& target)
{
    const std::vector<ProfileChoice> choices = ChooseProfile(paths, body.Root(), target);
    bool isOld = false;
    const ProfileChoice& taken = Taken(choices, isOld);
    if (!taken.match.IsWhole() || (!isOld && taken.verdict.sureness == ESureness::Doubtful))
        return EOutcome::Refused;
    if (IsRight(taken, body))
        return EOutcome::Right;
    return SaysWhichIsWhich(taken.verdict) ? EOutcome::Warned : EOutcome::Silent;
}

TEST(NameTable, NearlyEveryConventionIsTakenRightAndNoWrongNamesInSilence)
{
    CMotionFile target;
    ASSERT_TRUE(target.Load(std::string(kAssets) + "base.htr"));
    std::vector<std::string> paths;
    for (const std::string& file : FilesInFolder(std::string(kAssets), ".prf"))
        paths.push_back(std::string(kAssets) + file);
    size_t count = 0;
    std::vector<std::string> others;
    for (const Convention& convention : kConventions)
    {
        for (const BodyChange& change : kChanges)
        {
            const bool hasClavicle = *convention.arm != '-';
            if (!hasClavicle && change.names > BodyChange::SidesSwapped)
                continue;
            const std::string what = std::string(convention.what) + ", " + change.what;
            const EOutcome outcome = Outcome(CNamedBody(convention, change), paths, *target.motionRoot);
            EXPECT_NE(outcome, EOutcome::Silent) << what;
            const bool namesAreRight = change.names == BodyChange::Right;
            EXPECT_TRUE(namesAreRight || outcome != EOutcome::Right) << what;
            count += namesAreRight ? 1 : 0;
            if (namesAreRight && outcome != EOutcome::Right)
                others.push_back(what);
        }
    }
    EXPECT_LE(others.size(), 2 * count / 100) << testing::PrintToString(others);
}

} // namespace
} // namespace gw
