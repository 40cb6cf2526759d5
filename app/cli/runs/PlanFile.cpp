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
        return path + ": this is no plan; 'gaitwright plan' makes one";
    const std::string place = path + ':' + std::to_string(line);
    if (fault == EPlanFault::TooDeep)
        return place + ": this line is nested deeper than a plan can be; make the plan again";
    return place + ": this line is no source of a plan; make the plan again";
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
                 "; make it again, or results would differ");
    else
        return true;
    return false;
}

std::string ShardReport(const std::string& planPath, size_t shard)
{
    const CPathParts parts = SplitPath(planPath);
    return parts.folder + parts.stem + ".shard-" + std::to_string(shard) + ".jsonl";
}

} // namespace gw
