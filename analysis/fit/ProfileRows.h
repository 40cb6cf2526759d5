#pragma once

#include "ApplyRow.h"
#include "CMapRowTable.h"
#include "Vec3.h"

#include <cstddef>
#include <string>
#include <string_view>

namespace gw {

class CBoneNames;

/// A profile as loading its file would leave it.
struct ProfileRows
{
    std::string name; ///< display name
    int frameRate = 30;
    Vec3 position = kVec3Zero;
    size_t frameRateLine = 0; ///< in the file, from 1 on; 0 where it has none
    size_t positionLine = 0;
    CMapRowTable rows; ///< with those of the pelvis bones
};

/// Reads a profile. False, and the record left alone, when the file cannot be read.
bool ReadProfileRows(const std::string& path, ProfileRows& profile);
/// Reads the text of a profile.
ProfileRows RowsOfText(std::string_view text);
/// False if a profile names a source bone that does not exist, so that not all of its rows can fit. Most
/// profiles name one in their first rows and are read no further. In rare cases true for such a profile as
/// well.
bool MayFit(std::string_view text, const CBoneNames& sources);
/// The bytes of a file that reads as this profile.
std::string TextOf(const ProfileRows& profile);

/// The start that the source names of all rows share; empty where they share none or there is no row.
std::string SourcePrefix(const CMapRowTable& rows);
/// The rows with another start in place of that one before every source name.
CMapRowTable WithPrefix(const CMapRowTable& rows, std::string_view oldPrefix, std::string_view newPrefix);

} // namespace gw
