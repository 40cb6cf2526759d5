#pragma once

#include "CBoneMeter.h"
#include "ConversionDetail.h"

#include <span>
#include <vector>

namespace gw {

/// Keeps what the sums of a comparison pass over: frame by frame, how far the main bones are off.
class CDetailRecorder
{
public:
    /// Both trees are posed. The detail and the nodes must outlive the recorder.
    CDetailRecorder(ConversionDetail& detail, std::span<const BonePair> pairs, const CSourceTable& sources);

    /// Takes the present pose as the next frame.
    void Add();
    /// Enters the figures of the parts.
    void Finish();

private:
    void AddMainBone(const BonePair& pair, const CSourceTable& sources);
    void AddErrors();

    ConversionDetail& detail_;
    std::vector<CBoneMeter> m_kMeters; // of the main bones
};

} // namespace gw
