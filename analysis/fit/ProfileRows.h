#pragma once

#include "ApplyRow.h"
#include "CMapRowTable.h"
#include "Vec3.h"

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

namespace gw {

class CBoneNames;

/// A profile as loaded from its file.
struct ProfileRows
{
    std::string name; ///< display name
    int frameRate = 30;
    Vec3 position = kVec3Zero;
    size_t frameRateLine = 0; ///< in the file, starting at 1; 0 if the file has no such line
    size_t positionLine = 0;
    CMapRowTable rows; ///< including the pelvis bones
};

/// Reads a profile. Returns false, and leaves `profile` unchanged, if the file cannot be read.
bool ReadProfileRows(const std::string& path, ProfileRows& profile);
/// Reads a profile from text.
ProfileRows RowsOfText(std::string_view text);
/// Returns the most rows that a profile can have, or nothing if it names a source bone that does not exist,
/// so not all rows can fit. Most profiles name one in their first rows, and reading stops there. Rarely
/// returns a number for such a profile too.
std::optional<size_t> RowsThatMayFit(std::string_view text, const CBoneNames& sources);
/// Returns the bytes of a file that reads as this profile.
std::string TextOf(const ProfileRows& profile);

/// Returns the prefix that all source names have in common; may be empty.
std::string SourcePrefix(const CMapRowTable& rows);
/// Returns the rows with another prefix in place of that one in every source name.
CMapRowTable WithPrefix(const CMapRowTable& rows, std::string_view oldPrefix, std::string_view newPrefix);

} // namespace gw
