#include "ProfileChoice.h"

#include "CJsonWriter.h"
#include "CReport.h"
#include "FitWords.h"
#include "ProfileFit.h"
#include "Words.h"

#include <tuple>

namespace gw {

namespace {

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
