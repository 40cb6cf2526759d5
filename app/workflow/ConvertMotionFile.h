#pragma once

#include "CConversion.h"
#include "Notice.h"

#include <string>
#include <vector>

namespace gw {

/// A conversion without user interaction. Paths are UTF-8.
struct MotionFileJob
{
    std::string source;  ///< a motion file, or a container with keyframes
    std::string profile; ///< path of a .prf file
    /// ends in .Kinetra for a package; any other extension yields an .htr. An existing file is replaced
    std::string output;
    std::string dataFolder;    ///< contains base.htr and KsBone.bsm; empty for the program's own folder
    ConversionChoices choices; ///< conversion options
};

/// The result of such a conversion.
struct MotionFileResult
{
    bool written = false;
    std::vector<Notice> notices; ///< warnings, and at least one error if nothing was written
};

/// Opens, converts and saves one motion with the same result as the window and the shell program, for
/// programs that link the engine. Leaves no settings or folders behind.
MotionFileResult ConvertMotionFile(const MotionFileJob& job);

} // namespace gw
