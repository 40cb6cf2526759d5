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
    /// Without an end it is the direction of the joint's bone: +y of its bone mesh, else of its own.
    CBoneDirection(const CNode& joint, const CNode* end) : m_pkJoint(&joint), m_pkEnd(end) {}

    /// The unit direction in the present pose.
    Vec3 Present() const;

private:
    const CNode* m_pkJoint;
    const CNode* m_pkEnd; // null for an end joint
};

/// One pair of bones while frames go by: both have a direction, or are looked at by their bones' axes.
class CBoneMeter
{
public:
    CBoneMeter(const BonePair& pair, const BoneEnds& ends);

    /// Takes the present pose as the next frame.
    void Add();
    const CRunningMean& Errors() const { return m_kErrors; }
    /// The angle of the last frame, in degrees.
    double LastError() const { return m_fLastError; }
    /// Enters the figures, all but the names.
    void Write(BoneMeasures& bone) const;

private:
    CBoneDirection m_kSource;
    CBoneDirection m_kTarget;
    CRunningMean m_kErrors;
    double m_fLastError = 0.0;
    int m_iFrame = 0; // the next one
    int m_iLargestFrame = 0;
};

} // namespace gw
