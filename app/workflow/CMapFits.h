#pragma once

#include "ChooseProfile.h"

#include <cstddef>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CNode;

/// How well the installed bone maps fit the open source.
class CMapFits
{
public:
    /// Matches the maps of some folders, which end in separators. Of maps with the same name, the first one
    /// counts, because only that one can be selected by its name.
    void Measure(std::span<const std::string> folders, CNode& source, CNode& target);

    /// Returns the best map of which every row matches, possibly doubtful or adapted to the source's name
    /// prefix; null if no map fits.
    const ProfileChoice* Best() const;
    /// Returns how a map fits as it is installed; null for a name that is not.
    const ProfileChoice* Find(std::string_view name) const;
    /// Returns a number by which maps are listed, lowest first: maps that fit, then near fits, then the rest
    /// with equal numbers.
    size_t RankOf(std::string_view name) const;
    /// Returns a few words for the list: "best fit, sure", "fits, likely", "19 of 21". Empty for a map that
    /// is far from fitting.
    std::string WordsOf(std::string_view name) const;
    /// Returns the name and what is known about its fit, in lines.
    std::string TipOf(const std::string& name) const;

private:
    std::vector<ProfileChoice> choices_; ///< best first
};

} // namespace gw
