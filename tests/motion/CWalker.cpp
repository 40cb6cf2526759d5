#include "CWalker.h"

#include "Angles.h"
#include "Skeleton.h"

#include <cmath>

namespace gw {
namespace {

constexpr float kUpper = 45.0f;
constexpr float kLower = 37.0f;
constexpr const char* kSides[] = {"L", "R"};

constexpr MadeBone kBones[] = {
    {"Hips", "", {0.0f, 88.0f, 0.0f}},         {"LHip", "Hips", {9.0f, -4.0f, 0.0f}},
    {"LKnee", "LHip", {0.0f, -kUpper, 0.0f}},  {"LAnkle", "LKnee", {0.0f, -kLower, 0.0f}},
    {"LBall", "LAnkle", {0.0f, -6.0f, 14.0f}}, {"RHip", "Hips", {-9.0f, -4.0f, 0.0f}},
    {"RKnee", "RHip", {0.0f, -kUpper, 0.0f}},  {"RAnkle", "RKnee", {0.0f, -kLower, 0.0f}},
    {"RBall", "RAnkle", {0.0f, -6.0f, 14.0f}},
};
constexpr MadeBone kTarget[] = {
    {"LowerTorso", "", kTargetOrigin},
    {"Waist", "LowerTorso", {0.0f, 95.0f, 0.0f}},
    {"UpperTorso", "Waist", {0.0f, 150.0f, 0.0f}},
    {"Neck", "UpperTorso", {0.0f, 265.0f, 0.0f}},
    {"Head", "Neck", {0.0f, 95.0f, 0.0f}},
    {"LCollar", "UpperTorso", {25.0f, 215.0f, 0.0f}, -90.0},
    {"LUpperArm", "LCollar", {0.0f, 145.0f, 0.0f}},
    {"LForearm", "LUpperArm", {0.0f, 285.0f, 0.0f}},
    {"LHand", "LForearm", {0.0f, 255.0f, 0.0f}},
    {"LPelvis", "LowerTorso", kVec3Zero, 180.0},
    {"LThigh", "LPelvis", {-95.0f, 138.0f, 0.0f}},
    {"LCalf", "LThigh", {0.0f, 360.0f, 0.0f}},
    {"LFoot", "LCalf", {0.0f, 345.0f, 0.0f}},
    {"LToe", "LFoot", {0.0f, 62.0f, 130.0f}},
    {"RPelvis", "LowerTorso", kVec3Zero, 180.0},
    {"RThigh", "RPelvis", {95.0f, 138.0f, 0.0f}},
    {"RCalf", "RThigh", {0.0f, 360.0f, 0.0f}},
    {"RFoot", "RCalf", {0.0f, 345.0f, 0.0f}},
    {"RToe", "RFoot", {0.0f, 62.0f, 130.0f}},
};

// A bone that points down along a direction and turns about the knee's hinge.
Mat3 PointedAlong(const Vec3& direction, const Vec3& hinge)
{
    const Vec3 up = -Vec3Normalized(direction);
    Mat3 rotation;
    rotation.SetRow(0, hinge);
    rotation.SetRow(1, up);
    rotation.SetRow(2, Vec3Cross(hinge, up));
    return rotation;
}

void TurnTo(CNode& node, const Mat3& world, const Mat3& parentWorld)
{
    node.m_kMatrix = Mat4Compose(world * Mat3Transpose(parentWorld), node.m_kMatrix.Translation());
}

// How far a foot of the walk is in its cycle: it stands up to 0.6.
double PhaseOf(int side, int frame)
{
    return std::fmod(frame / 36.0 + (side == 0 ? 0.0 : 0.5), 1.0);
}

} // namespace

CWalker::CWalker() : CMadeFigure(kBones) {}

void CWalker::Record(int frameCount, const std::function<Pose(int frame)>& pose)
{
    const auto move = [&](CMadeFigure&, int frame) {
        const Pose at = pose(frame);
        const Mat3 pelvis = Mat3FromAxisAngle(kVec3UnitX, at.lean * kDegreesToRadians);
        Root().m_kMatrix = Mat4Compose(pelvis, at.hips + pelvis.Row(1) * 4.0f);
        for (size_t side = 0; side < 2; ++side)
            PoseLeg(side, at, pelvis);
    };
    CMadeFigure::Record(frameCount, move, kWalkerSeconds);
}

void CWalker::PoseLeg(size_t side, const Pose& pose, const Mat3& pelvis)
{
    const Vec3 toAnkle = pose.ankles[side] - pose.hips - pelvis.Row(0) * (side == 0 ? 9.0f : -9.0f);
    const double distance = Vec3Length(toAnkle);
    const Vec3 along = Vec3Normalized(toAnkle);
    const double out = (side == 0 ? 1.0 : -1.0) * static_cast<double>(pose.kneesOut * kDegreesToRadians);
    const Vec3 forward{static_cast<float>(std::sin(out)), 0.0f, static_cast<float>(std::cos(out))};
    const Vec3 bend = Vec3Normalized(forward - along * static_cast<float>(Vec3Dot(forward, along)));
    const double down = (distance * distance + kUpper * kUpper - kLower * kLower) / (2.0 * distance);
    const double off = std::sqrt(std::max(0.0, kUpper * kUpper - down * down));
    const Vec3 knee = along * static_cast<float>(down) + bend * static_cast<float>(off);

    const Vec3 hinge = Vec3Cross(bend, along);
    const Mat3 thigh = PointedAlong(knee, -hinge);
    const Mat3 shin = PointedAlong(toAnkle - knee, -hinge);
    const std::string name = kSides[side];
    TurnTo(Bone(name + "Hip"), thigh, pelvis);
    TurnTo(Bone(name + "Knee"), shin, thigh);
    TurnTo(Bone(name + "Ankle"), Mat3FromAxisAngle(kVec3UnitX, pose.footDegrees[side] * kDegreesToRadians),
           shin);
}

CWalker::Pose WalkingPose(int frame)
{
    constexpr double kStride = 70.0;
    CWalker::Pose pose;
    pose.hips.y = 83.0f + static_cast<float>(std::cos(4.0 * kPi64 * frame / 36.0));
    pose.hips.z = static_cast<float>(kStride * frame / 36.0);
    for (int side = 0; side < 2; ++side)
    {
        const double phase = PhaseOf(side, frame);
        const double swing = std::max(0.0, (phase - 0.6) / 0.4);
        const double start = kStride * (frame / 36.0 - phase + 0.3);
        Vec3& ankle = pose.ankles[static_cast<size_t>(side)];
        ankle.y += static_cast<float>(12.0 * std::pow(std::sin(kPi64 * swing), 2.0));
        ankle.z = static_cast<float>(start + kStride * swing * swing * (3.0 - 2.0 * swing));
        pose.footDegrees[static_cast<size_t>(side)] =
            static_cast<float>(12.0 * std::sin(2.0 * kPi64 * swing));
    }
    return pose;
}

bool WalkerStands(int side, int frame)
{
    const double phase = PhaseOf(side, frame);
    return phase > 0.1 && phase < 0.5;
}

Ref<CNode> MakeTarget()
{
    return &CMadeFigure(kTarget).Root();
}

void PairWalker(CRetargeter& retargeter, const CWalker& walker, CNode& target)
{
    const Mat3 halfTurn = Mat3FromAxisAngle(kVec3UnitZ, kPi);
    retargeter.SetScenes(&walker.Root(), &target);
    retargeter.SetSourceOf(&target, &walker.Root());
    for (const std::string side : kSides)
    {
        retargeter.SetFixed(FindNode(&target, (side + "Pelvis").c_str()), true);
        for (const auto& [bone, source] :
             {std::pair{"Thigh", "Hip"}, {"Calf", "Knee"}, {"Foot", "Ankle"}, {"Toe", "Ball"}})
        {
            CNode* const node = FindNode(&target, (side + bone).c_str());
            retargeter.SetSourceOf(node, &walker.Bone(side + source));
            retargeter.SetOffsetMatrix(node, halfTurn);
        }
    }
}

} // namespace gw
