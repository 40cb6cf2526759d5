#pragma once

#include "CJsonMembers.h"

#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CFailureRecord;
class CJsonWriter;
struct CReport;

/// Writes reports as the members "failures" and "warnings".
void WriteReports(CJsonWriter& json, const std::vector<CReport>& reports);
/// Writes a reader's failures and warnings as the same members.
void WriteRecord(CJsonWriter& json, const std::string& path, const CFailureRecord& record);
/// Appends the reports of an object with those members. Returns false if the text is not a JSON object.
bool ReadReports(std::string_view text, std::vector<CReport>& reports);
/// Reads the output and the outcome from a line of a run's report. Returns NotJson for any other line.
EJsonFault ReadReportLine(std::string_view text, std::string& output, std::string& outcome);

} // namespace gw
