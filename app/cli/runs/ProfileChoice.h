#pragma once

#include <string>

namespace gw {

class CJsonWriter;
struct CProfileFit;
struct CReport;

/// Returns the report that no installed profile fits a source, with the closest one; `nearest` without rows
/// means that none is installed.
CReport NoneFitsReport(const std::string& source, const CProfileFit& nearest);
/// Writes the same as members of a JSON object.
void WriteFit(CJsonWriter& json, const CProfileFit& fit);

} // namespace gw
