#pragma once

#include "CSourcePoses.h"
#include "CTargetBones.h"
#include "HostRows.h"
#include "ProfileFile.h"

#include <array>
#include <cstddef>
#include <iterator>
#include <optional>

namespace gw {

inline constexpr size_t kHostRowCount = std::size(kHostRows);
/// The source joints of the host rows, by index in the source's tree; CJointTree::kNone without one.
using RowJoints = std::array<int, kHostRowCount>;

/// Computes offsets and axis codes for the rows of a profile.
class CRowTurner
{
public:
    /// The tree, poses and target must outlive this object. The body in the tree must be complete.
    CRowTurner(const CJointTree& tree, const CSourcePoses& poses, const CTargetBones& target,
               const RowJoints& joints);

    const RowNumbers& Numbers(size_t row) const { return m_kNumbers[row]; }
    /// Returns whether a row's twist is a degree or two off the best one, to keep a bone below it away from a
    /// pole that a conversion could not handle.
    bool IsNudged(size_t row) const { return m_kNudged[row]; }
    /// Returns the angle in degrees between both bones' directions in the source's rest pose; nothing for a
    /// bone that does not lead to a joint.
    std::optional<double> RestError(size_t row) const;

private:
    void Turn(size_t row);
    void KeepOffPoles(size_t row);
    bool IsNearPole(size_t row, const RowNumbers& numbers) const;
    bool IsAtPole(size_t row, const RowNumbers& numbers) const;
    bool IsAtPole(size_t row, const RowNumbers& numbers, size_t child) const;
    int AimOf(size_t row) const;
    Vec3 Axis(size_t row) const;
    Vec3 RestAim(size_t row, int aim) const;
    std::optional<Vec3> ReferenceDirection(size_t row, int aim) const;

    const CJointTree& tree_;
    const CSourcePoses& poses_;
    const CTargetBones& target_;
    const RowJoints& joints_;
    size_t m_uiReference;
    Mat3 m_kFacing;
    std::array<RowNumbers, kHostRowCount> m_kNumbers{};
    std::array<bool, kHostRowCount> m_kNudged{};
};

} // namespace gw
