#pragma once

#include <string>
#include <string_view>

namespace gw {

/// A window's position as stored in the settings, in screen pixels.
struct WindowPlacement
{
    int flags = 0; ///< always written as 0
    int showCommand = 1;
    int minimisedX = 0;
    int minimisedY = 0;
    int maximisedX = 0;
    int maximisedY = 0;
    int left = 0;
    int top = 0;
    int right = 0;
    int bottom = 0;

    friend bool operator==(const WindowPlacement&, const WindowPlacement&) = default;
};

/// Returns ten numbers separated by commas.
std::string PlacementText(const WindowPlacement& placement);
/// Parses a placement. Returns false, and leaves it unchanged, unless the text is exactly ten integers.
bool ScanPlacement(std::string_view text, WindowPlacement& placement);

} // namespace gw
