#pragma once

#include <cstddef>
#include <span>
#include <string>
#include <string_view>

namespace gw {

/// Processes one input: reads it and, if that succeeds, checks the promises. Each target defines this once.
void FuzzOne(std::span<const std::byte> input);

/// Ends the program if a promise does not hold. The fuzzer treats that as a crash and keeps the input.
void Require(bool holds, const char* promise);

/// Returns the text of an input.
std::string_view TextOf(std::span<const std::byte> input);
/// Returns a path in the folder of this run, which is deleted at the end.
std::string ScratchPath(std::string_view name);
/// Writes a file in that folder and returns its path.
std::string ScratchFile(std::string_view name, std::span<const std::byte> bytes);

} // namespace gw
