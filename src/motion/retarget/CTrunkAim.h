#pragma once

#include "CPoseMatcher.h"
#include "CTrunkLine.h"

#include <array>
#include <vector>

namespace gw {

/// Makes the target's trunk lean and bend like the source's, regardless of proportions. The line from the
/// midpoint of the hip joints to the neck points in the source's direction, except for the difference between
/// the two rest poses. Bones attached to the trunk keep their world rotations.
class CTrunkAim
{
public:
    /// Plans the trunk. Both trees must be in rest pose. The object does nothing without a root, if the
    /// target has no complete trunk, or if the source has no hip joints or nothing that drives neck or head.
    CTrunkAim(const CRetargeter& retargeter, const CPoseMatcher& matcher, CNode* targetRoot);

    /// Returns the source's joints that are read.
    std::vector<CNode*> Joints() const { return m_bIsPlanned ? m_kLine.Joints() : std::vector<CNode*>(); }
    /// Rotates the trunk's bones in the matcher's current pose to match the source's current pose.
    void Aim(CPoseMatcher& matcher);

private:
    static constexpr size_t kBones = 3; // LowerTorso, Waist, UpperTorso

    bool FindBones(const CPoseMatcher& matcher, CNode* targetRoot);
    void PlanShares(const CNode& neck, const CNode& top);
    void PlanRest();
    void PlanHanging(const CPoseMatcher& matcher);
    Vec3 RestHips() const;
    Vec3 Chord() const;
    Mat3 RestTurn(const Vec3& chord) const;
    Vec3 Pelvis(const CPoseMatcher& matcher) const;
    std::array<Vec3, kBones> Directions(const Vec3& pelvis) const;
    void TurnTrunk(CPoseMatcher& matcher, const std::array<Vec3, kBones>& directions);

    bool m_bIsPlanned = false;
    CTrunkLine m_kLine;
    std::array<CNode*, kBones + 1> m_apkJoints{}; // the target's, from LowerTorso up to the neck
    std::array<size_t, kBones + 1> m_auiBones{};  // of these joints
    std::array<double, kBones + 1> m_afShares{};  // of the joints, as fractions of the line
    std::array<CNode*, 2> m_apkThighs{};          // the target's
    std::array<size_t, 2> m_auiThighs{};
    Mat3 m_kRestSwing = kMat3Identity; // from the source's line at rest to the target's, in trunk axes
    std::vector<size_t> m_kRiders;     // unposed bones attached to the trunk; parents first
    std::vector<size_t> m_kHanging;    // posed bones attached to the trunk or to riders
    std::vector<Mat3> m_kKept;         // world rotations of the bones in m_kHanging
    std::vector<Mat3> m_kWorlds;       // world rotations of trunk and riders after aiming, by bone
};

} // namespace gw
