#include "AimBones.h"

#include "AlignMotion.h"
#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "CPoseSampler.h"
#include "CRetargeter.h"
#include "HostBones.h"
#include "Skeleton.h"

#include <unordered_map>

namespace gw {

namespace {

class CBoneAimer
{
public:
    CBoneAimer(CRetargeter& table, CNode& targetRoot, const BodyMotion& source, const Alignment& alignment,
               const AlignedMotion& aligned);
    void Aim();

private:
    struct Row
    {
        CNode* target;
        CNode* source; ///< joint of the original motion; null if there is none
        bool fixed;
        Mat3 turn = kMat3Identity; ///< rotation at rest, relative to the source's rotation
    };

    Row* RowOf(const char* target);
    bool LiesInTrunk(const CNode* source) const;
    void TakeSpine();
    void TakeCollars();
    void TakePelvis();
    void SetRow(const Row& row);

    CRetargeter& table_;
    CNode& targetRoot_;
    const BodyMotion& source_;
    const AlignedMotion& aligned_;
    std::vector<Row> m_kRows;
    std::unordered_map<const CNode*, size_t> m_kIndex;
    const Alignment& alignment_;
};

CBoneAimer::CBoneAimer(CRetargeter& table, CNode& targetRoot, const BodyMotion& source,
                       const Alignment& alignment, const AlignedMotion& aligned)
    : table_(table), targetRoot_(targetRoot), source_(source), aligned_(aligned), alignment_(alignment)
{
    for (CNode* target : NodesOf(targetRoot))
    {
        bool fixed = false;
        table.IsFixed(target, fixed);
        m_kRows.push_back({target, table.SourceOf(target), fixed, kMat3Identity});
    }
    for (const JointAlignment& joint : alignment.joints)
        m_kIndex.emplace(joint.node, m_kIndex.size());
}

CBoneAimer::Row* CBoneAimer::RowOf(const char* target)
{
    const CNode* const node = FindNode(&targetRoot_, target);
    for (Row& row : m_kRows)
    {
        if (row.target == node)
            return &row;
    }
    return nullptr;
}

bool CBoneAimer::LiesInTrunk(const CNode* source) const
{
    const auto found = m_kIndex.find(source);
    return found != m_kIndex.end() && alignment_.joints[found->second].axis == kVec3UnitY;
}

// Drives torso and waist by the spine if the torso's source is outside the trunk. The rotation of a collar,
// for example, shows less about the torso than the spine's own rotation.
void CBoneAimer::TakeSpine()
{
    const std::vector<CNode*>& spine = source_.body.spine;
    Row* const torso = RowOf(kTorsoBone);
    Row* const waist = RowOf(kWaistBone);
    if (!torso || !waist || !torso->source || LiesInTrunk(torso->source) || spine.empty())
        return;
    torso->source = spine.back();
    waist->fixed = false;
    waist->source = spine.size() > 1 ? spine[(spine.size() - 1) / 2] : nullptr;
}

// Makes collars without a source follow the torso. Otherwise, a collar would share the rotation of the upper
// arm, whose frame is at an angle to its own.
void CBoneAimer::TakeCollars()
{
    const Row* const torso = RowOf(kTorsoBone);
    for (const HostSide& side : kHostSides)
    {
        Row* const collar = RowOf(side.collar);
        if (collar && torso && !collar->source && !collar->fixed)
            collar->source = torso->source;
    }
}

// Makes hip bones without a source follow the pelvis, to which the legs are attached. Its direction can
// differ from that of the bone between hip and spine.
void CBoneAimer::TakePelvis()
{
    for (const HostSide& side : kHostSides)
    {
        Row* const bone = RowOf(side.pelvis);
        if (!bone || bone->source)
            continue;
        bone->fixed = false;
        bone->source = source_.body.hip;
        bone->turn = alignment_.pelvisTurn;
    }
}

void CBoneAimer::SetRow(const Row& row)
{
    if (row.fixed)
        table_.SetFixed(row.target, true);
    const auto found = m_kIndex.find(row.source);
    if (found == m_kIndex.end())
        return;
    CNode* const source = aligned_.joints[found->second];
    const CBoneMesh* const mesh = FindBoneMesh(*source);
    const Mat3 frame = mesh ? NormalizedRows(mesh->m_kMatrix) : kMat3Identity;
    table_.SetSourceOf(row.target, source);
    table_.SetOffsetMatrix(row.target,
                           NormalizedRows(RestWorld(*row.target)) * row.turn * Mat3Transpose(frame));
}

void CBoneAimer::Aim()
{
    TakeSpine();
    TakeCollars();
    TakePelvis();
    table_.SetScenes(aligned_.root.Get(), &targetRoot_);
    table_.SetPlainTurns(true); // a T-pose consists of exact quarter turns
    for (const Row& row : m_kRows)
        SetRow(row);
}

} // namespace

void DriveHands(CRetargeter& table, CNode& targetRoot, const CBodyMap& body)
{
    for (const EBodySide side : kBodySides)
    {
        CNode* const hand = FindNode(&targetRoot, kHostSides[static_cast<size_t>(side)].hand);
        bool fixed = false;
        table.IsFixed(hand, fixed);
        if (hand && !fixed && !table.SourceOf(hand) && body.Arm(side).hand)
            table.SetSourceOf(hand, body.Arm(side).hand);
    }
}

void AimBones(CRetargeter& table, CNode& targetRoot, const BodyMotion& source, const Alignment& alignment,
              const AlignedMotion& aligned)
{
    CBoneAimer(table, targetRoot, source, alignment, aligned).Aim();
}

} // namespace gw
