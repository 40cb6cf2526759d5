#pragma once

#include "ArmTurn.h"
#include "CArmFit.h"
#include "Vec3.h"

#include <array>
#include <cstddef>
#include <vector>

namespace gw {

/// The hands of a body and the points that hands touch; pairs are indexed by side. Positions are in
/// millimeters of the target, above its floor, for the source as well.
struct TouchPoints
{
    std::array<Vec3, 2> hands{};
    std::array<Vec3, 2> hips{};
    std::array<Vec3, 2> knees{};
    Vec3 neck = kVec3Zero;
    Vec3 head = kVec3Zero; ///< the joint at its base
};

/// The pose of the target.
struct ArmPoints : TouchPoints
{
    std::array<Vec3, 2> collars{};
    std::array<Vec3, 2> shoulders{};
    Vec3 chestUp = kVec3UnitY; ///< axis of the chest
};

/// Plans how to move each arm so that its hand keeps the source's distance to thighs, trunk, head, the other
/// hand and the floor, whenever the source's hand touches or nearly touches one of them.
class CHandPlan
{
public:
    /// `arms` are the lengths of the target's arms. Without a floor, the height of the hands is not limited.
    CHandPlan(const std::array<LegLengths, 2>& arms, size_t frameCount, double secondsPerFrame,
              bool hasFloor);

    /// Returns how many samples the plan takes of the motion, and the frame of each. Fast recordings have
    /// more frames.
    size_t SampleCount() const { return m_kValues[0].size(); }
    size_t FrameOf(size_t sample) const;
    /// Returns whether the pose of the source matters because a hand touches or nearly touches something, or
    /// because the target's hand may be below the floor.
    bool Touches(const TouchPoints& source) const;
    /// Adds the poses of a sample: the source's, and the target's before its hands are moved. Samples must
    /// ascend; some may be skipped.
    void Add(size_t sample, const TouchPoints& source, const ArmPoints& target);
    /// Computes how both arms move in all frames. Call it only once, after the last Add.
    void Solve();
    /// Returns how to move an arm in a frame. Call it only after Solve.
    ArmTurn Turn(size_t side, size_t frame) const;

private:
    struct Pose
    {
        size_t sample;
        TouchPoints source;
        ArmPoints target;
        ArmPoints moved; // the target with its arms turned
    };
    // Poses so close in time that the arms have no time to return in between, and the samples around them.
    struct Run
    {
        size_t firstPose;
        size_t endPose;
        size_t firstSample;
        size_t endSample;
    };

    std::vector<Run> Runs() const;
    bool AddRequests(CArmFit& fit, size_t sample, const Pose& pose, size_t side, bool fromSourceSide) const;
    bool Fit(const Run& run, size_t side, bool fromSourceSide);
    double Move(Pose& pose, size_t side) const;

    std::array<LegLengths, 2> m_kArms;
    size_t m_uiFrameCount;
    size_t m_uiStep; // frames per sample
    double m_fSecondsPerSample;
    bool m_bHasFloor;
    std::vector<Pose> m_kPoses;
    std::array<std::vector<CArmFit::Values>, 2> m_kValues; // per side and sample, in the order of ArmTurn
};

} // namespace gw
