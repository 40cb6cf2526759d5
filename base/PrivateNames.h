#pragma once

#include <string>
#include <string_view>

namespace gw {

// Names of files that stand in a folder only while a program works on something else there. They are hidden,
// nobody can foresee them, and they tell which program of which machine they belong to, so that what a killed
// one left can be told from what a living one needs.

/// A new private name in a folder, which ends in a separator or is empty; with an extension, dot included. It
/// does not tell the name that it stands beside, so that a long one stays within the system's limit.
std::string PrivateName(const std::string& folder, std::string_view extension);
/// Whether a file name without a folder is such a name.
bool IsPrivateName(std::string_view name);
/// Deletes the private files in a folder whose program ran on this machine and is gone.
void RemoveLeftovers(const std::string& folder);

} // namespace gw
