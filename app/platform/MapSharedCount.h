#pragma once

#include <cstdint>
#include <memory>
#include <string>

namespace gw {

/// Returns the system's name of a word of memory that the user's processes share.
std::string SharedCountName(const std::string& name);
/// Opens the word with such a name; new ones are 0. Returns memory of this process if it cannot be shared.
std::shared_ptr<int32_t> MapSharedCount(const std::string& sharedName);

} // namespace gw
