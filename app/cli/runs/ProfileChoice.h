#pragma once

#include <string>

namespace gw {

class CJsonWriter;
struct CProfileFit;
struct CReport;

/// Why a source is converted by no installed profile, with the one that comes nearest; without rows none is
/// installed.
CReport NoneFitsReport(const std::string& source, const CProfileFit& nearest);
/// The same as members of a JSON object.
void WriteFit(CJsonWriter& json, const CProfileFit& fit);

} // namespace gw
