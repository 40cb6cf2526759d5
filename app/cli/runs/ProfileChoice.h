#pragma once

#include <string>

namespace gw {

class CJsonWriter;
struct CProfileFit;
struct Notice;
struct ProfileVerdict;

/// Returns the notice that no installed profile fits a source. It names the closest one; if `nearest` has no
/// rows, it says that none is installed.
Notice NoneFitsNotice(const std::string& source, const CProfileFit& nearest);
/// Writes a fit as members of an open JSON object.
void WriteFit(CJsonWriter& json, const CProfileFit& fit);

/// Writes confidence and doubts as members of an open JSON object.
void WriteVerdict(CJsonWriter& json, const ProfileVerdict& verdict);

} // namespace gw
