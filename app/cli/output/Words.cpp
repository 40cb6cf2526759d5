#include "Words.h"

#include "CFailure.h"
#include "CReport.h"
#include "FailureWords.h"
#include "ShellOptions.h"
#include "Text.h"

#include <cstdio>

namespace gw {

void SayError(std::string_view words)
{
    // One write per line, so that lines of several programs on one terminal do not mix.
    const std::string line = "gaitwright: " + std::string(words) + '\n';
    std::fwrite(line.data(), 1, line.size(), stderr);
}

bool Refuse(std::string_view words)
{
    SayError(words);
    return false;
}

void SayWord(const ShellOptions& options, std::string_view words)
{
    if (!options.quiet)
        SayError(words);
}

void SayReport(const ShellOptions& options, const CReport& report)
{
    if (report.warning)
        SayWord(options, "warning: " + ReportLine(report));
    else
        SayError(ReportLine(report));
}

CReport ShellFailure(const std::string& path, const char* code, const std::string& words)
{
    CReport report;
    report.path = path;
    report.code = code;
    report.words = words;
    return report;
}

void SayFailure(const std::string& path, const CFailure& failure)
{
    SayError(ReportLine(MakeReport(path, failure, false)));
}

void SayWarnings(const ShellOptions& options, const std::string& path, const CFailureRecord& record)
{
    for (const CFailure& warning : record.Warnings())
        SayReport(options, MakeReport(path, warning, true));
}

void SayDamage(const std::string& path, const CFailure& failure)
{
    const std::string place = failure.where == 0 ? "" : " at byte " + std::to_string(failure.where);
    SayError(Printable(path) + ": damaged" + place + ": " + MakeReport(path, failure, false).words);
}

} // namespace gw
