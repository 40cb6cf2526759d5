#pragma once

#include "JointWords.h"

#include <span>
#include <string>
#include <string_view>

namespace gw {

/// Returns the part of a name after its last colon, or the whole name.
std::string_view WithoutNamespace(std::string_view name);

/// Returns the start, in lower case, that many of the names share and that is not part of a joint's name:
/// "Model_", "DEF-", "J_Bip_", "mixamorig", "m". Of several, the one whose removal makes the most names
/// meaningful; empty if none helps. The names must have no namespace. `whole` is what they mean as they are.
std::string FindNamePrefix(std::span<const std::string_view> names, std::span<const JointName> whole);

/// Returns a name without that prefix, if it has it, ignoring case.
std::string_view WithoutPrefix(std::string_view name, std::string_view prefix);

} // namespace gw
