#pragma once

#include "Finding.h"
#include "Text.h"

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

namespace gw {

/// Returns the number of tokens in a text.
size_t CountTokens(std::string_view text, std::string_view delimiters = kTokenDelimiters);

/// Returns whether the commas of a text are clearly decimal commas: each is between two digits, and the text
/// has the required number of values only if commas do not separate.
bool HasDecimalCommas(std::string_view text, size_t valueCount);
/// Returns a copy with points in place of commas.
std::string WithPoints(std::string_view text);

/// Returns what is wrong with a token that should be a 32-bit number: NaN for anything not finite, in all the
/// spellings that programs print, or StuckNumber. Nothing for a plain number.
std::optional<EFailure> FailureOfNumber(std::string_view token);

} // namespace gw
