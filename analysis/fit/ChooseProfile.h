#pragma once

#include "JudgeProfile.h"
#include "ProfileRows.h"

#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// A profile matched against a source.
struct ProfileChoice
{
    std::string path;     ///< of the profile's file
    ProfileRows profile;  ///< the file's content, or its adapted form
    bool adapted = false; ///< rows and name use the prefix of the source's names, not the file's
    RowMatch match;
    ProfileVerdict verdict; ///< set if all rows fit
};

/// A profile's path and its text, already read.
struct LoadedProfile
{
    std::string path;
    std::string_view text; ///< must outlive the choice
};

/// Which of the fitting profiles are judged.
enum class EJudged : uint8_t
{
    All,
    First, ///< those that can come first; the rest follow unsorted or are left out
};

/// Matches profiles against a source and returns them best first. Profiles whose rows all fit come first:
/// those with more rows, then those without grave doubts, then those that leave out fewer spine joints and
/// rotate bones less. The others are sorted by their share of fitting rows. Ties keep the given order. If no
/// profile fits and the source's names share a prefix, profiles that fit with that prefix added or replaced
/// come first, marked as adapted. Unreadable files are left out.
std::vector<ProfileChoice> ChooseProfile(std::span<const std::string> paths, CNode& sourceRoot,
                                         CNode& targetRoot, EJudged judged = EJudged::All);
/// The same for profiles that were read and skeletons whose names were listed. Both have roots.
std::vector<ProfileChoice> ChooseProfile(std::span<const LoadedProfile> profiles, const CBoneNames& sources,
                                         const CBoneNames& targets, EJudged judged = EJudged::All);

} // namespace gw
