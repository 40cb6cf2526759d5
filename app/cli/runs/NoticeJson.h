#pragma once

#include "CJsonMembers.h"

#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CFailureRecord;
class CJsonWriter;
struct Notice;

/// Writes notices as the members "failures" and "warnings".
void WriteNotices(CJsonWriter& json, const std::vector<Notice>& notices);
/// Writes a reader's failures and warnings as members of the same names.
void WriteRecord(CJsonWriter& json, const std::string& path, const CFailureRecord& record);
/// Appends the notices from an object with these members. Returns false if the text is not a JSON object.
bool ReadNotices(std::string_view text, std::vector<Notice>& notices);
/// Reads the output and the outcome from a line of a run's report. Returns UnexpectedLine if the line is
/// anything else.
EFailure ReadReportLine(std::string_view text, std::string& output, std::string& outcome);

} // namespace gw
