#pragma once

#include <cstddef>
#include <span>
#include <string>
#include <string_view>

namespace gw {

/// What a target does with one input: reads it, and where it can be read, holds it against the promises. Each
/// target defines this once.
void FuzzOne(std::span<const std::byte> input);

/// Ends the program unless a promise holds, as a crash that whoever runs it keeps the input of.
void Require(bool holds, const char* promise);

/// The text of an input.
std::string_view TextOf(std::span<const std::byte> input);
/// A path in the folder of this run, which goes with the program.
std::string ScratchPath(std::string_view name);
/// Replaces a file in that folder and answers its path.
std::string ScratchFile(std::string_view name, std::span<const std::byte> bytes);

} // namespace gw
