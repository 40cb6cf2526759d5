#pragma once

#include <string>
#include <string_view>

namespace gw {

/// The name of standard input as a source, and of standard output as a result.
inline constexpr std::string_view kStandardStream = "-";

/// Returns whether a path is standard input or output, or a pipe or device, named or by descriptor. Such a
/// source can be read only once, and such an output is never replaced by a file.
bool IsStream(const std::string& path);
/// Returns whether what is written to a path goes to standard output, where messages must not get between.
bool IsStandardOutput(const std::string& path);
/// Returns the stem of a source's file name, for the names of files made from it. Standard input has one
/// too.
std::string StemOf(const std::string& source);
/// Returns the path of a result. If the output is a folder, the result lies in it, under the source's stem
/// with an extension.
std::string InFolder(const std::string& output, const std::string& source, std::string_view extension);
/// Returns the extension of a motion or container, found in its first bytes; empty if the format is unknown.
std::string_view ExtensionOfContent(std::string_view start);

} // namespace gw
