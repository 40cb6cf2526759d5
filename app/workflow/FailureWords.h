#pragma once

#include "CFailure.h"
#include "CReport.h"

#include <cstdint>
#include <string>
#include <string_view>

namespace gw {

/// Why a motion that could be read cannot be converted, or not well.
enum class EMisfit : uint8_t
{
    NoScene,      ///< no source is open, or base.htr could not be read
    NoProfile,    ///< no profile is selected
    BadProfile,   ///< the profile's file cannot be read
    NoRootRow,    ///< no row drives the target's root bone
    NoRootSource, ///< the row of the target's root bone is fixed
    NoFrames,     ///< the source has no frames
    NoBody,       ///< the rows drive too little of a body to align it
    TurnedAtRest, ///< rows rotate limbs in the source's rest pose; `name` is one of its joints
};

/// Returns the short fixed word for a reason.
std::string_view FailureCode(EFailure reason);

/// Returns what can be done about it; empty if unknown.
std::string_view FailureRemedy(EFailure reason);

/// Returns a failure or warning of a file as a report: "walk.bvh:12: an empty line ...". Names are made safe
/// to print.
CReport MakeReport(const std::string& path, const CFailure& failure, bool warning);
CReport MakeReport(const std::string& path, EMisfit misfit, const std::string& name = {});

/// Returns the report as one line: path, place and message.
std::string ReportLine(const CReport& report);

} // namespace gw
