#include "FindingWords.h"

#include "CFindings.h"
#include "FailureWords.h"
#include "MotionFacts.h"
#include "Text.h"

#include <cstdio>

namespace gw {

namespace {

std::string FailureSentence(const std::string& path, const Finding& finding)
{
    const CReport report = MakeReport(path, {finding.reason, finding.where, finding.name}, false);
    const std::string remedy = " (" + std::string(FailureRemedy(finding.reason)) + ')';
    const std::string_view words = report.words;
    return std::string(words.ends_with(remedy) ? words.substr(0, words.size() - remedy.size()) : words);
}

std::string FaultSentence(const Finding& finding)
{
    std::string words(RowOf(finding.fault).words);
    if (!finding.name.empty())
        words += ": \"" + Printable(finding.name) + '"';
    return words;
}

// Returns a number as people write it: "29.97", "30".
std::string Short(double number)
{
    char text[32];
    std::snprintf(text, sizeof(text), "%.4g", number);
    return text;
}

std::string Counted(size_t count, const char* what)
{
    return std::to_string(count) + ' ' + what + (count == 1 ? "" : "s");
}

} // namespace

std::string_view FindingCode(const Finding& finding)
{
    return finding.fault == EFault::Reader ? FailureCode(finding.reason) : RowOf(finding.fault).code;
}

std::string_view FindingRemedy(const Finding& finding)
{
    return finding.fault == EFault::Reader ? FailureRemedy(finding.reason) : RowOf(finding.fault).remedy;
}

std::string FindingWords(const std::string& path, const Finding& finding)
{
    std::string words =
        finding.fault == EFault::Reader ? FailureSentence(path, finding) : FaultSentence(finding);
    if (finding.more > 0)
        words += ", and " + std::to_string(finding.more) + " more";
    return words;
}

std::string FindingLine(const std::string& path, const Finding& finding)
{
    CReport report;
    report.path = path;
    report.where = finding.where;
    report.words = std::string(FindingCode(finding)) + ": " + FindingWords(path, finding);
    if (const std::string_view remedy = FindingRemedy(finding); !remedy.empty())
        report.words += " (" + std::string(remedy) + ')';
    return ReportLine(report);
}

std::string FactsLine(const MotionFacts& facts)
{
    std::string line = Counted(facts.jointCount, "joint") + ", " + Counted(facts.frameCount, "frame") +
                       " at " + Short(1.0 / facts.frameSeconds) + " per second";
    if (facts.leg > 0.0)
    {
        const std::string unit = facts.unit.empty() ? "an unknown unit" : std::string(facts.unit);
        line += ", legs of " + Short(facts.leg) + " (" + unit + ')';
    }
    if (!facts.up.empty())
        line += ", " + std::string(facts.up) + " up";
    line += ", rest pose: " + std::string(RestPoseName(facts.restPose));
    return line + ", body by: " + std::string(BodySourceName(facts.body));
}

} // namespace gw
