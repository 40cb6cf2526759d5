#include "FitWords.h"

#include "HostBones.h"
#include "Notice.h"
#include "ProfileFit.h"
#include "Text.h"

#include <algorithm>
#include <span>
#include <vector>

namespace gw {

namespace {

std::string MissingLine(const MissingBone& missing)
{
    const std::string place = missing.line == 0 ? "" : "line " + std::to_string(missing.line) + ": ";
    const std::string nearest =
        missing.nearest.empty() ? "; no similar name found" : "; the closest is " + Quoted(missing.nearest);
    return "  " + place + "the " + SideName(missing.side) + " has no bone " + Quoted(missing.name) + nearest;
}

std::string Lines(std::span<const MissingBone> bones)
{
    std::string lines;
    for (const MissingBone& missing : bones)
    {
        lines += lines.empty() ? "" : "\n";
        lines += MissingLine(missing);
    }
    return lines;
}

// Returns the three rows that are closest to matching, and the number of the others.
std::string NearestLines(const CProfileFit& fit)
{
    constexpr size_t kNamed = 3;
    std::vector<MissingBone> bones = fit.missing;
    std::stable_partition(bones.begin(), bones.end(),
                          [](const MissingBone& bone) { return !bone.nearest.empty(); });
    const size_t named = std::min(bones.size(), kNamed);
    const std::string lines = Lines(std::span(bones).first(named));
    return bones.size() == named ? lines
                                 : lines + "\n  and " + std::to_string(bones.size() - named) + " more";
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
    if (!fit.drivesRoot && fit.missing.empty())
        return "  no row drives the target's root bone " + Quoted(kRootBone);
    return Lines(fit.missing);
}

Notice MisfitNotice(const std::string& source, const CProfileFit& fit)
{
    const std::string summary = "bone map " + Quoted(fit.name) + ": " + FitSummary(fit);
    const std::string lines = fit.missing.empty() ? MissingLines(fit) : NearestLines(fit);
    return MakeNotice(source, "misfit", summary + '\n' + lines);
}

Notice NoneFitsNotice(const std::string& source, const CProfileFit& nearest)
{
    Notice notice = MisfitNotice(source, nearest);
    notice.words = nearest.rowCount == 0 ? "no profile is installed; name one with --profile FILE"
                                         : "no installed profile fits; the closest is " + notice.words;
    return notice;
}

} // namespace gw
