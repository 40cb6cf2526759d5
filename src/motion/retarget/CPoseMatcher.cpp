// Posing the target skeleton like the source skeleton, for one frame.
//
// The problem: the two skeletons have different bones. Each mapped target bone must end up with the world
// rotation of its source bone. Between two mapped bones there can be unmapped ones, for example two extra
// spine bones. If they stayed still, the whole bend would happen in a single joint and the body would look
// broken, so they take shares of the rotation.
//
// The idea: split the target into chains. A chain ends at a mapped bone and begins below the nearest mapped
// ancestor, or below a bone that is marked as fixed. It is posed from the top down. Each bone computes the
// rotation that is still missing, relative to its parent's current world matrix, and takes its part of it
// (SharedRotation). The last bone takes everything that is left, so it reaches the source's rotation. The
// user's offsets are applied on top.
//
// What the shares mean: the missing rotation is decomposed as Ra · Rb · Rc about three axes, selected by the
// bone's type. A link has two shares, which are running totals of the bones' weights and reach 1 at the end
// of the chain. `curve` scales the first rotation Ra; it follows a quarter of a sine wave, so the upper bones
// take more of it. `fraction` is the position of the slerp from the scaled Ra to the whole rotation. Bones
// without an entry in the share file have the weight log(1 + length), so long bones take more.
//
// Why it ends: chains are planned once, by walking up parent links, which end at the root. A pose is one loop
// over the chains and their links, without recursion, search or allocation. If two chains share a bone, the
// later one poses it again.
//
// Three peculiarities decide the bits of the result and must stay: scaled quaternions are not normalized, so
// a bone with a partial share can have a sheared world matrix; a bone with the whole share still goes through
// the decomposition if that does not reproduce the rotation (at exact quarter turns, see SafeAsin) or if its
// rows are not perpendicular; and the sine curve ends at 1.570795 rather than at pi / 2. SetPlainTurns turns
// off the second one for quarter turns.
//
// A chain without a mapped ancestor is free: its translations follow the source too, each bone at the tip of
// its parent's mesh. In all other chains, bones keep their own translation.

#include "CPoseMatcher.h"

#include "Angles.h"
#include "BoneMeshQueries.h"
#include "Euler.h"
#include "Skeleton.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// End of the quarter sine wave for the shares: exactly this decimal number, not pi / 2.
constexpr float kCurveEnd = 1.570795f;
// Tolerance for the rounding of summed shares.
constexpr float kWhole = 1e-6f;

// M = Ra · Rb · Rc: the Euler order that yields the angles, the axes of the three rotations, and the matrix
// element that is the sine of the middle angle.
struct Decomposition
{
    EEulerOrder order;
    int first;
    int middle;
    int last;
    int sineElement;
};
constexpr Decomposition kDecompositions[] = {
    {EEulerOrder::YZX, 0, 2, 1, 1},
    {EEulerOrder::XZY, 1, 2, 0, 3},
    {EEulerOrder::XYZ, 2, 1, 0, 6},
};

const Decomposition& DecompositionOf(int type)
{
    return kDecompositions[type == 0 || type == 1 ? type : 2];
}

Mat3 AboutAxis(int axis, float angle)
{
    const Vec3 axes[] = {kVec3UnitX, kVec3UnitY, kVec3UnitZ};
    return Mat3FromAxisAngle(axes[axis], angle);
}

// Returns a bone's part of a rotation: the first rotation of the decomposition scaled by `curve`, then
// `fraction` of the way from there to the whole rotation. Scaled quaternions are not normalized.
Mat3 SharedRotation(const Mat3& m, int type, float fraction, float curve)
{
    const Decomposition& parts = DecompositionOf(type);
    float angles[3] = {};
    Mat3ToEuler(m, static_cast<int>(parts.order), angles[0], angles[1], angles[2]);
    Quat first;
    QuatScale(QuatFromMat3(AboutAxis(parts.first, angles[parts.first])), curve, first);
    const Mat3 turned = QuatToMat3(first) * AboutAxis(parts.middle, angles[parts.middle]) *
                        AboutAxis(parts.last, angles[parts.last]);
    return QuatToMat3(QuatSlerp(fraction, first, QuatFromMat3(turned)));
}

// Whether the decomposition reproduces the rotation. It does not where SafeAsin's ends are swapped.
bool IsFaithful(const Mat3& m, int type)
{
    return std::fabs(m.m[DecompositionOf(type).sineElement]) < 1.0f;
}

// Whether the unit rows of a matrix are perpendicular. Below a bone with a partial share they may not be,
// because scaled quaternions shear its world matrix.
bool IsOrthogonal(const Mat3& m)
{
    constexpr float kPerpendicular = 1e-6f;
    const auto dot = [&m](int a, int b) {
        return m.m[a] * m.m[b] + m.m[a + 1] * m.m[b + 1] + m.m[a + 2] * m.m[b + 2];
    };
    return std::fabs(dot(0, 3)) < kPerpendicular && std::fabs(dot(0, 6)) < kPerpendicular &&
           std::fabs(dot(3, 6)) < kPerpendicular;
}

Mat3 RotationPart(const Mat4& m)
{
    return {
        {m.m[0], m.m[1], m.m[2], m.m[4], m.m[5], m.m[6], m.m[8], m.m[9], m.m[10]}
    };
}

struct Weights
{
    float share1;
    float share2;
    int type;
};

Weights WeightsOf(const CRetargeter& retargeter, const CNode& node)
{
    const BoneShares* shares = nullptr;
    if (retargeter.Shares(&node, shares))
        return {shares->m_fShare1, shares->m_fShare2,
                static_cast<int>(std::clamp(shares->m_fType, -1.0f, 1e6f))};
    const float weight = std::log(1.0f + NodeBoneLength(node));
    return {weight, weight, 1};
}

} // namespace

Mat3 OffsetRotation(const Vec3& degrees, const Mat3& matrix)
{
    if (degrees == kVec3Zero)
        return matrix;
    return matrix * AboutAxis(0, degrees.x * kDegreesToRadians) *
           AboutAxis(1, degrees.y * kDegreesToRadians) * AboutAxis(2, degrees.z * kDegreesToRadians);
}

void SetLocalMatrixKeepChildren(CNode& node, const Mat4& local)
{
    const Mat4 change = node.m_kMatrix * Mat4InverseOrIdentity(local);
    for (size_t i = 0; i < node.GetChildCount(); ++i)
    {
        if (CSpatial* const child = node.ChildAt(i))
            child->m_kMatrix = child->m_kMatrix * change;
    }
    node.m_kMatrix = local;
}

CPoseMatcher::CPoseMatcher(const CRetargeter& retargeter, CNode& targetRoot)
    : m_bPlainTurns(retargeter.HasPlainTurns())
{
    for (CNode* node : NodesOf(targetRoot))
        m_kBones.push_back({node, IndexOf(node->GetParentNode()), NormalizedRows(node->m_kMatrix),
                            node->m_kMatrix.Translation(), RowLengths(node->m_kMatrix), false,
                            node->m_kWorldMatrix});
    std::vector<bool> visited(m_kBones.size(), false);
    for (size_t bone = 0; bone < m_kBones.size(); ++bone)
    {
        CNode* source = retargeter.SourceOf(m_kBones[bone].node);
        if (!source)
            continue;
        m_kSources.push_back(source);
        PlanChain(retargeter, bone, *source, visited);
    }
}

int CPoseMatcher::IndexOf(const CNode* node) const
{
    const auto bone = std::ranges::find(m_kBones, node, &Bone::node);
    return bone == m_kBones.end() || !node ? -1 : static_cast<int>(bone - m_kBones.begin());
}

void CPoseMatcher::PlanChain(const CRetargeter& retargeter, size_t bone, CNode& source,
                             std::vector<bool>& visited)
{
    int stop = m_kBones[bone].parent;
    while (stop >= 0 && !retargeter.SourceOf(m_kBones[static_cast<size_t>(stop)].node))
        stop = m_kBones[static_cast<size_t>(stop)].parent;

    Chain chain{&NodeBoneWorld(source), stop < 0, {}, {}};
    bool fixed = false;
    int above = static_cast<int>(bone);
    for (; above != stop && !fixed; above = m_kBones[static_cast<size_t>(above)].parent)
    {
        chain.links.push_back(PlanLink(retargeter, static_cast<size_t>(above)));
        const int parent = m_kBones[static_cast<size_t>(above)].parent;
        if (parent >= 0)
            retargeter.IsFixed(m_kBones[static_cast<size_t>(parent)].node, fixed);
    }
    std::ranges::reverse(chain.links);

    float total1 = 0.0f;
    float total2 = 0.0f;
    for (auto link = chain.links.rbegin(); link != chain.links.rend(); ++link)
    {
        total1 += link->fraction;
        total2 += link->curve;
    }
    float done1 = total1 == 0.0f ? 1.0f : 0.0f;
    float done2 = total2 == 0.0f ? 1.0f : 0.0f;
    total1 += done1;
    total2 += done2;
    for (Link& link : chain.links)
    {
        done1 += link.fraction;
        done2 += link.curve;
        link.fraction = done1 / total1;
        link.curve = std::sin(done2 / total2 * kCurveEnd);
        link.whole = std::fabs(link.fraction - 1.0f) < kWhole && std::fabs(link.curve - 1.0f) < kWhole;
        visited[link.bone] = m_kBones[link.bone].posed = true;
    }
    for (; above >= 0 && !visited[static_cast<size_t>(above)];
         above = m_kBones[static_cast<size_t>(above)].parent)
    {
        chain.stale.push_back(static_cast<size_t>(above));
        visited[static_cast<size_t>(above)] = true;
    }
    std::ranges::reverse(chain.stale);
    m_kChains.push_back(std::move(chain));
}

CPoseMatcher::Link CPoseMatcher::PlanLink(const CRetargeter& retargeter, size_t index) const
{
    const Bone& bone = m_kBones[index];
    const Weights weights = WeightsOf(retargeter, *bone.node);
    const Mat3 offset =
        OffsetRotation(retargeter.OffsetAngles(bone.node), retargeter.OffsetMatrix(bone.node));
    const Vec3 tip =
        bone.parent < 0 ? kVec3Zero : NodeBoneAxis(*m_kBones[static_cast<size_t>(bone.parent)].node);
    return {index, weights.share1, weights.share2, weights.type, false, offset != kMat3Identity, offset, tip};
}

void CPoseMatcher::MatchPose()
{
    for (const Chain& chain : m_kChains)
    {
        for (const size_t index : chain.stale)
            UpdateWorld(index);
        SpreadRotation(chain, NormalizedRows(*chain.sourceWorld), chain.sourceWorld->Translation(),
                       RowLengths(*chain.sourceWorld));
    }
}

// Distributes a source bone's world rotation over the bones of a chain, top down, using the shares summed up
// at planning. `position` is passed by value: in a free chain, each link changes it for the links below.
void CPoseMatcher::SpreadRotation(const Chain& chain, const Mat3& rotation, Vec3 position, const Vec3& scale)
{
    for (const Link& link : chain.links)
        PoseLink(chain, link, rotation, scale, position);
}

void CPoseMatcher::PoseLink(const Chain& chain, const Link& link, const Mat3& rotation, const Vec3& scale,
                            Vec3& position)
{
    Bone& bone = m_kBones[link.bone];
    Mat4 local = Mat4Compose(rotation, kVec3Zero, scale);
    if (bone.parent >= 0)
    {
        const Mat4& parentWorld = m_kBones[static_cast<size_t>(bone.parent)].world;
        if (chain.free)
        {
            position = TransformCoord(link.parentTip, parentWorld) *
                       static_cast<float>(Vec3Length(bone.translation));
            local.SetTranslation(position);
            local = local * Mat4InverseOrIdentity(parentWorld);
        }
        else
            local = Mat4Compose(RotationPart(local) * Mat3InverseOrIdentity(RotationPart(parentWorld)),
                                kVec3Zero);
    }
    else
        local.SetTranslation(position);
    if (chain.free)
        bone.translation = local.Translation();

    Mat3 m = NormalizedRows(local);
    const bool keepsRotation = link.whole && (m_bPlainTurns || IsFaithful(m, link.type)) && IsOrthogonal(m);
    if (!keepsRotation)
        m = SharedRotation(m, link.type, link.fraction, link.curve);
    if (link.turned)
        m = link.offset * m;

    // The world matrix used by the bones below keeps the source's scale; the local pose keeps the rest pose's
    // scale.
    const Mat4 stretched = Mat4Compose(m, bone.translation, RowLengths(local));
    bone.world = bone.parent < 0 ? stretched : stretched * m_kBones[static_cast<size_t>(bone.parent)].world;
    bone.rotation = NormalizedRows(Mat4Compose(m, kVec3Zero));
}

Mat4 CPoseMatcher::LocalMatrix(size_t index) const
{
    const Bone& bone = m_kBones[index];
    return Mat4Compose(bone.rotation, bone.translation, bone.scale);
}

void CPoseMatcher::UpdateWorld(size_t index)
{
    Bone& bone = m_kBones[index];
    const Mat4 local = LocalMatrix(index);
    bone.world = bone.parent < 0 ? local : local * m_kBones[static_cast<size_t>(bone.parent)].world;
}

void CPoseMatcher::WriteNodes() const
{
    for (size_t index = 0; index < m_kBones.size(); ++index)
        m_kBones[index].node->m_kMatrix = LocalMatrix(index);
}

void CPoseMatcher::ReadTranslation(size_t index)
{
    m_kBones[index].translation = m_kBones[index].node->m_kMatrix.Translation();
}

} // namespace gw
