#pragma once

#include <string>

namespace gw {

class CJsonWriter;
struct CProfileFit;
struct CReport;

/// Whether a profile fits a source better than another: one of which all rows fit goes before one of which
/// not, more rows before fewer, and of those that do not fit the one that misses less.
bool IsBetterFit(const CProfileFit& fit, const CProfileFit& other);

/// Why a source is converted by no installed profile, with the one that comes nearest; without rows none is
/// installed.
CReport NoneFitsReport(const std::string& source, const CProfileFit& nearest);
/// The same as members of a JSON object.
void WriteFit(CJsonWriter& json, const CProfileFit& fit);

} // namespace gw
