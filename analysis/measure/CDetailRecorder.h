#pragma once

#include "CBoneMeter.h"
#include "ConversionDetail.h"

#include <span>
#include <vector>

namespace gw {

/// Keeps what the sums of a comparison pass over: frame by frame, how far the main bones are off and where
/// the roots are.
class CDetailRecorder
{
public:
    /// Both trees are posed. The detail and the nodes must outlive the recorder.
    CDetailRecorder(ConversionDetail& detail, std::span<const BonePair> pairs, const CSourceTable& sources,
                    const CNode* resultRoot);

    /// Takes the present pose as the next frame.
    void Add();
    /// Enters the figures of the parts, and brings the root's way into the unit of the result and above the
    /// floors. The feet are in the detail already.
    void Finish(const ConversionMeasures& measures);

private:
    void AddMainBone(const BonePair& pair, const CSourceTable& sources);
    void AddErrors();
    void FinishParts();

    ConversionDetail& detail_;
    std::vector<CBoneMeter> m_kMeters; // of the main bones
    const CNode* m_pkSourceRoot;       // null where the root is not mapped
    const CNode* m_pkResultRoot;
};

} // namespace gw
