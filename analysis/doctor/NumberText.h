#pragma once

#include "Fault.h"
#include "Text.h"

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

namespace gw {

/// The number of tokens in a text.
size_t CountTokens(std::string_view text, std::string_view delimiters = kTokenDelimiters);

/// Whether the commas of a text are decimal commas without doubt: each stands between two digits, and without
/// them as separators the text holds the number of values that it must, with them more.
bool HasDecimalCommas(std::string_view text, size_t valueCount);
/// A copy with points for commas.
std::string WithPoints(std::string_view text);

/// What is wrong with a token where a 32-bit number must stand: NaN for what is not finite, in all the ways
/// in which programs print that, or StuckNumber. Nothing for a plain number.
std::optional<EFault> FaultOfNumber(std::string_view token);

} // namespace gw
