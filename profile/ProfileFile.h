#pragma once

#include "AxisCodes.h"
#include "Vec3.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace gw {

class CMapRowTable;

/// The source column of a row whose target bone has no source.
inline constexpr std::string_view kFixedSource = "[FIXED]";

/// The maximum size of a profile; a full skeleton takes a fiftieth of it.
inline constexpr size_t kProfileByteLimit = 262'144;

/// Returns the display name of a profile: the first line of its file, trimmed at the end. Empty if the file
/// cannot be read.
std::string ReadProfileName(const std::string& path);

/// Reads the bytes of a profile. Returns false if the file cannot be read or exceeds the limit.
bool ReadProfileText(const std::string& path, std::string& text);

/// The numbers of a row.
struct RowNumbers
{
    std::array<int, 3> rotation{}; ///< X, Y, Z in degrees
    AxisCodes axes = kNeutralAxes;

    friend bool operator==(const RowNumbers&, const RowNumbers&) = default;
};

enum class EProfileLine : uint8_t
{
    Position,
    FrameRate,
    Fixed,   ///< a target bone without a source
    Mapping, ///< a source bone that drives a target bone
};

/// A line of a profile after the first. Only the members of its kind are used. Texts are views of the
/// profile's text.
struct ProfileLine
{
    /// Returns the numbers of a row. They are parsed here, because a search by names does not need them.
    RowNumbers Numbers() const;

    EProfileLine kind = EProfileLine::Mapping;
    size_t line = 0; ///< in the file, starting at 1
    Vec3 position = kVec3Zero;
    int frameRate = 0;
    std::string_view source; ///< kFixedSource for a fixed row
    std::string_view target;
    std::string_view numberText;
};

/// Reads the text of a profile line by line. It never fails: a line with too few tokens uses those of the
/// previous line for the missing ones, and a line of no other kind is a mapping row.
class CProfileReader
{
public:
    /// The text must outlive the reader.
    explicit CProfileReader(std::string_view text);

    const std::string& Name() const { return m_kName; }
    /// Returns false at the end of the file.
    bool Next(ProfileLine& line);

private:
    static constexpr size_t kTokenCount = 4;

    bool NextPiece(std::string_view& piece);
    void TakeTokens(std::string_view piece);

    std::string_view m_kRest;
    std::string_view m_kRestOfLine;
    std::string m_kName;
    std::array<std::string_view, kTokenCount> m_kToken; // not cleared between lines
    size_t m_uiLine = 0;
};

/// Returns a number truncated to an integer, clamped to its range; 0 for NaN.
int CutToInteger(float value);

/// Returns the text of a profile file. The name is written unchanged; the position is truncated to integers.
std::string ProfileText(std::string_view name, int frameRate, const Vec3& position, const CMapRowTable& rows);

} // namespace gw
