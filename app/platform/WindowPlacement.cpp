#include "WindowPlacement.h"

#include "Numbers.h"

#include <algorithm>
#include <charconv>

namespace gw {

namespace {

// The numbers in text order.
constexpr int WindowPlacement::*kNumbers[] = {
    &WindowPlacement::flags,      &WindowPlacement::showCommand, &WindowPlacement::minimisedX,
    &WindowPlacement::minimisedY, &WindowPlacement::maximisedX,  &WindowPlacement::maximisedY,
    &WindowPlacement::left,       &WindowPlacement::top,         &WindowPlacement::right,
    &WindowPlacement::bottom,
};

constexpr std::string_view kBlanks = " \t";

// Reads a field that contains one integer, optionally after blanks, and nothing else.
bool ScanField(std::string_view field, int& number)
{
    field.remove_prefix(std::min(field.find_first_not_of(kBlanks), field.size()));
    const char* const fieldEnd = field.data() + field.size();
    const auto [end, error] = std::from_chars(field.data(), fieldEnd, number);
    return error == std::errc() && end == fieldEnd;
}

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
        const size_t fieldEnd = std::min(text.find(','), text.size());
        if (!ScanField(text.substr(0, fieldEnd), scanned.*number))
            return false;
        text.remove_prefix(std::min(fieldEnd + 1, text.size()));
    }
    if (!text.empty())
        return false;
    placement = scanned;
    return true;
}

} // namespace gw
