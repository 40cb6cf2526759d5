#pragma once

#include "JudgeProfile.h"
#include "ProfileRows.h"

#include <span>
#include <string>
#include <vector>

namespace gw {

/// One profile, held against a source.
struct ProfileChoice
{
    std::string path; ///< of the profile's file
    std::string name; ///< display name; tells the prefix where the profile was adapted to one
    /// The bytes of the profile as adapted to the prefix of the source's names; empty where the file serves
    /// as it is.
    std::string text;
    RowMatch match;
    ProfileVerdict verdict; ///< of a profile whose rows all fit
};

/// Holds profiles against a source, the best one first. Those of which all rows fit go before the others, and
/// of them more rows before fewer, then what is not doubtful, then what leaves out fewer spine joints and
/// turns bones less; the others stand by the share of their rows that fit. What is equal stays in the order
/// given. Where no profile fits as it is and the source's joints share a prefix, profiles that fit with that
/// prefix, or without their own one, come first as adapted ones. Files that cannot be read are left out.
std::vector<ProfileChoice> ChooseProfile(std::span<const std::string> paths, CNode& sourceRoot,
                                         CNode& targetRoot);

} // namespace gw
