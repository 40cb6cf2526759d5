#pragma once

#include <string>
#include <string_view>

namespace gw {

struct ShellOptions;

/// Returns the extension of a result by the option --format; ".Kinetra" without it.
std::string_view ResultExtension(const ShellOptions& options);
/// Same for an output that may be a pipe: without --format, its name decides.
std::string_view ResultExtension(const ShellOptions& options, const std::string& output);

} // namespace gw
