#pragma once

#include "ConvertFile.h"
#include "ShellOptions.h"

#include <array>
#include <cstddef>

namespace gw {

/// The number of sources for each outcome.
struct RunTally
{
    std::array<size_t, 4> ended{}; ///< indexed by EConversion
    size_t left = 0;               ///< not reached by the run

    size_t& operator[](EConversion outcome) { return ended[static_cast<size_t>(outcome)]; }
    size_t operator[](EConversion outcome) const { return ended[static_cast<size_t>(outcome)]; }
};

/// Prints the summary of a run: one line, or one object with --json.
void TellTally(const ShellOptions& options, const RunTally& tally);

} // namespace gw
