#include "PlanFile.h"

#include "Paths.h"
#include "Text.h"
#include "Words.h"

namespace gw {

namespace {

std::string FaultWords(const std::string& path, EPlanFault fault, size_t line)
{
    if (fault == EPlanFault::Unreadable)
        return path + ": the plan cannot be read (check the path and the permissions)";
    if (fault == EPlanFault::NoPlan)
        return path + ": this is not a plan; create one with 'gaitwright plan'";
    const std::string place = path + ':' + std::to_string(line);
    if (fault == EPlanFault::TooDeep)
        return place + ": this line is nested too deeply for a plan; create the plan again";
    return place + ": this line is not a valid plan entry; create the plan again";
}

} // namespace

bool LoadPlan(const std::string& path, CRunPlan& plan)
{
    size_t line = 0;
    const EPlanFault fault = ReadPlan(path, plan, line);
    if (fault != EPlanFault::None)
        SayError(FaultWords(Printable(path), fault, line));
    else if (plan.version != GAITWRIGHT_VERSION)
        SayError(Printable(path) + ": version " + Printable(plan.version) +
                 " made this plan, and this is version " + GAITWRIGHT_VERSION +
                 "; create it again, because results could differ");
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
