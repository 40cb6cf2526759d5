#pragma once

#include <string>
#include <vector>

namespace gw {

class CFailureRecord;
class CJsonWriter;
struct CReport;

/// Reports as the members "failures" and "warnings".
void WriteReports(CJsonWriter& json, const std::vector<CReport>& reports);
/// What a reader kept, as the same members.
void WriteRecord(CJsonWriter& json, const std::string& path, const CFailureRecord& record);

} // namespace gw
