#pragma once

#include "CPoseSampler.h"
#include "FigureSides.h"
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
    struct Line
    {
        std::array<Vec3, 2> ends;
        EFigureSide side = EFigureSide::Middle;
    };

    std::vector<Line> lines;
    std::vector<Line> badLines; ///< bones involved in a fault
    std::optional<Vec3> badJoint;
    Vec3 root = kVec3Zero; ///< position of the body's topmost joint
};

/// A line of a figure as indices of its ends; see CFigurePoser::Points.
struct FigureBone
{
    size_t from = 0;
    size_t to = 0;
    EFigureSide side = EFigureSide::Middle;
};

/// Poses one side of a conversion for drawings.
class CFigurePoser
{
public:
    /// `name` selects the names of the mapped bones in this clip. Nodes above all of them are not part of the
    /// body and are not drawn. The clip's tree must outlive the poser.
    CFigurePoser(const MotionClip& clip, const std::vector<BoneMeasures>& bones,
                 std::string BoneMeasures::*name);

    /// Returns the figure at a frame, which may be between two keys. `bone` is the name of the faulty bone on
    /// this side.
    PosedFigure Pose(double frame, EFrameFault fault, const std::string& bone);
    /// Returns the lines of the figure. Point 0 is the body's topmost joint.
    const std::vector<FigureBone>& Bones() const { return m_kBones; }
    /// Returns the points of the figure at a frame, in world space, always in the same order. Numbers can be
    /// infinite or NaN.
    std::vector<Vec3> Points(double frame);
    /// Returns the horizontal direction from the right hip to the left hip in the last pose; +x without hips.
    Vec3 Across(const std::string& rightThigh, const std::string& leftThigh) const;

private:
    std::vector<Vec3> CurrentPoints() const;

    CNode* m_pkTreeRoot;
    CNode* m_pkRoot; // root of the body
    std::vector<CNode*> m_kNodes;
    std::vector<FigureBone> m_kBones;
    std::vector<const CNode*> m_kTips; // nodes with a free end, whose points follow those of the joints
    CPoseSampler m_kSampler;
};

} // namespace gw
