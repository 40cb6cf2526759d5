#include "WindowPlacement.h"

#include "Numbers.h"

namespace gw {

namespace {

// The numbers in the order of the text.
constexpr int WindowPlacement::*kNumbers[] = {
    &WindowPlacement::flags,      &WindowPlacement::showCommand, &WindowPlacement::minimisedX,
    &WindowPlacement::minimisedY, &WindowPlacement::maximisedX,  &WindowPlacement::maximisedY,
    &WindowPlacement::left,       &WindowPlacement::top,         &WindowPlacement::right,
    &WindowPlacement::bottom,
};

} // namespace

std::string PlacementText(const WindowPlacement& placement)
{
    WindowPlacement written = placement;
    written.flags = 0;
    std::string text;
    for (const auto number : kNumbers)
    {
        if (!text.empty())
            text += ',';
        AppendInt(text, written.*number);
    }
    return text;
}

bool ScanPlacement(std::string_view text, WindowPlacement& placement)
{
    WindowPlacement scanned;
    for (const auto number : kNumbers)
    {
        if (number != kNumbers[0] && !text.starts_with(','))
            return false;
        if (number != kNumbers[0])
            text.remove_prefix(1);
        if (!ScanInt(text, scanned.*number))
            return false;
        text.remove_prefix(std::min(text.find(','), text.size()));
    }
    placement = scanned;
    return true;
}

} // namespace gw
