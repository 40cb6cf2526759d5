#pragma once

#include "CPoseSampler.h"
#include "MeasureConversion.h"
#include "WorstFrames.h"

#include <array>
#include <optional>
#include <string>
#include <vector>

namespace gw {

/// A skeleton as lines between its joints, in world space.
struct PosedFigure
{
    using Line = std::array<Vec3, 2>;

    std::vector<Line> lines;
    std::vector<Line> badLines; ///< the bones of a fault
    std::optional<Vec3> badJoint;
    Vec3 root = kVec3Zero; ///< where the body's uppermost joint is
};

/// Poses one side of a conversion for pictures of it.
class CFigurePoser
{
public:
    /// `bones` are the names of the mapped ones: what is above all of them is no part of the body and is not
    /// drawn. The clip's tree must outlive the poser.
    CFigurePoser(const MotionClip& clip, const std::vector<std::string>& bones);

    /// The figure at a frame, which may lie between two keys. `bone` is the fault's, by the name that this
    /// side has for it.
    PosedFigure Pose(double frame, EFrameFault fault, const std::string& bone);
    /// From the figure's right hip to its left one over the ground, as posed last; +x where it has none.
    Vec3 Across(const std::string& rightThigh, const std::string& leftThigh) const;

private:
    CNode* m_pkTreeRoot;
    CNode* m_pkRoot; // of the body
    std::vector<CNode*> m_kNodes;
    CPoseSampler m_kSampler;
};

} // namespace gw
