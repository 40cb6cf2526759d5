#pragma once

#include "JudgeProfile.h"
#include "ProfileRows.h"

#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// One profile, held against a source.
struct ProfileChoice
{
    std::string path;     ///< of the profile's file
    ProfileRows profile;  ///< what the file says, or what became of it
    bool adapted = false; ///< rows and name are those for the prefix of the source's names, not the file's
    RowMatch match;
    ProfileVerdict verdict; ///< of a profile whose rows all fit
};

/// A profile's file with its text, which has been read already.
struct LoadedProfile
{
    std::string path;
    std::string_view text; ///< must outlive the choice
};

/// Which of the profiles that fit get a verdict.
enum class EJudged : uint8_t
{
    All,
    First, ///< those that may be first; the others are behind them in no particular order, or left out
};

/// Holds profiles against a source, the best one first. Those of which all rows fit go before the others, and
/// of them more rows before fewer, then what is not doubtful, then what leaves out fewer spine joints and
/// turns bones less; the others stand by the share of their rows that fit. What is equal stays in the order
/// given. Where no profile fits as it is and the source's joints share a prefix, profiles that fit with that
/// prefix, or without their own one, come first as adapted ones. Files that cannot be read are left out.
std::vector<ProfileChoice> ChooseProfile(std::span<const std::string> paths, CNode& sourceRoot,
                                         CNode& targetRoot, EJudged judged = EJudged::All);
std::vector<ProfileChoice> ChooseProfile(std::span<const LoadedProfile> profiles, CNode& sourceRoot,
                                         CNode& targetRoot, EJudged judged = EJudged::All);

} // namespace gw
