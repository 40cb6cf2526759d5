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

/// Stands in the source column of a row whose target bone takes no source.
inline constexpr std::string_view kFixedSource = "[FIXED]";

/// The most bytes that a profile may have; a full skeleton takes a fiftieth of this.
inline constexpr size_t kProfileByteLimit = 262'144;

/// The platform's line end, which ends every line that is written.
inline constexpr std::string_view kLineEnd =
#ifdef _WIN32
    "\r\n";
#else
    "\n";
#endif

/// The display name of a profile: the first line of its file, cut at the end. Empty when the file cannot be
/// read.
std::string ReadProfileName(const std::string& path);

/// The bytes of a profile. False when the file cannot be read or is longer than a profile can be.
bool ReadProfileText(const std::string& path, std::string& text);

/// What a row says beside its two names.
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

/// One line of a profile behind the first. Only the members of its kind say something.
struct ProfileLine
{
    EProfileLine kind = EProfileLine::Mapping;
    size_t line = 0; ///< in the file, from 1 on
    Vec3 position = kVec3Zero;
    int frameRate = 0;
    std::string source; ///< kFixedSource in a fixed row
    std::string target;
    RowNumbers numbers;
};

/// Reads the text of a profile line by line. Never fails: a line with too few tokens takes the missing ones
/// from the line before, and one that fits no other kind is a mapping row.
class CProfileReader
{
public:
    /// The text must outlive the reader.
    explicit CProfileReader(std::string_view text);

    const std::string& Name() const { return m_kName; }
    /// False at the end of the file.
    bool Next(ProfileLine& line);

private:
    static constexpr size_t kTokenCount = 4;

    bool NextPiece(std::string_view& piece);
    void TakeTokens(std::string_view piece);

    std::string_view m_kRest;
    std::string_view m_kRestOfLine;
    std::string m_kName;
    std::array<std::string, kTokenCount> m_kToken; // not cleared between lines
    size_t m_uiLine = 0;
};

/// A decimal number cut to an integer toward zero; one that no integer can hold is the nearest end, none is
/// 0.
int CutToInteger(float value);

/// The whole text of a profile file. The name is written as it is; the position is cut to integers toward
/// zero.
std::string ProfileText(std::string_view name, int frameRate, const Vec3& position, const CMapRowTable& rows);

} // namespace gw
