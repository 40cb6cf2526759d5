#pragma once

#include "Mat3.h"

#include <array>
#include <string_view>

namespace gw {

/// The source axis for each target axis: 1, 2, 3 are X, Y, Z; negative numbers are reversed axes.
using AxisCodes = std::array<int, 3>;

/// No conversion.
inline constexpr AxisCodes kNeutralAxes{1, 2, 3};

/// Returns the code of a text such as " X" or "-y", ignoring case; 0 for anything else.
int AxisCodeOf(std::string_view text);
/// Returns " X" for 1, "-X" for -1 and so on; empty for 0 and for codes outside -3 to 3. The leading blank is
/// part of the text.
std::string_view AxisText(int code);
/// Returns the signed permutation whose row r has 1 or -1 in the column of code r. The row of an invalid code
/// is zero.
Mat3 AxisMatrix(const AxisCodes& codes);

} // namespace gw
