#pragma once

#include <span>
#include <string>
#include <string_view>

namespace gw {

/// What follows the last colon of a name, or the name.
std::string_view WithoutNamespace(std::string_view name);

/// The start that a good part of the names have in common and that is no word of a joint: "Model_", "DEF-",
/// "J_Bip_", "mixamorig", "m". In lower case. Of all such starts the one without which most names say what
/// they are, empty where none helps. The names have no namespace any more.
std::string FindNamePrefix(std::span<const std::string_view> names);

/// A name without that prefix where it has it, without regard to case.
std::string_view WithoutPrefix(std::string_view name, std::string_view prefix);

} // namespace gw
