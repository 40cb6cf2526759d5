#pragma once

#include "CPoseMatcher.h"
#include "CTrunkLine.h"

#include <array>
#include <vector>

namespace gw {

/// Makes the target's trunk lean and bend like the source's line from the middle of its hip joints to its
/// neck, regardless of proportions: the line from hips to neck points in the source's direction, apart from
/// the difference that the two rest poses have. Bones attached to the trunk keep their world rotations.
class CTrunkAim
{
public:
    /// Does nothing without a root, where the target lacks a bone of the trunk, or the source a hip joint or
    /// what drives neck and head. Both trees stand in rest pose.
    CTrunkAim(const CRetargeter& retargeter, const CPoseMatcher& matcher, CNode* targetRoot);

    /// The source's joints that are looked at.
    std::vector<CNode*> Joints() const { return m_bIsPlanned ? m_kLine.Joints() : std::vector<CNode*>(); }
    /// Turns the trunk's bones in the matcher's present pose, by that of the source.
    void Aim(CPoseMatcher& matcher);

private:
    static constexpr size_t kBones = 3; // LowerTorso, Waist, UpperTorso

    bool FindBones(const CPoseMatcher& matcher, CNode* targetRoot);
    void PlanShares(const CNode& neck, const CNode& top);
    void PlanRest();
    void PlanHanging(const CPoseMatcher& matcher);
    Vec3 RestHips() const;
    Vec3 Chord() const;
    Mat3 RestTurn() const;
    Vec3 Pelvis(const CPoseMatcher& matcher) const;
    std::array<Vec3, kBones> Directions(const Vec3& pelvis) const;
    void TurnTrunk(CPoseMatcher& matcher, const std::array<Vec3, kBones>& directions);

    bool m_bIsPlanned = false;
    CTrunkLine m_kLine;
    std::array<CNode*, kBones + 1> m_apkJoints{}; // of the target, from LowerTorso up to the neck
    std::array<size_t, kBones> m_auiBones{};
    std::array<double, kBones + 1> m_afShares{}; // of the joints on the line
    std::array<CNode*, 2> m_apkThighs{};         // of the target
    Mat3 m_kRestSwing = kMat3Identity; // from the source's line at rest to the target's, in trunk axes
    std::vector<size_t> m_kRiders;     // unposed bones that hang on the trunk; parents first
    std::vector<size_t> m_kHanging;    // posed bones that hang on the trunk or on those
    std::vector<Mat3> m_kKept;         // the world rotations of these, by m_kHanging
    std::vector<Mat3> m_kWorlds;       // by bone; of trunk and riders, in the pose that is aimed
};

} // namespace gw
