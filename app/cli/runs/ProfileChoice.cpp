#include "ProfileChoice.h"

#include "CJsonWriter.h"
#include "CReport.h"
#include "FitWords.h"
#include "ProfileFit.h"
#include "Words.h"

namespace gw {

CReport NoneFitsReport(const std::string& source, const CProfileFit& nearest)
{
    CReport report = MisfitReport(source, nearest);
    report.words = nearest.rowCount == 0 ? "no profile is installed; name one with --profile FILE"
                                         : "no installed profile fits; the closest is " + report.words;
    return report;
}

void WriteFit(CJsonWriter& json, const CProfileFit& fit)
{
    json.Key("fits").Bool(fit.IsWhole());
    json.Key("rows").Integer(fit.rowCount);
    json.Key("found").Integer(fit.foundCount);
    json.Key("drivesRoot").Bool(fit.drivesRoot);
    json.Key("missing").BeginArray();
    for (const MissingBone& missing : fit.missing)
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
