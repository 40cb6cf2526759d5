#include "ReportJson.h"

#include "CFailure.h"
#include "CJsonWriter.h"
#include "CReport.h"
#include "FailureWords.h"
#include "JsonText.h"

namespace gw {

namespace {

// As WriteReports has it. Most records are so; and what the library has parsed takes memory again when it is
// dropped, and ends the program where there is none.
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

CReport ReadReport(const nlohmann::ordered_json& json, bool warning)
{
    CReport report;
    report.warning = warning;
    TakeText(json, "path", report.path);
    TakeText(json, "code", report.code);
    TakeText(json, "name", report.name);
    TakeText(json, "words", report.words);
    const auto where = json.is_object() ? json.find("where") : json.end();
    if (where != json.end() && where->is_number_unsigned())
        report.where = where->get<size_t>();
    return report;
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
    const auto json = nlohmann::ordered_json::parse(text, nullptr, false);
    for (const bool warning : {false, true})
    {
        const auto found = json.is_object() ? json.find(warning ? "warnings" : "failures") : json.end();
        for (size_t i = 0; found != json.end() && found->is_array() && i < found->size(); ++i)
            reports.push_back(ReadReport((*found)[i], warning));
    }
    return json.is_object();
}

} // namespace gw
