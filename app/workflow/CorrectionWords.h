#pragma once

#include <string>

namespace gw {

struct Corrections;
enum class ECorrection : unsigned char;

/// Returns the short fixed word for what an alignment corrects: "bone-frame".
const char* CorrectionCode(ECorrection kind);
/// Returns how many of each kind were corrected: "4 bones off their axes at rest, 2 rotated frames of slanted
/// bones".
std::string CorrectionWords(const Corrections& corrections);

} // namespace gw
