// A target skeleton driven by an aligned motion, whatever rotations the profile's rows contain.

#include "AimBones.h"
#include "AlignMotion.h"
#include "CMadeBody.h"
#include "CRetargeter.h"
#include "Directions.h"
#include "Rotations.h"
#include "TurnedBones.h"

#include <functional>
#include <gtest/gtest.h>

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
            AddMesh(bone.name, kVec3UnitY * 100.0f);
        Root().UpdateScene(0.0f, true);
    }
    Mat3 World(const std::string& name) const { return NormalizedRows(Bone(name).m_kWorldMatrix); }
    /// Returns the way to a bone from the one that carries all.
    Vec3 WayTo(const std::string& name) const
    {
        return Bone(name).m_kWorldMatrix.Translation() - Root().m_kWorldMatrix.Translation();
    }
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

void Convert(const CMadeBody& told, const CTarget& target, CRetargeter& table)
{
    const BodyMotion motion = told.Motion();
    Alignment alignment;
    ASSERT_TRUE(PlanAlignment(motion, alignment));
    const AlignedMotion aligned = AlignMotion(motion, alignment);
    AimBones(table, target.Root(), motion, alignment, aligned);
    table.Retarget(0.0f, 39.0f, 0.0f, motion.frequency, {0, 923, 13}, true, false);
}

// Every bone's rotation from the target's rest pose is the joint's rotation from a T-pose.
void ExpectBonesFollow(const CMadeBody& truth, const CTarget& target, int frame)
{
    const float time = static_cast<float>(frame) / truth.Motion().frequency;
    const CTarget rest;
    truth.Motion().root->UpdateScene(time, true);
    target.Root().UpdateScene(time, true);
    for (const MadeBone& bone : kBones)
    {
        if (!truth.HasJoint(bone.name))
            continue;
        const Mat3 meant = rest.World(bone.name) * NormalizedRows(truth.Joint(bone.name).m_kWorldMatrix);
        EXPECT_LT(DegreesBetween(target.World(bone.name), meant), 0.2) << bone.name << " at " << frame;
    }
}

TEST(AimBones, LetsEveryBonePointAsItsSource)
{
    const CMadeBody told({.turn = ArmsDown(80.0)});
    const CMadeBody truth{{}};
    const struct
    {
        const char* what;
        std::function<void(CRetargeter&, const CTarget&)> change;
    } rows[] = {
        {"whatever the rows turn", [](CRetargeter&, const CTarget&) {}},
        {"by the spine where a collar drives the torso",
         [&](CRetargeter& table, const CTarget& target) {
             table.SetSourceOf(&target.Bone("UpperTorso"), &told.Joint("LCollar"));
             table.SetSourceOf(&target.Bone("Waist"), nullptr);
             table.SetFixed(&target.Bone("Waist"), true);
         }},
        {"with the torso if it is a collar without source",
         [](CRetargeter& table, const CTarget& target) {
             table.SetSourceOf(&target.Bone("LCollar"), nullptr);
         }},
    };
    for (const auto& [what, change] : rows)
    {
        SCOPED_TRACE(what);
        const CTarget target;
        CRetargeter table;
        FillTable(table, told, target);
        change(table, target);
        Convert(told, target, table);
        for (const int frame : {0, 11, 39})
            ExpectBonesFollow(truth, target, frame);
    }
}

TEST(AimBones, HangsLegsOnThePelvisHoweverTheSpineLeans)
{
    const CMadeBody told({.turn = ArmsDown(80.0)});
    CKeyframeControl& waist = told.Track("Waist");
    waist.m_kRestMatrix.SetTranslation({0, 10, -6});
    waist.m_kPositionKeys.assign(waist.m_kPositionKeys.size(), {0, 10, -6});
    const CTarget target;
    CRetargeter table;
    FillTable(table, told, target);
    Convert(told, target, table);
    target.Root().UpdateScene(0.0f, true);
    EXPECT_LT(AngleBetween(target.WayTo("Waist"), {0, 10, -6}), 0.1);
    EXPECT_LT(Vec3Length(target.WayTo("LThigh") - Vec3{95, -138, 0}), 0.1);
}

TEST(FindTurnedBones, NamesLimbsThatRowsTurnAtRest)
{
    const CMadeBody hanging({.turn = ArmsDown(80.0)});
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
