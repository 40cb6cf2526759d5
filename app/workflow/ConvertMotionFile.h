#pragma once

#include "CConversion.h"
#include "CReport.h"

#include <string>
#include <vector>

namespace gw {

/// A conversion that needs no answers on its way. Paths are UTF-8.
struct MotionFileJob
{
    std::string source;        ///< a motion file, or a container with keys
    std::string profile;       ///< path of a .prf file
    std::string output;        ///< ends in .Kinetra for a package; anything else gives an .htr. Replaced
    std::string dataFolder;    ///< of base.htr and KsBone.bsm; empty for the program's own
    ConversionChoices choices; ///< beside the rules
};

/// What came of it.
struct MotionFileResult
{
    bool written = false;
    std::vector<CReport> reports; ///< warnings, and where nothing was written at least one that is none
};

/// Opens, converts and saves one motion as window and shell do: for programs that link the engine. Leaves no
/// settings and no folders behind.
MotionFileResult ConvertMotionFile(const MotionFileJob& job);

} // namespace gw
