#pragma once

#include <string>
#include <string_view>

namespace gw {

/// Returns a new private name in a folder (empty or with a trailing separator), with an extension, dot
/// included. It does not contain the destination's name, so it stays within the system's limit even if that
/// name is long.
std::string PrivateName(const std::string& folder, std::string_view extension);
/// Returns whether a file name, without folder, is a private name.
bool IsPrivateName(std::string_view name);

/// Locks a newly created private file until its descriptor is closed. Returns true also on file systems
/// without locks. Returns false if another program has swept the file; then use another name.
bool LockNewFile(int file);
/// Deletes the private files in a folder that no running program holds.
void RemoveLeftovers(const std::string& folder);
/// Same as RemoveLeftovers, for use before a file is written: at most once per folder and process, and
/// limited to the first thousand entries, so that saving stays fast in huge folders.
void SweepOnce(const std::string& folder);

} // namespace gw
