#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// How a made walk is written. Lengths are centimeters times `unit`.
struct WalkStyle
{
    int frames = 90;
    double rate = 30.0;         ///< of the walk: 1.1 seconds for two steps
    double declaredRate = 30.0; ///< of the file
    float unit = 1.0f;
    bool zUp = false;
    bool toes = true;
    bool sixChannels = false;    ///< positions on every joint, as differences from the offsets
    bool repeatsOffsets = false; ///< positions on every joint, repeating the offsets
    /// the root's offset contains the hip's height, which its channels contain too
    bool hipOffset = false;
    bool rootBelow = false; ///< a root "Reference" above the hip
};

/// Returns a person who walks 0.69 m per step, as the text of a correct BVH file.
std::string MadeWalk(const WalkStyle& style = {});

/// Returns a text with one part replaced, which must occur; of several, the first one after a mark.
std::string Replaced(std::string text, std::string_view part, std::string_view instead,
                     std::string_view behind = {});
/// Returns a text with all occurrences replaced.
std::string AllReplaced(std::string text, std::string_view part, std::string_view instead);
/// Returns the line number of a frame's row in a made walk, starting at 1.
size_t LineOfFrame(std::string_view text, int frame);
/// Returns a text with one line replaced, given without its line end.
std::string WithLine(std::string_view text, size_t number, std::string_view line);
/// Returns a line of a text without its end.
std::string LineOf(std::string_view text, size_t number);
/// Returns the value in a column of a frame's row.
double ValueOf(std::string_view text, int frame, size_t column);
/// Returns a text with new values in a column, one a frame from a frame on.
std::string WithValues(std::string text, int frame, size_t column, const std::vector<const char*>& values);

} // namespace gw
