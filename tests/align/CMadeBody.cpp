#include "CMadeBody.h"

#include "Directions.h"
#include "FindBodyByNames.h"
#include "Skeleton.h"

#include <algorithm>
#include <cmath>

namespace gw {
namespace {

constexpr float kFrequency = 1.0f / 30.0f;

constexpr MadeBone kJoints[] = {
    {"LowerTorso", "", {0, 90, 0}},        {"Waist", "LowerTorso", {0, 10, 0}},
    {"UpperTorso", "Waist", {0, 15, 0}},   {"Neck", "UpperTorso", {0, 25, 0}},
    {"Head", "Neck", {0, 10, 0}},          {"LCollar", "UpperTorso", {3, 20, 0}},
    {"LUpperArm", "LCollar", {14, 0, 0}},  {"LForearm", "LUpperArm", {28, 0, 0}},
    {"LHand", "LForearm", {25, 0, 0}},     {"LThumb", "LHand", {3, -1, 4}},
    {"LIndex", "LHand", {9, 0, 3}},        {"LMiddle", "LHand", {9, 0, 0}},
    {"LLittle", "LHand", {9, 0, -3}},      {"RCollar", "UpperTorso", {-3, 20, 0}},
    {"RUpperArm", "RCollar", {-14, 0, 0}}, {"RForearm", "RUpperArm", {-28, 0, 0}},
    {"RHand", "RForearm", {-25, 0, 0}},    {"LThigh", "LowerTorso", {9, -5, 0}},
    {"LCalf", "LThigh", {0, -40, 0}},      {"LFoot", "LCalf", {0, -38, 0}},
    {"LToe", "LFoot", {0, -6, 13}},        {"RThigh", "LowerTorso", {-9, -5, 0}},
    {"RCalf", "RThigh", {0, -40, 0}},      {"RFoot", "RCalf", {0, -38, 0}},
    {"RToe", "RFoot", {0, -6, 13}},
};
constexpr Vec3 kHandEnd{-9, 0, 0};
constexpr double kLeg = 78.0;

// Returns a joint's rotation in the squat at a frame. Feet stay level while the hips go down and the arms up.
Mat3 Pose(const std::string& joint, int frame)
{
    const double phase = std::sin(0.16 * frame);
    const double squat = 4.0 + 40.0 * phase * phase;
    const double arms = 5.0 + 70.0 * phase * phase; // below the T-pose
    const double side = joint.starts_with('L') ? 1.0 : -1.0;
    const std::string part = joint.substr(1);
    if (part == "Thigh")
        return TurnAbout(kVec3UnitX, -squat);
    if (part == "Calf")
        return TurnAbout(kVec3UnitX, 2.0 * squat);
    if (part == "Foot")
        return TurnAbout(kVec3UnitX, -squat);
    if (part == "UpperArm")
        return TurnAbout(kVec3UnitZ, -side * arms);
    if (part == "Forearm")
        return TurnAbout(kVec3UnitY, -side * 1.5 * squat);
    if (joint == "Head")
        return TurnAbout(kVec3UnitY, 20.0 * phase);
    return kMat3Identity;
}

Vec3 RootPlace(int frame)
{
    const double phase = std::sin(0.16 * frame);
    const double squat = (4.0 + 40.0 * phase * phase) / 180.0 * std::acos(-1.0);
    return {20.0f, static_cast<float>(90.0 - kLeg * (1.0 - std::cos(squat))), -30.0f};
}

} // namespace

CMadeBody::CMadeBody(const Telling& telling) : m_iFrames(telling.frameCount)
{
    const auto above = [&](const std::string& parent) {
        return parent.empty() ? telling.world : telling.turn(parent);
    };
    std::vector<MadeBone> joints;
    for (const MadeBone& joint : kJoints)
    {
        const bool orphan = *joint.parent && !HasJoint(joint.parent);
        if (orphan || std::ranges::find(telling.without, joint.name) != telling.without.end())
            continue;
        m_kFigure.AddBone(joint.name, joint.parent, Turned(joint.offset, above(joint.parent)));
        m_kNames.emplace_back(joint.name);
        joints.push_back(joint);
    }
    m_kFigure.Record(
        telling.frameCount,
        [&](CMadeFigure& figure, int frame) {
            for (const MadeBone& joint : joints)
            {
                Mat4& matrix = figure.Bone(joint.name).m_kMatrix;
                const int over = std::max(0, frame - telling.frameCount + telling.tumbling);
                const Mat3 tumble = TurnAbout(kVec3UnitZ, 360.0 * over / std::max(telling.tumbling, 1));
                const Mat3 pose = Pose(joint.name, frame) * (*joint.parent ? kMat3Identity : tumble);
                const Mat3 turn = Mat3Transpose(telling.turn(joint.name)) * pose;
                matrix = Mat4Compose(turn * above(joint.parent),
                                     *joint.parent ? matrix.Translation() * (telling.doubled ? 2.0f : 1.0f)
                                                   : Turned(RootPlace(frame), telling.world));
            }
        },
        kFrequency);
    for (const std::string& name : m_kNames)
        m_kFigure.AddMesh(name, Turned(name == "RHand" ? kHandEnd : Vec3{0, 5, 0}, telling.turn(name)));
    m_kFigure.Root().UpdateScene(0.0f, true);
}

CKeyframeControl& CMadeBody::Track(const std::string& name) const
{
    return static_cast<CKeyframeControl&>(*Joint(name).GetControl());
}

BodyMotion CMadeBody::Motion() const
{
    CBodyMap body = FindBodyByNames(m_kFigure.Root());
    if (!HasJoint("Neck")) // names of a spine say nothing without it
        body.spine = {&Joint("Waist"), &Joint("UpperTorso")};
    return {&m_kFigure.Root(), kFrequency, m_iFrames, body};
}

bool IsOneOf(const std::string& joint, std::initializer_list<const char*> parts)
{
    return std::ranges::any_of(parts, [&](const char* part) { return joint.substr(1) == part; });
}

CMadeBody::Turn ArmsDown(double degrees)
{
    return [=](const std::string& joint) {
        const bool isArm =
            IsOneOf(joint, {"UpperArm", "Forearm", "Hand", "Thumb", "Index", "Middle", "Little"});
        return isArm ? TurnAbout(kVec3UnitZ, joint[0] == 'L' ? -degrees : degrees) : kMat3Identity;
    };
}

std::vector<Mat4> WorldsAt(CNode& root, float frequency, int frame)
{
    root.UpdateScene(static_cast<float>(frame) / frequency, true);
    std::vector<Mat4> worlds;
    for (const CNode* node : NodesOf(root))
        worlds.push_back(node->m_kWorldMatrix);
    return worlds;
}

} // namespace gw
