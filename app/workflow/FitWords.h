#pragma once

#include <string>

namespace gw {

struct CProfileFit;
struct CReport;
enum class ESkeletonSide : unsigned char;

/// "source" or "target".
const char* SideName(ESkeletonSide side);
/// "23 rows, all fit" or "20 of 23 rows fit".
std::string FitSummary(const CProfileFit& fit);
/// What a profile misses, one line each, with the nearest names.
std::string MissingLines(const CProfileFit& fit);
/// Why a source is not converted by a profile: its code is "misfit".
CReport MisfitReport(const std::string& source, const CProfileFit& fit);

} // namespace gw
