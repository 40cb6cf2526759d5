#pragma once

#include "BoneEnds.h"
#include "BonePairs.h"
#include "ConversionMeasures.h"
#include "Figures.h"

namespace gw {

class CPoseSampler;

/// The direction from one joint to another.
class CBoneDirection
{
public:
    /// Without an end joint, the direction is that of the joint's bone: +y of its bone mesh, otherwise +y of
    /// the joint itself.
    CBoneDirection(const CNode& joint, const CNode* end) : m_pkJoint(&joint), m_pkEnd(end) {}

    /// Returns the unit direction in the current pose.
    Vec3 Present() const;

private:
    const CNode* m_pkJoint;
    const CNode* m_pkEnd; // null for an end joint
};

/// Measures one pair of bones frame by frame. Either both have a direction between joints, or both are
/// compared by their bones' axes.
class CBoneMeter
{
public:
    CBoneMeter(const BonePair& pair, const BoneEnds& ends);

    /// Adds the current pose as the next frame.
    void Add();
    const CRunningMean& Errors() const { return m_kErrors; }
    /// Returns the angle in the last frame, in degrees.
    double LastError() const { return m_fLastError; }
    /// Writes the figures, but not the names.
    void Write(BoneMeasures& bone) const;

private:
    CBoneDirection m_kSource;
    CBoneDirection m_kTarget;
    CRunningMean m_kErrors;
    double m_fLastError = 0.0;
    int m_iFrame = 0; // next frame
    int m_iLargestFrame = 0;
};

} // namespace gw
