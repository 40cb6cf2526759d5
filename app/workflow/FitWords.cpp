#include "FitWords.h"

#include "HostBones.h"
#include "Notice.h"
#include "ProfileFit.h"
#include "Text.h"

namespace gw {

namespace {

std::string MissingLine(const MissingBone& missing)
{
    const std::string place = missing.line == 0 ? "" : "line " + std::to_string(missing.line) + ": ";
    const std::string nearest =
        missing.nearest.empty() ? "; no similar name found" : "; the closest is " + Quoted(missing.nearest);
    return "  " + place + "the " + SideName(missing.side) + " has no bone " + Quoted(missing.name) + nearest;
}

} // namespace

const char* SideName(ESkeletonSide side)
{
    return side == ESkeletonSide::Source ? "source" : "target";
}

std::string FitSummary(const CProfileFit& fit)
{
    if (fit.foundCount != fit.rowCount)
        return std::to_string(fit.foundCount) + " of " + std::to_string(fit.rowCount) + " rows match";
    return std::to_string(fit.rowCount) + " rows, all match";
}

std::string MissingLines(const CProfileFit& fit)
{
    std::string lines;
    for (const MissingBone& missing : fit.missing)
    {
        lines += lines.empty() ? "" : "\n";
        lines += MissingLine(missing);
    }
    if (!fit.drivesRoot && fit.missing.empty())
        lines = "  no row drives the target's root bone " + Quoted(kRootBone);
    return lines;
}

Notice MisfitNotice(const std::string& source, const CProfileFit& fit)
{
    const std::string summary = "profile " + Quoted(fit.name) + ": " + FitSummary(fit);
    return MakeNotice(source, "misfit", summary + '\n' + MissingLines(fit));
}

} // namespace gw
