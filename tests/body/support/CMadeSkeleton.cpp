#include "CMadeSkeleton.h"

#include "Angles.h"
#include "Euler.h"
#include "TempFolder.h"
#include "Text.h"

#include <cmath>

namespace gw {
namespace {

constexpr Mat3 kZUp{{1, 0, 0, 0, 0, 1, 0, -1, 0}};
constexpr Mat3 kTurned{{0, 0, 1, 0, 1, 0, -1, 0, 0}};

float SideX(EBodySide side)
{
    return side == EBodySide::Left ? 1.0f : -1.0f;
}

Vec3 Through(const Vec3& v, const Mat3& m)
{
    return m.Row(0) * v.x + m.Row(1) * v.y + m.Row(2) * v.z;
}

// Returns any rotation that takes +x to a direction.
Mat3 AlongX(const Vec3& direction)
{
    const Vec3 x = Vec3Normalized(direction);
    const Vec3 helper = std::fabs(x.z) < 0.9f ? kVec3UnitZ : kVec3UnitY;
    Mat3 m;
    m.SetRow(0, x);
    m.SetRow(1, Vec3Normalized(Vec3Cross(helper, x)));
    m.SetRow(2, Vec3Cross(m.Row(0), m.Row(1)));
    return m;
}

Mat3 Turn(const Vec3& degrees)
{
    const auto about = [](const Vec3& axis, float angle) {
        return Mat3FromAxisAngle(axis, angle * kDegreesToRadians);
    };
    return about(kVec3UnitX, degrees.x) * about(kVec3UnitY, degrees.y) * about(kVec3UnitZ, degrees.z);
}

} // namespace

CMadeSkeleton::CMadeSkeleton(std::string_view recipe, unsigned seed) : m_kRecipe(recipe), m_kRandom(seed)
{
    AddBody();
    if (Has("nopose"))
        TurnFrames(*m_spkRoot);
    const CTempFolder folder;
    WriteBytes(folder.Path("made.bvh"), Text());
    m_kMotion.Load(folder.Path("made.bvh"));
}

std::string CMadeSkeleton::NameAt(BodyPlace place) const
{
    const auto found = m_kRoles.find(IndexOf(place));
    return found == m_kRoles.end() ? std::string() : found->second;
}

bool CMadeSkeleton::Has(std::string_view word) const
{
    std::string_view rest = m_kRecipe;
    for (std::string_view token = NextToken(rest); !token.empty(); token = NextToken(rest))
    {
        if (token == word)
            return true;
    }
    return false;
}

int CMadeSkeleton::Number(std::string_view word, int otherwise) const
{
    constexpr int kMost = 10;
    for (int number = 0; number <= kMost; ++number)
    {
        if (Has(std::string(word) + std::to_string(number)))
            return number;
    }
    return otherwise;
}

double CMadeSkeleton::Jitter(double value)
{
    return value * std::uniform_real_distribution(0.97, 1.03)(m_kRandom);
}

CMadeSkeleton::Joint& CMadeSkeleton::Add(Joint* parent, const Vec3& place)
{
    constexpr std::string_view kLetters = "bcdfgkmnpqvwxz";
    auto joint = std::make_unique<Joint>();
    joint->name.resize(10);
    for (char& letter : joint->name)
        letter = kLetters[m_kRandom() % kLetters.size()];
    joint->place = place;
    joint->parent = parent;
    if (!parent)
        return *(m_spkRoot = std::move(joint));
    return *parent->children.emplace_back(std::move(joint));
}

CMadeSkeleton::Joint& CMadeSkeleton::AddAt(Joint& parent, const Vec3& place, BodyPlace role)
{
    Joint& joint = Add(&parent, place);
    m_kRoles[IndexOf(role)] = joint.name;
    return joint;
}

// Adds the joint at the end of a bone, with the bone's twist joints.
CMadeSkeleton::Joint& CMadeSkeleton::AddBone(Joint& from, const Vec3& to, BodyPlace role, bool twists)
{
    const Vec3 middle = (from.place + to) * 0.5f;
    if (Has("twistleaf") && twists)
        Add(&from, middle);
    return AddAt(Has("twist") && twists ? Add(&from, middle) : from, to, role);
}

CMadeSkeleton::Joint& CMadeSkeleton::AddHelpers(Joint& parent, const Vec3& place)
{
    if (!Has("helpers"))
        return parent;
    return Add(&Add(&parent, parent.place), place);
}

void CMadeSkeleton::AddBody()
{
    const Vec3 at{0.0f, 95.0f, 0.0f};
    Joint* above = Has("root") ? &Add(nullptr, kVec3Zero) : nullptr;
    Joint& hip = Add(above, at);
    m_kRoles[IndexOf({EBodyJoint::Hip})] = hip.name;
    const EBodySide first = Has("rightfirst") ? EBodySide::Right : EBodySide::Left;
    const EBodySide second = Has("rightfirst") ? EBodySide::Left : EBodySide::Right;
    if (Has("prop") && above)
        Add(above, {40.0f, 60.0f, 20.0f}).tip = {0.0f, 30.0f, 0.0f};
    if (Has("torsofirst"))
        AddTrunk(hip);
    AddLeg(hip, first);
    AddLeg(hip, second);
    if (!Has("torsofirst"))
        AddTrunk(hip);
    if (Has("tail"))
        Add(&Add(&Add(&hip, {0.0f, 92.0f, -12.0f}), {0.0f, 80.0f, -30.0f}), {0.0f, 70.0f, -55.0f});
}

void CMadeSkeleton::AddTrunk(Joint& hip)
{
    const int count = Number("spine", 3);
    const float height = count == 1 ? 25.0f : 42.0f;
    Joint* top = &hip;
    for (int i = 1; i <= count; ++i)
    {
        const float share = static_cast<float>(i) / static_cast<float>(count);
        const Vec3 place = hip.place + Vec3{0.0f, height * share, -4.0f * std::sin(3.0f * share)};
        top = &AddAt(*top, place, {EBodyJoint::Spine});
    }
    const bool rightFirst = Has("rightfirst");
    if (Has("torsofirst"))
        AddHead(*top);
    AddArm(*top, rightFirst ? EBodySide::Right : EBodySide::Left);
    AddArm(*top, rightFirst ? EBodySide::Left : EBodySide::Right);
    if (!Has("torsofirst"))
        AddHead(*top);
}

void CMadeSkeleton::AddHead(Joint& chest)
{
    Joint* top = &chest;
    float y = 152.0f;
    for (int i = Number("neck", 1); i > 0; --i)
    {
        Joint& neck = Add(top, {0.0f, y, 1.0f});
        if (top == &chest)
            m_kRoles[IndexOf({EBodyJoint::Neck})] = neck.name;
        top = &neck;
        y += 10.0f / static_cast<float>(Number("neck", 1));
    }
    Joint& head = AddAt(*top, {0.0f, std::max(y, 160.0f), 2.0f}, {EBodyJoint::Head});
    head.tip = Has("bare") ? kVec3Zero : Vec3{0.0f, 18.0f, 0.0f};
    if (Has("headend"))
        Add(&head, head.place + Vec3{0.0f, 19.0f, 1.0f});
    if (!Has("face"))
        return;
    Add(&head, head.place + Vec3{3.2f, 8.0f, 8.0f});
    Add(&head, head.place + Vec3{-3.2f, 8.0f, 8.0f});
    Add(&Add(&head, head.place + Vec3{0.0f, 2.0f, 5.0f}), head.place + Vec3{0.0f, 0.0f, 9.0f});
}

void CMadeSkeleton::AddLeg(Joint& hip, EBodySide side)
{
    const float x = 9.0f * SideX(side);
    const auto length = static_cast<float>(Has("child") ? 0.7 : 1.0);
    const Vec3 hipPlace{x, 91.0f, 0.5f};
    const Vec3 knee = hipPlace + Vec3{0.3f * x, -41.0f * length, 0.4f} * static_cast<float>(Jitter(1.0));
    const Vec3 ankle = knee + Vec3{0.0f, -40.0f * length, -1.2f} * static_cast<float>(Jitter(1.0));
    Joint& top = Has("hipjoints") ? Add(&hip, {0.4f * x, 93.0f, 0.0f}) : hip;
    Joint& thigh = AddAt(AddHelpers(top, hipPlace), hipPlace, {EBodyJoint::Thigh, side});
    Joint& shin = AddBone(thigh, knee, {EBodyJoint::Shin, side}, true);
    thigh.swing = {25.0f * SideX(side), 0.0f, 0.0f};
    shin.swing = {30.0f, 0.0f, 0.0f};
    if (Has("nofeet"))
        shin.tip = ankle - knee;
    else
        AddFoot(AddBone(shin, ankle, {EBodyJoint::Foot, side}, true), side, x);
}

void CMadeSkeleton::AddFoot(Joint& ankle, EBodySide side, float x)
{
    const Vec3 ball = ankle.place + Vec3{0.06f * x, -7.0f, 13.0f};
    ankle.tip = Has("bare") ? kVec3Zero : ball - ankle.place;
    if (Has("notoes"))
        return;
    Joint& toe = AddAt(ankle, ball, {EBodyJoint::Toe, side});
    toe.tip = {0.0f, 0.0f, Has("bare") ? 0.0f : 6.0f};
    for (int i = 0; Has("toes5") && i < 5; ++i)
        Add(&Add(&toe, ball + Vec3{0.2f * static_cast<float>(i - 2) * x, 0.0f, 2.0f}),
            ball + Vec3{0.2f * static_cast<float>(i - 2) * x, 0.0f, 5.0f});
}

void CMadeSkeleton::AddArm(Joint& chest, EBodySide side)
{
    const float s = SideX(side);
    const double dip = Has("down") ? 82.0 : Has("apose") ? 42.0 : 0.0;
    const auto angle = static_cast<float>(dip * kDegreesToRadians64);
    const float size = Has("longarms") ? 1.2f : Has("child") ? 0.75f : 1.0f;
    const Vec3 along{s * std::cos(angle), -std::sin(angle), 0.02f};
    const Vec3 shoulder{17.5f * s, 146.0f, -1.0f};
    const Vec3 elbow = shoulder + along * (28.0f * size * static_cast<float>(Jitter(1.0)));
    const Vec3 wrist =
        elbow + (along + Vec3{0.0f, 0.0f, 0.05f}) * (25.5f * size * static_cast<float>(Jitter(1.0)));
    Joint* top = &chest;
    if (!Has("noclavicle"))
        top = &AddAt(AddHelpers(chest, {3.0f * s, 147.0f, 1.0f}), {3.0f * s, 147.0f, 1.0f},
                     {EBodyJoint::Clavicle, side});
    Joint& upper = AddAt(*top, shoulder, {EBodyJoint::UpperArm, side});
    Joint& forearm = AddBone(upper, elbow, {EBodyJoint::Forearm, side}, true);
    Joint& hand = AddBone(forearm, wrist, {EBodyJoint::Hand, side}, true);
    upper.swing = {-20.0f * s, 0.0f, 0.0f};
    hand.tip = along * (Has("bare") ? 0.0f : 9.0f);
    if (Has("fingers"))
        AddFingers(hand, along);
    if (Has("sword") && side == EBodySide::Right)
        Add(&Add(&hand, wrist + along * 7.0f), wrist + along * 7.0f + Vec3{0.0f, 20.0f, 90.0f});
}

void CMadeSkeleton::AddFingers(Joint& hand, const Vec3& along)
{
    for (int i = -2; i <= 2; ++i)
    {
        Joint* joint = &hand;
        for (const float step : {i == -2 ? 4.0f : 9.0f, 13.0f, 15.5f})
            joint = &Add(joint, hand.place + along * step + Vec3{0.0f, 0.0f, -1.8f * static_cast<float>(i)});
    }
}

// Rotates the frame of every joint so that its first child is along x.
void CMadeSkeleton::TurnFrames(Joint& joint)
{
    const Vec3 bone = joint.children.empty() ? joint.tip : joint.children.front()->place - joint.place;
    if (Vec3Length(bone) > 0.0)
        joint.world = AlongX(World(bone));
    for (const auto& child : joint.children)
        TurnFrames(*child);
}

// Converts from the stance's axes to the file's.
Vec3 CMadeSkeleton::World(const Vec3& place) const
{
    Vec3 world = Has("turned") ? Through(place, kTurned) : place;
    world = Has("zup") ? Through(world, kZUp) : world;
    return Has("metres") ? world * 0.01f : world;
}

Vec3 CMadeSkeleton::OffsetOf(const Joint& joint) const
{
    if (!joint.parent)
        return kVec3Zero;
    return Through(World(joint.place - joint.parent->place), Mat3Transpose(joint.parent->world));
}

void CMadeSkeleton::AppendJoints(std::vector<TextJoint>& joints, const Joint& joint, int parent) const
{
    const auto self = static_cast<int>(joints.size());
    const Vec3 tip = Through(World(joint.tip), Mat3Transpose(joint.world));
    joints.push_back({joint.name, parent, OffsetOf(joint), tip});
    for (const auto& child : joint.children)
        AppendJoints(joints, *child, self);
}

// Appends the angles of a joint and its subtree for a step of the walk; legs and arms swing about the
// stance's x axis, knees only backward.
void CMadeSkeleton::AppendRotations(std::vector<Vec3>& degrees, const Joint& joint, const Mat3& parentTurn,
                                    double phase) const
{
    const double swing = Has("walk") ? std::sin(phase) : 0.0;
    const bool isKnee = joint.swing.x == 30.0f;
    const auto amount = static_cast<float>(isKnee ? Has("walk") * (1.2 + swing) * 0.6 : swing);
    Mat3 turn = Turn(joint.swing * amount);
    if (amount != 0.0f)
    {
        // The swing axis in the file's axes.
        Mat3 axes;
        axes.SetRow(0, Vec3Normalized(World(kVec3UnitX)));
        axes.SetRow(1, Vec3Normalized(World(kVec3UnitY)));
        axes.SetRow(2, Vec3Normalized(World(kVec3UnitZ)));
        turn = Mat3Transpose(axes) * turn * axes;
    }
    const Mat3 world = turn * parentTurn;
    const Mat3 parentWorld = joint.parent ? joint.parent->world * parentTurn : kMat3Identity;
    const Mat3 local = joint.world * world * Mat3Transpose(parentWorld);
    Vec3 angles;
    Mat3ToEuler(local, static_cast<int>(EEulerOrder::ZXY), angles.x, angles.y, angles.z);
    if (Has("rest"))
        angles = kVec3Zero;
    degrees.push_back(angles * (1.0f / kDegreesToRadians));
    for (const auto& child : joint.children)
        AppendRotations(degrees, *child, world, phase);
}

std::string CMadeSkeleton::Text() const
{
    std::vector<TextJoint> joints;
    AppendJoints(joints, *m_spkRoot, -1);
    std::vector<Vec3> degrees; // of a frame, joint by joint
    const auto key = [&](size_t joint, int frame) {
        if (joint == 0)
        {
            degrees.clear();
            AppendRotations(degrees, *m_spkRoot, kMat3Identity, 0.5 * frame);
        }
        return TextKey{joint == 0 ? World(m_spkRoot->place) : kVec3Zero, degrees[joint]};
    };
    return CMadeText(std::move(joints)).Write(Has("walk") ? 24 : 1, 0.04, key);
}

std::vector<std::string> SkeletonRecipes()
{
    return {
        "",
        "bare",
        "notoes",
        "nofeet walk",
        "noclavicle",
        "noclavicle neck0 bare",
        "fingers",
        "fingers toes5 face headend",
        "headend bare",
        "headend neck3 bare",
        "face neck2",
        "neck0",
        "neck3",
        "spine1",
        "spine2",
        "spine4",
        "spine6",
        "spine10 neck3",
        "helpers",
        "helpers fingers notoes",
        "hipjoints",
        "hipjoints zup",
        "hipjoints notoes bare walk",
        "twist",
        "twist fingers apose",
        "twist hipjoints helpers fingers toes5",
        "twistleaf",
        "twistleaf fingers down",
        "root",
        "root prop",
        "root prop torsofirst",
        "sword",
        "sword fingers down",
        "tail",
        "rightfirst",
        "rightfirst zup metres",
        "torsofirst",
        "torsofirst rightfirst fingers",
        "zup",
        "zup turned",
        "turned",
        "apose",
        "apose bare metres",
        "down",
        "down twist fingers",
        "nopose walk",
        "nopose walk rightfirst fingers",
        "nopose walk zup helpers",
        "nopose walk notoes",
        "nopose",
        "walk",
        "walk notoes bare twist",
        "child",
        "child fingers down",
        "longarms",
        "longarms noclavicle apose",
    };
}

} // namespace gw
