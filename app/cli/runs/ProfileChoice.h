#pragma once

namespace gw {

class CJsonWriter;
struct CProfileFit;
struct ProfileVerdict;

/// Writes a fit as members of an open JSON object.
void WriteFit(CJsonWriter& json, const CProfileFit& fit);

/// Writes confidence and doubts as members of an open JSON object.
void WriteVerdict(CJsonWriter& json, const ProfileVerdict& verdict);

} // namespace gw
