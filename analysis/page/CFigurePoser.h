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
    std::vector<Line> badLines; ///< bones involved in a fault
    std::optional<Vec3> badJoint;
    Vec3 root = kVec3Zero; ///< position of the body's topmost joint
};

/// Poses one side of a conversion for drawings.
class CFigurePoser
{
public:
    /// `bones` are the names of the mapped bones. Nodes above all of them are not part of the body and are
    /// not drawn. The clip's tree must outlive the poser.
    CFigurePoser(const MotionClip& clip, const std::vector<std::string>& bones);

    /// Returns the figure at a frame, which may be between two keys. `bone` is the name of the faulty bone on
    /// this side.
    PosedFigure Pose(double frame, EFrameFault fault, const std::string& bone);
    /// Returns the horizontal direction from the right hip to the left hip in the last pose; +x without hips.
    Vec3 Across(const std::string& rightThigh, const std::string& leftThigh) const;

private:
    CNode* m_pkTreeRoot;
    CNode* m_pkRoot; // root of the body
    std::vector<CNode*> m_kNodes;
    CPoseSampler m_kSampler;
};

} // namespace gw
