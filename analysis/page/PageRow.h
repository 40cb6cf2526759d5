#pragma once

#include <optional>
#include <string>
#include <vector>

namespace gw {

/// What a page says about one source of a run. It is made from the source's record, so the row of a source
/// that was skipped looks like the one of the run that converted it.
struct PageRow
{
    std::string source = {};  ///< path
    std::string outcome = {}; ///< "converted", "skipped", "failed" or "left"
    std::string profile = {};
    std::string confidence = {}; ///< in the profile: "sure", "doubtful", "drafted"; empty if it was named
    long long frames = 0;
    std::vector<std::string> warnings = {}; ///< their kinds
    std::string cause = {};                 ///< for a failure: the message
    std::string causeKind = {};             ///< and its kind
    /// in the order of KeyFiguresOf; empty if nothing was measured
    std::vector<std::optional<double>> figures = {};
};

} // namespace gw
