#pragma once

#include <string>
#include <string_view>

namespace gw {

/// Prepares the standard streams at program start: bytes and line ends pass unchanged, text is UTF-8, and
/// streams that the caller has closed lead nowhere. Otherwise, the next opened file would be such a stream,
/// and messages would be written into a result. A limit on the size of files makes a write fail like a full
/// disk.
void PrepareStandardStreams();

/// Returns whether a path names a stream of this process, a device or a pipe: something that cannot be read
/// twice and must not be replaced by a file.
bool IsStreamPath(const std::string& path);
/// Returns whether a path names this process's standard output.
bool IsStandardOutputPath(const std::string& path);

/// Returns the characters that no file name may contain.
std::string_view ForbiddenInFileNames();

} // namespace gw
