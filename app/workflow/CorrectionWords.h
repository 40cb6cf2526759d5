#pragma once

#include <string>

namespace gw {

struct Corrections;
enum class ECorrection : unsigned char;

/// Returns the fixed short code of a kind of correction: "bone-frame".
const char* CorrectionCode(ECorrection kind);
/// Returns the number of corrections of each kind as text: "4 bones off their axes at rest, 2 rotated frames
/// of slanted bones".
std::string CorrectionWords(const Corrections& corrections);

} // namespace gw
