#pragma once

#include "Vec3.h"

#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// What a line of the older map syntax says.
enum class EMapLine : uint8_t
{
    Text,      ///< anything else, such as the name in the first line
    Position,  ///< the root position
    FrameRate, ///< frames per second
    Mapping,   ///< a source bone that drives a target bone
    Fixed,     ///< a target bone without a source: a line with a star and no arrow
};

/// One entry of the older map syntax: the line as it stands, and what it says. Only the members of its kind
/// count.
struct MapLine
{
    std::string text;
    EMapLine kind = EMapLine::Text;
    std::string source;
    std::string target;
    bool hasRotation = false; ///< a mapping that was only added has none yet
    Vec3 numbers = kVec3Zero; ///< a mapping's rotation in degrees, or the root position
    int frameRate = 0;
};

/// Reads one line. Every text is a line of some kind.
MapLine ParseMapLine(std::string_view text);

// The lines as the map tool writes them. Numbers are cut to integers toward zero.
std::string PositionLine(const Vec3& position);
std::string FrameRateLine(int frameRate);
/// A mapping without a rotation.
std::string MappingLine(std::string_view source, std::string_view target);
std::string MappingLine(std::string_view source, std::string_view target, const Vec3& degrees);

/// Reads all lines of a map or profile file. False, and lines left alone, when it cannot be read.
bool ReadMapLines(const std::string& path, std::vector<MapLine>& lines);
/// Replaces a file by the lines' texts. False leaves an old file as it was.
bool WriteMapLines(const std::string& path, std::span<const MapLine> lines);

} // namespace gw
