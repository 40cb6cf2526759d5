#pragma once

#include <string>

namespace gw {

class CJsonWriter;
struct CProfileFit;
struct Notice;
struct ProfileVerdict;

/// Returns the notice that no installed profile fits a source, with the closest one; `nearest` without rows
/// means that none is installed.
Notice NoneFitsNotice(const std::string& source, const CProfileFit& nearest);
/// Writes the same as members of a JSON object.
void WriteFit(CJsonWriter& json, const CProfileFit& fit);

/// Writes sureness and doubts as members of a JSON object.
void WriteVerdict(CJsonWriter& json, const ProfileVerdict& verdict);

} // namespace gw
