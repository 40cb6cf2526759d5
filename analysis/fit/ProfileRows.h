#pragma once

#include "CMapRowTable.h"
#include "Vec3.h"

#include <string>
#include <string_view>

namespace gw {

class CBoneNames;
class CRetargeter;

/// A profile as loading its file would leave it.
struct ProfileRows
{
    std::string name; ///< display name
    int frameRate = 30;
    Vec3 position = kVec3Zero;
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

/// How many rows there are, fixed ones included, and how many find their bones.
struct RowMatch
{
    int rowCount = 0;
    int foundCount = 0;
    int mappedCount = 0;     ///< those of them that have a source
    bool drivesRoot = false; ///< a source bone that is there drives the target's root bone

    /// Whether a conversion accepts the rows.
    bool IsWhole() const { return foundCount == rowCount && drivesRoot; }
};

/// Looks up the bones of all rows and tells a retargeter what those say whose bones are there.
RowMatch ApplyRows(const CMapRowTable& rows, const CBoneNames& sources, const CBoneNames& targets,
                   CRetargeter& table);

} // namespace gw
