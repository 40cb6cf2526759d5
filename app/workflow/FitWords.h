#pragma once

#include <string>

namespace gw {

struct CProfileFit;
struct Notice;
enum class ESkeletonSide : unsigned char;

/// Returns "source" or "target".
const char* SideName(ESkeletonSide side);
/// Returns "23 rows, all fit" or "20 of 23 rows fit".
std::string FitSummary(const CProfileFit& fit);
/// Returns the missing bones of a profile, one line each, with the closest names.
std::string MissingLines(const CProfileFit& fit);
/// Returns why a profile does not fit a source; the notice's code is "misfit".
Notice MisfitNotice(const std::string& source, const CProfileFit& fit);
/// Returns the notice that no installed profile fits a source. It names the closest one; if `nearest` has no
/// rows, it says that none is installed.
Notice NoneFitsNotice(const std::string& source, const CProfileFit& nearest);

} // namespace gw
