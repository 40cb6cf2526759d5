#include "ProfileChoice.h"

#include "CJsonWriter.h"
#include "ChooseProfile.h"
#include "DoubtWords.h"
#include "FitWords.h"
#include "ProfileFit.h"

namespace gw {

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

void WriteVerdict(CJsonWriter& json, const ProfileVerdict& verdict)
{
    json.Key("sureness").Text(SurenessName(verdict.sureness));
    json.Key("spineJointsLeftOut").Integer(static_cast<int64_t>(verdict.leftOut));
    json.Key("turn").Number(static_cast<float>(verdict.turn));
    json.Key("doubts").BeginArray();
    for (const ProfileDoubt& doubt : verdict.doubts)
    {
        json.BeginObject();
        json.Key("kind").Text(DoubtCode(doubt.kind));
        json.Key("joint").Text(doubt.joint);
        json.Key("other").Text(doubt.other);
        json.Key("words").Text(DoubtSentence(doubt));
        json.EndObject();
    }
    json.EndArray();
}

} // namespace gw
