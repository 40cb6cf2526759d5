// Failures and warnings as JSON, and back. A run's parent process reads its workers' records this way.

#include "ReportJson.h"

#include "CFailure.h"
#include "CJsonMembers.h"
#include "CJsonWriter.h"
#include "CReport.h"
#include "FailureWords.h"

namespace gw {

namespace {

// Most records end like this, as WriteReports writes them, and need not be parsed.
constexpr std::string_view kNoReports = R"("failures":[],"warnings":[])";

void WriteReport(CJsonWriter& json, const CReport& report)
{
    json.BeginObject();
    json.Key("path").Text(report.path);
    json.Key("where").Integer(static_cast<int64_t>(report.where));
    json.Key("code").Text(report.code);
    json.Key("name").Text(report.name);
    json.Key("words").Text(report.words);
    json.EndObject();
}

CReport ReadReport(std::string_view text, bool warning)
{
    CJsonMembers json;
    json.Read(text);
    CReport report;
    report.warning = warning;
    json.TakeText("path", report.path);
    json.TakeText("code", report.code);
    json.TakeText("name", report.name);
    json.TakeText("words", report.words);
    uint64_t where = 0;
    if (json.TakeCount("where", where))
        report.where = where;
    return report;
}

// Returns the elements of an array member.
std::vector<CJsonMembers::Member> ReadList(const CJsonMembers& json, std::string_view key)
{
    CJsonMembers list;
    const CJsonMembers::Member* const member = json.Find(key);
    if (member && member->text.starts_with('[') && member->kind == CJsonMembers::EKind::Nested)
        list.Read(member->text);
    return list.Members();
}

} // namespace

void WriteReports(CJsonWriter& json, const std::vector<CReport>& reports)
{
    for (const bool warning : {false, true})
    {
        json.Key(warning ? "warnings" : "failures").BeginArray();
        for (const CReport& report : reports)
        {
            if (report.warning == warning)
                WriteReport(json, report);
        }
        json.EndArray();
    }
}

void WriteRecord(CJsonWriter& json, const std::string& path, const CFailureRecord& record)
{
    std::vector<CReport> reports;
    if (record.Failure())
        reports.push_back(MakeReport(path, record.Failure(), false));
    for (const CFailure& warning : record.Warnings())
        reports.push_back(MakeReport(path, warning, true));
    WriteReports(json, reports);
}

bool ReadReports(std::string_view text, std::vector<CReport>& reports)
{
    if (text.find(kNoReports) != text.npos)
        return true;
    CJsonMembers json;
    json.Read(text);
    for (const bool warning : {false, true})
    {
        for (const CJsonMembers::Member& report : ReadList(json, warning ? "warnings" : "failures"))
            reports.push_back(ReadReport(report.text, warning));
    }
    return json.IsObject();
}

EJsonFault ReadReportLine(std::string_view text, std::string& output, std::string& outcome)
{
    CJsonMembers json;
    const EJsonFault fault = json.Read(text);
    if (fault != EJsonFault::None)
        return fault;
    return json.TakeText("output", output) && json.TakeText("outcome", outcome) ? EJsonFault::None
                                                                                : EJsonFault::NotJson;
}

} // namespace gw
