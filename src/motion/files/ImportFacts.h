#pragma once

#include <string>
#include <vector>

namespace gw {

/// What to read from a file with several clips.
struct ImportChoice
{
    std::string clip;  ///< name, case ignored; empty for the longest
    double rate = 0.0; ///< frames per second if the file has no rate; 0 for 30
};

/// What the file of a modeling program says besides the motion.
struct ImportFacts
{
    std::string clip;               ///< the clip that was read
    std::vector<std::string> clips; ///< all clips, in the order of the file
    bool isRateOfFile = false;      ///< otherwise the rate was chosen
    double unitMeters = 0.0;        ///< length of a unit; 0 if the file does not contain it
    bool wasTurnedUp = false;       ///< the up axis was not Y
};

} // namespace gw
