#pragma once

#include <string>
#include <string_view>

namespace gw {

/// How a made walk is written. Lengths are centimetres times `unit`.
struct WalkStyle
{
    int frames = 90;
    double rate = 30.0;         ///< of the walk: 1.1 seconds for two steps
    double declaredRate = 30.0; ///< of the file
    float unit = 1.0f;
    bool zUp = false;
    bool toes = true;
    bool sixChannels = false;    ///< positions on every joint, as differences from the offsets
    bool repeatsOffsets = false; ///< positions on every joint, as the offsets over again
    bool hipOffset = false;      ///< the root's offset holds the height of the hip that its channels hold too
    bool rootBelow = false;      ///< a root "Reference" above the hip
    bool scientific = false;     ///< numbers like 9.0000000e+01
};

/// A person who walks 0.69 m a step, as the text of a BVH file without any fault.
std::string MadeWalk(const WalkStyle& style = {});

/// A text with one part replaced by another, which must be there; of several the first one behind a mark.
std::string Replaced(std::string text, std::string_view part, std::string_view instead,
                     std::string_view behind = {});
/// A text with all parts of a kind replaced.
std::string AllReplaced(std::string text, std::string_view part, std::string_view instead);
/// The number of the row of a frame in the text of a made walk, from 1 on.
size_t LineOfFrame(std::string_view text, int frame);
/// A text with one line replaced; it is given without its line end.
std::string WithLine(std::string_view text, size_t number, std::string_view line);
/// A line of a text without its end.
std::string LineOf(std::string_view text, size_t number);
/// The value in a column of a frame's row.
double ValueOf(std::string_view text, int frame, size_t column);
/// A row with the value in a column given anew.
std::string WithValue(std::string_view row, size_t column, std::string_view value);

} // namespace gw
