#pragma once

#include "CConversion.h"
#include "Notice.h"

#include <string>
#include <vector>

namespace gw {

/// A conversion without questions. Paths are UTF-8.
struct MotionFileJob
{
    std::string source;  ///< a motion file, or a container with keys
    std::string profile; ///< path of a .prf file
    /// ends in .Kinetra for a package; anything else yields an .htr. Replaced if it exists
    std::string output;
    std::string dataFolder;    ///< with base.htr and KsBone.bsm; empty for the program's own
    ConversionChoices choices; ///< conversion options
};

/// The result of such a conversion.
struct MotionFileResult
{
    bool written = false;
    std::vector<Notice> notices; ///< warnings, and at least one error if nothing was written
};

/// Opens, converts and saves one motion like the window and the shell, for programs that link the engine.
/// Leaves no settings or folders behind.
MotionFileResult ConvertMotionFile(const MotionFileJob& job);

} // namespace gw
