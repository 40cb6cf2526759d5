#pragma once

#include "CJsonMembers.h"

#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CFailureRecord;
class CJsonWriter;
struct CReport;

/// Reports as the members "failures" and "warnings".
void WriteReports(CJsonWriter& json, const std::vector<CReport>& reports);
/// What a reader kept, as the same members.
void WriteRecord(CJsonWriter& json, const std::string& path, const CFailureRecord& record);
/// Takes the reports back out of an object with those members, behind what is there already. False where the
/// text is no JSON object.
bool ReadReports(std::string_view text, std::vector<CReport>& reports);
/// Takes the output and the outcome from a line of a run's report. NotJson for any other line.
EJsonFault ReadReportLine(std::string_view text, std::string& output, std::string& outcome);

} // namespace gw
