#include "CConversionRun.h"
#include "CommandTable.h"
#include "OptionJson.h"
#include "Output.h"
#include "Paths.h"
#include "PlanFile.h"
#include "RunSetup.h"
#include "Text.h"
#include "Words.h"

namespace gw {

namespace {

// A shard can be run repeatedly: it continues after failures and skips what is done.
bool TakePlan(const CRunPlan& plan, size_t shard, ShellOptions& options)
{
    std::string wrong;
    const std::string planPath = options.files[0];
    if (!ReadOptionsJson(plan.options, ~kHowToRun, options, wrong))
    {
        Notice notice =
            MakeNotice(planPath, "plan-option", "the plan has an unknown option: " + Quoted(wrong));
        notice.where = 1;
        SayNotice(options, notice);
        return false;
    }
    if (IsSameFile(options.report, planPath))
    {
        SayError(options.report, "own-source", "this is the plan; choose another file for the report");
        return false;
    }
    options.files.clear();
    options.outputFolder = plan.outputFolder;
    options.keepGoing = true;
    options.resume = true;
    if (options.report.empty())
        options.report = ShardReport(planPath, shard);
    return true;
}

RunState ShardState(const CRunPlan& plan, const std::string& planPath, size_t shard)
{
    const std::string folder = plan.outputFolder.empty() ? SplitPath(planPath).folder : plan.outputFolder;
    return {WithSeparator(folder), "shard-" + std::to_string(shard)};
}

bool HasShard(const CRunPlan& plan, int64_t shard)
{
    if (static_cast<uint64_t>(shard) < plan.shardCount)
        return true;
    SayError("unknown shard " + std::to_string(shard) + "; the plan has shards 0 to " +
             std::to_string(plan.shardCount - 1));
    return false;
}

} // namespace

EExit RunShard(const ShellOptions& given)
{
    CRunPlan plan;
    if (!IsRunPossible(given))
        return EExit::Usage;
    if (!LoadPlan(given.files[0], plan))
        return EExit::Failed;
    if (!HasShard(plan, *given.shard))
        return EExit::Usage;
    const auto shard = static_cast<size_t>(*given.shard);
    ShellOptions options = given;
    if (!TakePlan(plan, shard, options) || !MakeOutputFolder(options))
        return EExit::Failed;
    CFileRun::Jobs jobs;
    for (CRunPlan::Entry& entry : plan.Shard(shard))
        jobs.push_back({std::move(entry.source), std::move(entry.output), std::move(entry.clip)});
    return CConversionRun(options, std::move(jobs), ShardState(plan, given.files[0], shard)).RunAll();
}

} // namespace gw
