#pragma once

#include <string>
#include <string_view>

namespace gw {

/// Converts between UTF-8 and the system's UTF-16. What is not valid is replaced.
std::wstring WideText(std::string_view text);
std::string NarrowText(std::wstring_view text);

} // namespace gw
