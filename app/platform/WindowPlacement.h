#pragma once

#include <string>
#include <string_view>

namespace gw {

/// Where a window stood, as the settings keep it. Screen pixels.
struct WindowPlacement
{
    int flags = 0; ///< written as 0
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

/// Ten numbers with commas between them.
std::string PlacementText(const WindowPlacement& placement);
/// Returns false and leaves the placement unchanged for a text that is not exactly ten integers.
bool ScanPlacement(std::string_view text, WindowPlacement& placement);

} // namespace gw
