#pragma once

#include "Vec3.h"

#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// The kind of a line in the older map syntax.
enum class EMapLine : uint8_t
{
    Text,      ///< anything else, such as the name in the first line
    Position,  ///< the root position
    FrameRate, ///< frames per second
    Mapping,   ///< a source bone that drives a target bone
    Fixed,     ///< a target bone without a source: a line with a star and without an arrow
};

/// One line of the older map syntax: its text and its meaning. Only the members of its kind are used.
struct MapLine
{
    std::string text;
    EMapLine kind = EMapLine::Text;
    std::string source;
    std::string target;
    bool hasRotation = false; ///< false for a mapping that was just added
    Vec3 numbers = kVec3Zero; ///< a mapping's rotation in degrees, or the root position
    int frameRate = 0;
};

/// Parses a line. Every text is some kind of line.
MapLine ParseMapLine(std::string_view text);

// Lines as written by the map tool. Numbers are truncated toward zero.
std::string PositionLine(const Vec3& position);
std::string FrameRateLine(int frameRate);
/// Returns the line of a mapping without a rotation.
std::string MappingLine(std::string_view source, std::string_view target);
/// Returns the line of a mapping with rotations about X, Y and Z in degrees.
std::string MappingLine(std::string_view source, std::string_view target, const Vec3& degrees);

/// Reads all lines of a map or profile file. Returns false, leaving `lines` unchanged, if it cannot be read.
bool ReadMapLines(const std::string& path, std::vector<MapLine>& lines);
/// Replaces a file by the lines' texts. Returns false, keeping an old file, if that fails.
bool WriteMapLines(const std::string& path, std::span<const MapLine> lines);

} // namespace gw
