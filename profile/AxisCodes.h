#pragma once

#include "Mat3.h"

#include <array>
#include <string_view>

namespace gw {

/// One code for each target axis: the source axis that it takes. 1, 2, 3 are X, Y, Z; negative is the
/// reversed axis.
using AxisCodes = std::array<int, 3>;

/// No conversion.
inline constexpr AxisCodes kNeutralAxes{1, 2, 3};

/// The code of a text such as " X" or "-y", without regard to case; 0 for anything else.
int AxisCodeOf(std::string_view text);
/// " X" for 1, "-X" for -1 and so on; empty for 0 and for codes outside -3 to 3. The leading blank belongs to
/// the text.
std::string_view AxisText(int code);
/// The signed permutation whose row r has 1 or -1 in the column of code r. The row of a code that is none is
/// zero.
Mat3 AxisMatrix(const AxisCodes& codes);

} // namespace gw
