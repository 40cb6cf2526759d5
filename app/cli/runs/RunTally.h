#pragma once

#include "ConvertFile.h"
#include "ShellOptions.h"

#include <array>
#include <cstddef>

namespace gw {

/// How many sources of a run came to each end.
struct RunTally
{
    std::array<size_t, 4> ended{}; ///< by EConversion
    size_t left = 0;               ///< that the run did not come to

    size_t& operator[](EConversion outcome) { return ended[static_cast<size_t>(outcome)]; }
    size_t operator[](EConversion outcome) const { return ended[static_cast<size_t>(outcome)]; }
};

/// The closing words of a run: one line, or one object with --json.
void TellTally(const ShellOptions& options, const RunTally& tally);

} // namespace gw
