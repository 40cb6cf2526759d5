#pragma once

#include <string>
#include <string_view>

namespace gw {

/// A new private name in a folder, which ends in a separator or is empty; with an extension, dot included. It
/// does not contain the name of the file that it stands for, so that a long one stays within the system's
/// limit.
std::string PrivateName(const std::string& folder, std::string_view extension);
/// Whether a file name without a folder is such a name.
bool IsPrivateName(std::string_view name);

/// Locks a file that was just created under a private name, until its descriptor is closed. True also on a
/// file system without locks; false when another program has swept the file, so that it needs another name.
bool LockNewFile(int file);
/// Deletes the private files in a folder that no living program holds.
void RemoveLeftovers(const std::string& folder);
/// The same before a file is written, but at most once per folder and process, and not beyond the first
/// thousand entries, so that saving stays fast in huge folders.
void SweepOnce(const std::string& folder);

} // namespace gw
