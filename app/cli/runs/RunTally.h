#pragma once

#include "ConvertFile.h"
#include "ShellOptions.h"

#include <array>
#include <cstddef>
#include <string>

namespace gw {

class CJsonWriter;

/// The number of sources for each outcome.
struct RunTally
{
    std::array<size_t, 4> ended{}; ///< indexed by EConversion
    size_t left = 0;               ///< not reached by the run

    size_t& operator[](EConversion outcome) { return ended[static_cast<size_t>(outcome)]; }
    size_t operator[](EConversion outcome) const { return ended[static_cast<size_t>(outcome)]; }
};

/// Returns "8 converted, 2 skipped, 0 failed, 0 left".
std::string TallyWords(const ShellOptions& options, const RunTally& tally);
/// Writes the same as members of an open JSON object.
void WriteTally(CJsonWriter& json, const ShellOptions& options, const RunTally& tally);

} // namespace gw
