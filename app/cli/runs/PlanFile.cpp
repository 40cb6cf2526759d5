#include "PlanFile.h"

#include "Paths.h"
#include "SystemError.h"
#include "Text.h"
#include "Words.h"

namespace gw {

namespace {

// For these reasons, the sentences about plans differ from those about motion files.
std::string PlanWords(const std::string& path, const Finding& failure)
{
    const std::string place = path + ':' + std::to_string(failure.where);
    switch (failure.reason)
    {
    case EFailure::BadHeader:
        return path + ": this is not a plan; create one with 'gaitwright plan'";
    case EFailure::TooDeep:
        return place + ": this line is nested too deeply for a plan; create the plan again";
    case EFailure::UnexpectedLine:
        return place + ": this line is not a valid plan entry; create the plan again";
    default:
        return path + ": the plan cannot be read" + SystemErrorWords(failure.systemError);
    }
}

} // namespace

bool LoadPlan(const std::string& path, CRunPlan& plan)
{
    if (const Finding failure = ReadPlan(path, plan))
        SayError({}, "unreadable-plan", PlanWords(Printable(path), failure));
    else if (plan.version != GAITWRIGHT_VERSION)
        SayError(path, "plan-version",
                 "version " + Printable(plan.version) + " made this plan, and this is version " +
                     GAITWRIGHT_VERSION + "; create it again, because results could differ");
    else
        return true;
    return false;
}

std::string ShardReport(const std::string& planPath, size_t shard)
{
    const PathParts parts = SplitPath(planPath);
    return parts.folder + parts.stem + ".shard-" + std::to_string(shard) + ".jsonl";
}

} // namespace gw
