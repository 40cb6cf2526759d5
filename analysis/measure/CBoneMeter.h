#pragma once

#include "BoneEnds.h"
#include "BonePairs.h"
#include "ConversionMeasures.h"
#include "Figures.h"

namespace gw {

class CPoseSampler;

/// The direction from one joint to another while frames go by, and how much it shakes.
class CDirectionMeter
{
public:
    /// Without an end it is the direction of the joint's bone: +y of its bone mesh, else of its own.
    CDirectionMeter(const CNode& joint, const CNode* end) : m_pkJoint(&joint), m_pkEnd(end) {}

    /// Takes the present pose as the next frame.
    void Add();
    /// The unit direction of the last frame.
    const Vec3& Direction() const { return m_kLast; }
    double Jitter() const { return m_kBends.Mean(); }

private:
    Vec3 Present() const;

    const CNode* m_pkJoint;
    const CNode* m_pkEnd; // null for an end joint
    Vec3 m_kLast = kVec3Zero;
    Vec3 m_kBeforeLast = kVec3Zero;
    int m_iFrames = 0;
    CRunningMean m_kBends;
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
    CDirectionMeter m_kSource;
    CDirectionMeter m_kTarget;
    CRunningMean m_kErrors;
    double m_fLastError = 0.0;
    int m_iFrame = 0; // the next one
    int m_iLargestFrame = 0;
};

} // namespace gw
