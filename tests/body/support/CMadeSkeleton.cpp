#include "CMadeSkeleton.h"

#include "Angles.h"
#include "Directions.h"
#include "Text.h"

#include <algorithm>
#include <cmath>

namespace gw {
namespace {

// Separated by commas.
constexpr std::string_view kRecipes =
    "plain, bare, notoes, nofeet walk, noclavicle, noclavicle neck0 bare, "
    "fingers toes5 face headend, headend neck3 bare, face neck2, neck0, spine1, spine2, spine6, "
    "spine10 neck3, helpers fingers notoes, hipjoints zup, hipjoints notoes bare walk, "
    "twist fingers apose, twist hipjoints helpers fingers toes5, twistleaf fingers down, root, "
    "root prop torsofirst, sword, sword fingers down, tail, rightfirst zup metres, "
    "torsofirst rightfirst fingers, zup turned, apose longends metres, down twist fingers, "
    "nopose walk rightfirst fingers, nopose walk zup helpers, nopose walk notoes, nopose, "
    "walk notoes bare twist, child fingers down, longarms noclavicle apose";

float SideX(EBodySide side)
{
    return side == EBodySide::Left ? 1.0f : -1.0f;
}

} // namespace

std::vector<std::string> SkeletonRecipes()
{
    std::vector<std::string> recipes;
    for (std::string_view rest = kRecipes; !rest.empty();)
        recipes.emplace_back(NextToken(rest, ","));
    return recipes;
}

CMadeSkeleton::CMadeSkeleton(std::string_view recipe, unsigned seed)
    : m_kRecipe(' ' + std::string(recipe) + ' '), m_kRandom(seed),
      m_kAxes((Has("turned") ? TurnAbout(kVec3UnitY, -90.0) : kMat3Identity) *
              (Has("zup") ? TurnAbout(kVec3UnitX, 90.0) : kMat3Identity)),
      m_kFigure(std::span<const MadeBone>(), Has("metres") ? 0.01 : 1.0)
{
    AddBody();
    if (Has("nopose"))
        TurnFrames();
    for (const Joint& joint : m_kJoints)
    {
        const Joint& parent = m_kJoints[joint.parent];
        const Vec3 offset = Turned(joint.place - parent.place, m_kAxes);
        m_kFigure.Move(joint.node->GetName(), ToLocal(offset, parent.frame));
    }
    for (const Joint& joint : m_kJoints)
    {
        const Vec3 tip = Has("longends") ? kVec3UnitX * 100.0f : joint.tip;
        m_kFigure.AddMesh(joint.node->GetName(), ToLocal(Turned(tip, m_kAxes), joint.frame));
    }
    m_kFigure.Record(
        Has("walk") ? 24 : 1, [this](CMadeFigure&, int frame) { Pose(frame); }, 0.04f);
    m_kMotion.motionRoot = &m_kFigure.Root();
}

bool CMadeSkeleton::Has(std::string_view word) const
{
    return m_kRecipe.find(' ' + std::string(word) + ' ') != m_kRecipe.npos;
}

int CMadeSkeleton::Number(std::string_view word, int otherwise) const
{
    const size_t at = m_kRecipe.find(word);
    return at == m_kRecipe.npos ? otherwise : std::stoi(m_kRecipe.substr(at + word.size()));
}

float CMadeSkeleton::Jitter()
{
    return Has("exact") ? 1.0f : std::uniform_real_distribution(0.97f, 1.03f)(m_kRandom);
}

// Adds a joint with a name that says nothing; the first one is the root.
size_t CMadeSkeleton::Add(size_t parent, const Vec3& place, CNode** role)
{
    constexpr std::string_view kLetters = "bcdfgkmnpqvwxz";
    std::string name(10, ' ');
    for (char& letter : name)
        letter = kLetters[m_kRandom() % kLetters.size()];
    const std::string above = m_kJoints.empty() ? "" : m_kJoints[parent].node->GetName();
    m_kJoints.push_back({&m_kFigure.AddBone(name, above, kVec3Zero), parent, place});
    if (role)
        *role = m_kJoints.back().node;
    return m_kJoints.size() - 1;
}

// Adds the joint at the end of a long bone, with the bone's twist joints.
size_t CMadeSkeleton::AddBone(size_t from, const Vec3& to, CNode** role)
{
    const Vec3 middle = (m_kJoints[from].place + to) * 0.5f;
    if (Has("twistleaf"))
        Add(from, middle);
    return Add(Has("twist") ? Add(from, middle) : from, to, role);
}

size_t CMadeSkeleton::AddHelpers(size_t parent, const Vec3& place)
{
    return Has("helpers") ? Add(Add(parent, m_kJoints[parent].place), place) : parent;
}

void CMadeSkeleton::AddBody()
{
    const size_t above = Has("root") ? Add(0, kVec3Zero) : 0;
    const size_t hip = Add(above, {0.0f, 95.0f, 0.0f}, &m_kBody.hip);
    if (Has("prop"))
        m_kJoints[Add(above, {40.0f, 60.0f, 20.0f})].tip = {0.0f, 30.0f, 0.0f};
    if (Has("torsofirst"))
        AddTrunk(hip);
    AddLeg(hip, Has("rightfirst") ? EBodySide::Right : EBodySide::Left);
    AddLeg(hip, Has("rightfirst") ? EBodySide::Left : EBodySide::Right);
    if (!Has("torsofirst"))
        AddTrunk(hip);
    if (Has("tail"))
        Add(Add(Add(hip, {0.0f, 92.0f, -12.0f}), {0.0f, 80.0f, -30.0f}), {0.0f, 70.0f, -55.0f});
}

void CMadeSkeleton::AddTrunk(size_t hip)
{
    const int count = Number("spine", 3);
    const float height = count == 1 ? 25.0f : 42.0f;
    size_t top = hip;
    for (int i = 1; i <= count; ++i)
    {
        const float share = static_cast<float>(i) / static_cast<float>(count);
        const float curve = Has("exact") ? 0.0f : -4.0f * std::sin(3.0f * share);
        top = Add(top, {0.0f, 95.0f + height * share, curve}, &m_kBody.spine.emplace_back());
    }
    if (Has("torsofirst"))
        AddHead(top);
    AddArm(top, Has("rightfirst") ? EBodySide::Right : EBodySide::Left);
    AddArm(top, Has("rightfirst") ? EBodySide::Left : EBodySide::Right);
    if (!Has("torsofirst"))
        AddHead(top);
}

void CMadeSkeleton::AddHead(size_t chest)
{
    const int count = Number("neck", 1);
    const float forward = Has("exact") ? 0.0f : 1.0f;
    size_t top = chest;
    float y = 152.0f;
    for (int i = 0; i < count; ++i)
    {
        top = Add(top, {0.0f, y, forward}, &m_kBody.neck.emplace_back());
        y += 10.0f / static_cast<float>(count);
    }
    const Vec3 place{0.0f, std::max(y, 160.0f), 2.0f * forward};
    const size_t head = Add(top, place, &m_kBody.head);
    m_kJoints[head].tip = {0.0f, Has("bare") ? 0.0f : 18.0f, 0.0f};
    if (Has("headend"))
        Add(head, place + Vec3{0.0f, 19.0f, 1.0f});
    if (!Has("face"))
        return;
    Add(head, place + Vec3{3.2f, 8.0f, 8.0f});
    Add(head, place + Vec3{-3.2f, 8.0f, 8.0f});
    Add(Add(head, place + Vec3{0.0f, 2.0f, 5.0f}), place + Vec3{0.0f, 0.0f, 9.0f});
}

void CMadeSkeleton::AddLeg(size_t hip, EBodySide side)
{
    BodyLeg& leg = m_kBody.Leg(side);
    const float x = 9.0f * SideX(side);
    const float length = Has("child") ? 0.7f : 1.0f;
    const Vec3 hipPlace{x, 91.0f, 0.5f};
    const Vec3 knee = hipPlace + Vec3{0.3f * x, -41.0f * length, 0.4f} * Jitter();
    const Vec3 ankle = knee + Vec3{0.0f, -40.0f * length, -1.2f} * Jitter();
    const float share = side == EBodySide::Left ? 0.6f : 0.4f;
    const size_t top = Has("hipjoints") ? Add(hip, {share * x, 93.0f, 0.0f}) : hip;
    const size_t thigh = Add(AddHelpers(top, hipPlace), hipPlace, &leg.thigh);
    const size_t shin = AddBone(thigh, knee, &leg.shin);
    m_kJoints[thigh].swing = 25.0 * SideX(side);
    m_kJoints[shin].bend = 22.0;
    m_kJoints[shin].swing = 18.0;
    if (Has("nofeet"))
        m_kJoints[shin].tip = ankle - knee;
    else
        AddFoot(shin, ankle, side);
}

void CMadeSkeleton::AddFoot(size_t shin, const Vec3& ankle, EBodySide side)
{
    BodyLeg& leg = m_kBody.Leg(side);
    const float x = 9.0f * SideX(side);
    const Vec3 ball = ankle + Vec3{0.06f * x, -7.0f, 13.0f};
    const size_t foot = AddBone(shin, ankle, &leg.foot);
    m_kJoints[foot].tip = Has("bare") ? kVec3Zero : ball - ankle;
    if (Has("notoes"))
        return;
    const size_t toe = Add(foot, ball, &leg.toe);
    m_kJoints[toe].tip = {0.0f, 0.0f, Has("bare") ? 0.0f : 6.0f};
    for (int i = -2; Has("toes5") && i <= 2; ++i)
    {
        const Vec3 beside = ball + Vec3{0.2f * static_cast<float>(i) * x, 0.0f, 2.0f};
        Add(Add(toe, beside), beside + kVec3UnitZ * 3.0f);
    }
}

void CMadeSkeleton::AddArm(size_t chest, EBodySide side)
{
    BodyArm& arm = m_kBody.Arm(side);
    const float s = SideX(side);
    const double dip = Has("down") ? 82.0 : Has("apose") ? 42.0 : 0.0;
    const auto angle = static_cast<float>(dip * kDegreesToRadians64);
    const float size = Has("longarms") ? 1.2f : Has("child") ? 0.75f : 1.0f;
    const Vec3 along{s * std::cos(angle), -std::sin(angle), 0.02f};
    const Vec3 clavicle{3.0f * s, 147.0f, 1.0f};
    const Vec3 shoulder{17.5f * s, 146.0f, -1.0f};
    const Vec3 elbow = shoulder + along * (28.0f * size * Jitter());
    const Vec3 wrist = elbow + (along + kVec3UnitZ * 0.05f) * (25.5f * size * Jitter());
    const size_t top = Has("noclavicle") ? chest : Add(AddHelpers(chest, clavicle), clavicle, &arm.clavicle);
    const size_t upper = Add(top, shoulder, &arm.upperArm);
    const size_t hand = AddBone(AddBone(upper, elbow, &arm.forearm), wrist, &arm.hand);
    m_kJoints[upper].swing = -20.0 * s;
    m_kJoints[hand].tip = along * (Has("bare") ? 0.0f : 9.0f);
    if (Has("fingers"))
        AddFingers(hand, along);
    if (Has("handend"))
        Add(hand, wrist + along * 9.0f);
    const Vec3 grip = wrist + along * 7.0f;
    if (Has("sword") && side == EBodySide::Right)
        Add(Add(hand, grip), grip + Vec3{0.0f, 20.0f, 90.0f});
}

void CMadeSkeleton::AddFingers(size_t hand, const Vec3& along)
{
    const Vec3 wrist = m_kJoints[hand].place;
    for (int i = -2; i <= 2; ++i)
    {
        size_t joint = hand;
        for (const float step : {i == -2 ? 4.0f : 9.0f, 13.0f, 15.5f})
            joint = Add(joint, wrist + along * step + Vec3{0.0f, 0.0f, -1.8f * static_cast<float>(i)});
    }
}

// Rotates the frame of every joint so that its first child is along x.
void CMadeSkeleton::TurnFrames()
{
    for (size_t i = 0; i < m_kJoints.size(); ++i)
    {
        Joint& joint = m_kJoints[i];
        const auto child = std::find_if(m_kJoints.begin() + static_cast<ptrdiff_t>(i) + 1, m_kJoints.end(),
                                        [=](const Joint& other) { return other.parent == i; });
        const Vec3 bone = child == m_kJoints.end() ? joint.tip : child->place - joint.place;
        joint.frame = LeastSwing(kVec3UnitX, Turned(bone, m_kAxes));
    }
}

// Poses a frame: legs and arms swing about the stance's x axis, knees only backward.
void CMadeSkeleton::Pose(int frame)
{
    m_kFigure.Move(Root().GetName(), Turned(m_kJoints[0].place, m_kAxes));
    if (Has("rest"))
        return;
    const double walk = Has("walk") ? 1.0 : 0.0;
    const Vec3 axis = Turned(kVec3UnitX, m_kAxes);
    std::vector<Mat3> turns; // from the stance, by joint
    for (const Joint& joint : m_kJoints)
    {
        const Mat3 above = turns.empty() ? kMat3Identity : turns[joint.parent];
        const double degrees = walk * (joint.bend + joint.swing * std::sin(0.5 * frame));
        turns.push_back(TurnAbout(axis, degrees) * above);
        const Mat3 parent = turns.size() == 1 ? kMat3Identity : m_kJoints[joint.parent].frame * above;
        Mat4& matrix = joint.node->m_kMatrix;
        matrix = Mat4Compose(joint.frame * turns.back() * Mat3Transpose(parent), matrix.Translation());
    }
}

} // namespace gw
