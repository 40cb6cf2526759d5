#include "FitWords.h"

#include "CJsonWriter.h"
#include "CReport.h"
#include "HostBones.h"
#include "ProfileFit.h"
#include "Words.h"

#include <tuple>

namespace gw {

namespace {

const char* SideName(ESkeletonSide side)
{
    return side == ESkeletonSide::Source ? "source" : "target";
}

std::string MissingLine(const CMissingBone& missing)
{
    const std::string place = missing.line == 0 ? "" : "line " + std::to_string(missing.line) + ": ";
    const std::string nearest =
        missing.nearest.empty() ? "; no name is near" : "; the nearest is " + Quoted(missing.nearest);
    return "  " + place + "the " + SideName(missing.side) + " has no bone " + Quoted(missing.name) + nearest;
}

// Larger is better.
auto Rank(const CProfileFit& fit)
{
    const bool whole = fit.IsWhole();
    return std::tuple(whole, whole ? 0 : fit.foundCount - fit.rowCount, fit.rowCount);
}

} // namespace

bool IsBetterFit(const CProfileFit& fit, const CProfileFit& other)
{
    return other.rowCount == 0 || Rank(fit) > Rank(other);
}

std::string FitSummary(const CProfileFit& fit)
{
    if (fit.foundCount != fit.rowCount)
        return std::to_string(fit.foundCount) + " of " + std::to_string(fit.rowCount) + " rows fit";
    return std::to_string(fit.rowCount) + " rows, all fit";
}

std::string MissingLines(const CProfileFit& fit)
{
    std::string lines;
    for (const CMissingBone& missing : fit.missing)
    {
        lines += lines.empty() ? "" : "\n";
        lines += MissingLine(missing);
    }
    if (!fit.drivesRoot && fit.missing.empty())
        lines = "  no row drives the target's root bone " + Quoted(kRootBone);
    return lines;
}

CReport MisfitReport(const std::string& source, const CProfileFit& fit)
{
    return ShellFailure(source, "misfit",
                        "profile " + Quoted(fit.name) + ": " + FitSummary(fit) + '\n' + MissingLines(fit));
}

CReport NoneFitsReport(const std::string& source, const CProfileFit& nearest)
{
    CReport report = MisfitReport(source, nearest);
    report.words = nearest.rowCount == 0 ? "no profile is installed; name one with --profile FILE"
                                         : "no installed profile fits; nearest comes " + report.words;
    return report;
}

void WriteFit(CJsonWriter& json, const CProfileFit& fit)
{
    json.Key("fits").Bool(fit.IsWhole());
    json.Key("rows").Integer(fit.rowCount);
    json.Key("found").Integer(fit.foundCount);
    json.Key("drivesRoot").Bool(fit.drivesRoot);
    json.Key("missing").BeginArray();
    for (const CMissingBone& missing : fit.missing)
    {
        json.BeginObject();
        json.Key("side").Text(SideName(missing.side));
        json.Key("bone").Text(missing.name);
        json.Key("nearest").Text(missing.nearest);
        json.Key("line").Integer(static_cast<int64_t>(missing.line));
        json.EndObject();
    }
    json.EndArray();
}

} // namespace gw
