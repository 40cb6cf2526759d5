// A target skeleton driven by an aligned motion, whatever rotations the profile's rows contain.

#include "AimBones.h"
#include "AlignMotion.h"
#include "BoneMeshQueries.h"
#include "CKeyframeControl.h"
#include "CMadeBody.h"
#include "CPoseSampler.h"
#include "CRetargeter.h"
#include "Directions.h"
#include "MotionNode.h"
#include "Rotations.h"
#include "Skeleton.h"
#include "TurnedBones.h"

#include <gtest/gtest.h>
#include <map>

namespace gw {
namespace {

// A target like the host's: bones along their own Y.
constexpr MadeBone kBones[] = {
    {"LowerTorso", "", {0, 923, 13}, 0},      {"Waist", "LowerTorso", {0, 95, 0}, 0},
    {"UpperTorso", "Waist", {0, 150, 0}, 0},  {"Neck", "UpperTorso", {0, 265, 0}, 0},
    {"Head", "Neck", {0, 95, 0}, 0},          {"LCollar", "UpperTorso", {25, 215, 0}, -90},
    {"LUpperArm", "LCollar", {0, 145, 0}, 0}, {"LForearm", "LUpperArm", {0, 285, 0}, 0},
    {"LHand", "LForearm", {0, 255, 0}, 0},    {"LPelvis", "LowerTorso", {0, 0, 0}, 180},
    {"LThigh", "LPelvis", {-95, 138, 0}, 0},  {"LCalf", "LThigh", {0, 360, 0}, 0},
    {"LFoot", "LCalf", {0, 345, 0}, 0},
};

class CTarget : public CMadeFigure
{
public:
    CTarget() : CMadeFigure(kBones)
    {
        for (const MadeBone& bone : kBones)
            AttachBone(Bone(bone.name), bone.name, 1, 100.0f);
        Root().UpdateScene(0.0f, true);
        for (CNode* node : NodesOf(Root()))
            m_kRest.emplace(node->GetName(), NormalizedRows(node->m_kWorldMatrix));
    }
    const Mat3& Rest(const std::string& name) const { return m_kRest.at(name); }

private:
    std::map<std::string, Mat3> m_kRest;
};

// Maps all target bones to the source bones with the same names, with rotations that would spoil a
// conversion.
void FillTable(CRetargeter& table, const CMadeBody& source, const CTarget& target)
{
    table.SetScenes(source.Motion().root, &target.Root());
    for (const MadeBone& bone : kBones)
    {
        if (!source.HasJoint(bone.name))
            continue;
        table.SetSourceOf(&target.Bone(bone.name), &source.Joint(bone.name));
        table.SetOffsetAngles(&target.Bone(bone.name), {40, -20, 70});
    }
}

CMadeBody HangingArms(std::vector<std::string> without = {})
{
    CMadeBody::Telling telling;
    telling.turn = [](const std::string& joint) {
        const bool isArm = joint == "LUpperArm" || joint == "LForearm" || joint == "LHand";
        return isArm ? TurnAbout(kVec3UnitZ, -80.0) : kMat3Identity;
    };
    telling.without = std::move(without);
    return CMadeBody(telling);
}

// Converts, and compares every bone's rotation from the target's rest pose with the joint's rotation from a
// T-pose.
void ExpectBonesFollow(const CMadeBody& told, const CMadeBody& truth, const CTarget& target,
                       CRetargeter& table)
{
    const BodyMotion motion = told.Motion();
    Alignment alignment;
    ASSERT_TRUE(PlanAlignment(motion, alignment));
    const AlignedMotion aligned = AlignMotion(motion, alignment);
    AimBones(table, target.Root(), motion, alignment, aligned);
    table.Retarget(0.0f, 39.0f, 0.0f, motion.frequency, {0, 923, 13}, true, false);
    for (const int frame : {0, 11, 39})
    {
        const float time = static_cast<float>(frame) / motion.frequency;
        truth.Motion().root->UpdateScene(time, true);
        target.Root().UpdateScene(time, true);
        for (const MadeBone& bone : kBones)
        {
            if (!truth.HasJoint(bone.name) || !told.HasJoint(bone.name))
                continue;
            const Mat3 turned = NormalizedRows(target.Bone(bone.name).m_kWorldMatrix);
            const Mat3 meant = target.Rest(bone.name) * NormalizedRows(truth.Joint(bone.name).m_kWorldMatrix);
            EXPECT_LT(DegreesBetween(turned, meant), 0.2) << bone.name << " at frame " << frame;
        }
    }
}

TEST(AimBones, LetsEveryBonePointAsItsSource)
{
    const CMadeBody told = HangingArms();
    const CTarget target;
    CRetargeter table;
    FillTable(table, told, target);
    ExpectBonesFollow(told, CMadeBody{{}}, target, table);
}

TEST(AimBones, TakesTheSpineWhereACollarDrivesTheTorso)
{
    const CMadeBody told = HangingArms();
    const CTarget target;
    CRetargeter table;
    FillTable(table, told, target);
    table.SetSourceOf(&target.Bone("UpperTorso"), &told.Joint("LCollar"));
    table.SetSourceOf(&target.Bone("Waist"), nullptr);
    table.SetFixed(&target.Bone("Waist"), true);
    ExpectBonesFollow(told, CMadeBody{{}}, target, table);
}

TEST(AimBones, KeepsACollarWithoutSourceAtTheTorso)
{
    const CMadeBody told = HangingArms();
    const CTarget target;
    CRetargeter table;
    FillTable(table, told, target);
    table.SetSourceOf(&target.Bone("LCollar"), nullptr);
    ExpectBonesFollow(told, CMadeBody{{}}, target, table);
}

TEST(AimBones, HangsLegsOnThePelvisHoweverTheSpineLeans)
{
    CMadeBody told = HangingArms();
    auto& waist = static_cast<CKeyframeControl&>(*told.Joint("Waist").GetControl());
    waist.m_kRestMatrix.SetTranslation({0, 10, -6});
    waist.m_kPositionKeys.assign(waist.m_kPositionKeys.size(), {0, 10, -6});
    const CTarget target;
    CRetargeter table;
    FillTable(table, told, target);
    const BodyMotion motion = told.Motion();
    Alignment alignment;
    ASSERT_TRUE(PlanAlignment(motion, alignment));
    const AlignedMotion aligned = AlignMotion(motion, alignment);
    AimBones(table, target.Root(), motion, alignment, aligned);
    table.Retarget(0.0f, 39.0f, 0.0f, motion.frequency, {0, 923, 13}, true, false);
    target.Root().UpdateScene(0.0f, true);
    const Vec3 spine = target.Bone("Waist").m_kWorldMatrix.Translation() -
                       target.Bone("LowerTorso").m_kWorldMatrix.Translation();
    EXPECT_LT(AngleBetween(spine, {0, 10, -6}), 0.1);
    const Vec3 thigh = target.Bone("LThigh").m_kWorldMatrix.Translation() -
                       target.Bone("LowerTorso").m_kWorldMatrix.Translation();
    EXPECT_LT(Vec3Length(thigh - Vec3{95, -138, 0}), 0.1);
}

TEST(FindTurnedBones, NamesLimbsThatRowsTurnAtRest)
{
    const CMadeBody hanging = HangingArms();
    const CMadeBody straight{{}};
    const CTarget target;
    const auto names = [&](const CMadeBody& source, bool spoil) {
        CRetargeter table;
        FillTable(table, source, target);
        for (const MadeBone& bone : kBones)
            table.SetOffsetAngles(&target.Bone(bone.name), spoil ? Vec3{0, 90, 0} : kVec3Zero);
        std::vector<std::string> found;
        for (const TurnedBone& bone : FindTurnedBones(table, target.Root()))
            found.push_back(bone.target);
        return found;
    };
    EXPECT_EQ(names(straight, false), std::vector<std::string>());
    EXPECT_EQ(names(hanging, false), (std::vector<std::string>{"LUpperArm", "LForearm"}));
    EXPECT_EQ(names(straight, true).size(), 6u) << "every limb and the spine, by a quarter turn";
}

} // namespace
} // namespace gw
