#pragma once

#include "CByteSink.h"
#include "Failures.h"
#include "gaitwright/gaitwright.h"

#include <cstddef>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

namespace gaitwright {

/// Writes a file; returns a failure if that fails.
using Writer = std::function<Outcome<void>(const std::string& path)>;

/// Writes a file, unless one exists that must not be replaced.
Outcome<void> WriteFile(const std::string& path, Existing existing, const Writer& write);
/// Returns the bytes that a writer writes to a file with this extension.
Outcome<std::vector<std::byte>> BytesOf(std::string_view extension, const Writer& write);

/// Writes a file atomically with the text that a function sends to a sink.
Outcome<void> WriteText(const std::string& path, const std::function<bool(const gw::CTextSink&)>& send);

/// Returns a format as an extension with a dot, in lower case.
std::string ExtensionOf(std::string_view format);

} // namespace gaitwright
