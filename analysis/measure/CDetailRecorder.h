#pragma once

#include "CBoneMeter.h"
#include "ConversionDetail.h"

#include <span>
#include <vector>

namespace gw {

/// Records what the summary figures leave out: the direction error of the main bones in each frame.
class CDetailRecorder
{
public:
    /// Both trees must be posed. The detail and the nodes must outlive the recorder.
    CDetailRecorder(ConversionDetail& detail, std::span<const BonePair> pairs, const CSourceTable& sources);

    /// Adds the current pose as the next frame.
    void Add();
    /// Writes the figures of the parts of the body.
    void Finish();

private:
    void AddMainBone(const BonePair& pair, const CSourceTable& sources);
    void AddErrors();

    ConversionDetail& detail_;
    std::vector<CBoneMeter> m_kMeters; // for the main bones
};

} // namespace gw
