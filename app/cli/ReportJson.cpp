#include "ReportJson.h"

#include "CFailure.h"
#include "CJsonWriter.h"
#include "CReport.h"
#include "FailureWords.h"

namespace gw {

namespace {

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

} // namespace gw
