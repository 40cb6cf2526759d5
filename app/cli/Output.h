#pragma once

#include "COptions.h"

#include <string>

namespace gw {

/// Whether something stands under a path already.
bool IsTaken(const std::string& path);
/// Whether a command may write a file: it is not there, or --force stands and it is a file. Says why not.
bool MayWrite(const COptions& options, const std::string& path);
/// Tells on standard output what was made of what. Answers Done.
EExit TellWritten(const COptions& options, const std::string& source, const std::string& output);

} // namespace gw
