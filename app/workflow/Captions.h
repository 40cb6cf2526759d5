#pragma once

#include "CConversion.h"
#include "CMapRowTable.h"

#include <string>

namespace gw {

/// How a result was made.
struct ResultOrigin
{
    std::string mapName;
    CMapRowTable rows;
    ConversionChoices choices;
    bool plantsFeet = true;
    SourceTiming timing; ///< of the result
};

/// Returns a view's caption: "walk.bvh: 69 frames at 30 fps, plays at double speed". The views play
/// one frame per tick of their clock, whatever the motion's rate.
std::string MotionCaption(const std::string& name, const SourceTiming& timing, int clockMilliseconds);
/// Returns the active options as a list: "aligned, faithful". Empty for a default conversion.
std::string ChoiceWords(const ConversionChoices& choices);
/// Returns how a result was made: "Made with \"Mixamo\", aligned".
std::string OriginCaption(const ResultOrigin& origin);

} // namespace gw
