// A trunk's bones can all point exactly like the source's, and the trunk can still lean differently: its
// joints are at other fractions of its length, so a bend at the source's hips may end up in the target's
// waist. What a viewer sees is the line from hips to neck. So the source's line is measured by arc length,
// the target's joints are looked up on it at their own fractions, and each bone is aimed from one such point
// to the next. If the two lines differ in the rest poses, the target keeps that difference: it stands upright
// when its source does.
//
// A bent line is shorter between two points than its arc, and the target's pelvis keeps its own rotation. So
// all bones are rotated together by the smallest angle that brings the neck back to the wanted direction:
// with p the vector from hips to LowerTorso, q the vector from there to the neck, and c the wanted direction,
// q must become
//
//     l c - p,    l = c . p + sqrt((c . p)^2 - |p|^2 + |q|^2)
//
// which has the length of q and makes p + q a multiple of c.

#include "CTrunkAim.h"

#include "CPoseSampler.h"
#include "CRetargeter.h"
#include "Directions.h"
#include "HostBones.h"
#include "PointBone.h"
#include "Skeleton.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// A larger difference between the lines at rest does not come from proportions: one of the rest poses is not
// a standing pose.
constexpr double kMostRestDegrees = 30.0;

constexpr const char* kTrunkJoints[] = {kRootBone, kWaistBone, kTorsoBone, kNeckBone};

double RestDistance(const CNode& a, const CNode& b)
{
    return Vec3Length(RestWorld(b).Translation() - RestWorld(a).Translation());
}

} // namespace

CTrunkAim::CTrunkAim(const CRetargeter& retargeter, const CPoseMatcher& matcher, CNode* targetRoot)
{
    if (!targetRoot || !FindBones(matcher, targetRoot))
        return;
    CNode* const neck = m_apkJoints[kBones];
    CNode* const top = retargeter.SourceOf(neck) ? neck : FindNode(targetRoot, kHeadBone);
    m_kLine = CTrunkLine({retargeter.SourceOf(m_apkThighs[0]), retargeter.SourceOf(m_apkThighs[1])},
                         retargeter.SourceOf(targetRoot), retargeter.SourceOf(top));
    if (!m_kLine.IsWhole())
        return;
    PlanShares(*neck, *top);
    PlanRest();
    PlanHanging(matcher);
    m_bIsPlanned = true;
}

// Finds the target's trunk and thighs. Returns false if a bone is missing or if a joint of the trunk is not
// the parent of the next.
bool CTrunkAim::FindBones(const CPoseMatcher& matcher, CNode* targetRoot)
{
    for (size_t i = 0; i <= kBones; ++i)
    {
        m_apkJoints[i] = FindNode(targetRoot, kTrunkJoints[i]);
        if (!m_apkJoints[i] || (i > 0 && m_apkJoints[i]->GetParentNode() != m_apkJoints[i - 1]))
            return false;
        m_auiBones[i] = static_cast<size_t>(matcher.IndexOf(m_apkJoints[i]));
    }
    for (size_t side = 0; side < kHostSides.size(); ++side)
    {
        m_apkThighs[side] = FindNode(targetRoot, kHostSides[side].thigh);
        m_auiThighs[side] = static_cast<size_t>(matcher.IndexOf(m_apkThighs[side]));
    }
    return m_apkThighs[0] && m_apkThighs[1];
}

Vec3 CTrunkAim::RestHips() const
{
    return (RestWorld(*m_apkThighs[0]).Translation() + RestWorld(*m_apkThighs[1]).Translation()) * 0.5f;
}

void CTrunkAim::PlanShares(const CNode& neck, const CNode& top)
{
    m_afShares[0] = Vec3Length(RestWorld(*m_apkJoints[0]).Translation() - RestHips());
    for (size_t i = 1; i <= kBones; ++i)
        m_afShares[i] = m_afShares[i - 1] + RestDistance(*m_apkJoints[i - 1], *m_apkJoints[i]);
    const double whole = m_afShares[kBones] + RestDistance(neck, top);
    for (double& share : m_afShares)
        share /= whole;
}

// Returns the source's direction from its hips to the point of the line that matches the target's neck.
Vec3 CTrunkAim::Chord() const
{
    return Vec3Normalized(m_kLine.At(m_afShares[kBones]) - m_kLine.At(0.0));
}

// If the lines differ at rest, for example because one neck is farther back, the target keeps that
// difference. So it stands upright when its source does.
void CTrunkAim::PlanRest()
{
    if (!m_kLine.Read())
        return;
    const Mat3 upright = TurnUpright(Chord(), Vec3Normalized(m_kLine.Across()));
    const Vec3 target = RestWorld(*m_apkJoints[kBones]).Translation() - RestHips();
    const Vec3 chord = Vec3Normalized(Turned(target, upright));
    if (AngleBetween(chord, kVec3UnitY) <= kMostRestDegrees)
        m_kRestSwing = LeastSwing(kVec3UnitY, chord);
}

// Returns the same difference for the current pose: it rotates with the source's trunk.
Mat3 CTrunkAim::RestTurn(const Vec3& chord) const
{
    const Mat3 upright = TurnUpright(chord, Vec3Normalized(m_kLine.Across()));
    return upright * m_kRestSwing * Mat3Transpose(upright);
}

void CTrunkAim::PlanHanging(const CPoseMatcher& matcher)
{
    const auto& bones = matcher.Bones();
    std::vector<bool> moves(bones.size(), false);
    for (size_t bone = 0; bone < bones.size(); ++bone)
    {
        const auto neck = m_auiBones.begin() + kBones;
        const bool isTrunk = std::find(m_auiBones.begin(), neck, bone) != neck;
        const bool hangs = bones[bone].parent >= 0 && moves[static_cast<size_t>(bones[bone].parent)];
        moves[bone] = isTrunk || (hangs && !bones[bone].posed);
        if (hangs && !isTrunk)
            (bones[bone].posed ? m_kHanging : m_kRiders).push_back(bone);
    }
    m_kKept.resize(m_kHanging.size());
    m_kWorlds.resize(bones.size());
}

// Returns the vector from the midpoint of the target's hip joints to its root. Zero if the hip joints rotate
// with the root instead of with posed bones of their own.
Vec3 CTrunkAim::Pelvis(const CPoseMatcher& matcher) const
{
    Vec3 hips = kVec3Zero;
    for (const size_t bone : m_auiThighs)
    {
        const auto& bones = matcher.Bones();
        const int pelvis = bones[bone].parent;
        if (pelvis < 0 || !bones[static_cast<size_t>(pelvis)].posed ||
            pelvis == static_cast<int>(m_auiBones[0]))
            return kVec3Zero;
        hips =
            hips +
            Turned(bones[bone].translation, NormalizedRows(bones[static_cast<size_t>(pelvis)].world)) * 0.5f;
    }
    return -hips;
}

// Returns the unit directions in which the bones must point.
std::array<Vec3, CTrunkAim::kBones> CTrunkAim::Directions(const Vec3& pelvis) const
{
    const bool rides = pelvis == kVec3Zero;
    const Vec3 sourceChord = Chord();
    const Mat3 rest = RestTurn(sourceChord);
    const Vec3 chord = Turned(sourceChord, rest);
    std::array<Vec3, kBones> directions;
    Vec3 way = kVec3Zero;
    for (size_t i = 0; i < kBones; ++i)
    {
        const double from = rides && i == 0 ? 0.0 : m_afShares[i];
        directions[i] = Turned(Vec3Normalized(m_kLine.At(m_afShares[i + 1]) - m_kLine.At(from)), rest);
        way = way + directions[i] * static_cast<float>(m_afShares[i + 1] - from);
    }
    const Vec3 below = Vec3Normalized(pelvis) * static_cast<float>(rides ? 0.0 : m_afShares[0]);
    const double along = Vec3Dot(chord, below);
    const double square = along * along - Vec3Dot(below, below) + Vec3Dot(way, way);
    if (!(square > 0.0))
        return directions;
    const Mat3 swing = LeastSwing(way, chord * static_cast<float>(along + std::sqrt(square)) - below);
    for (Vec3& direction : directions)
        direction = Turned(direction, swing);
    return directions;
}

void CTrunkAim::TurnTrunk(CPoseMatcher& matcher, const std::array<Vec3, kBones>& directions)
{
    auto& bones = matcher.Bones();
    Mat3 above = kMat3Identity;
    for (size_t i = 0; i < kBones; ++i)
    {
        CPoseMatcher::Bone& bone = bones[m_auiBones[i]];
        m_kWorlds[m_auiBones[i]] =
            PointedTo(directions[i], NormalizedRows(bone.world), bones[m_auiBones[i + 1]].translation);
        bone.rotation = m_kWorlds[m_auiBones[i]] * Mat3Transpose(above);
        above = m_kWorlds[m_auiBones[i]];
    }
}

void CTrunkAim::Aim(CPoseMatcher& matcher)
{
    if (!m_bIsPlanned || !m_kLine.Read())
        return;
    auto& bones = matcher.Bones();
    for (size_t i = 0; i < m_kHanging.size(); ++i)
        m_kKept[i] = NormalizedRows(bones[m_kHanging[i]].world);
    TurnTrunk(matcher, Directions(Pelvis(matcher)));
    for (const size_t rider : m_kRiders)
        m_kWorlds[rider] = bones[rider].rotation * m_kWorlds[static_cast<size_t>(bones[rider].parent)];
    for (size_t i = 0; i < m_kHanging.size(); ++i)
    {
        CPoseMatcher::Bone& bone = bones[m_kHanging[i]];
        bone.rotation = m_kKept[i] * Mat3Transpose(m_kWorlds[static_cast<size_t>(bone.parent)]);
    }
}

} // namespace gw
