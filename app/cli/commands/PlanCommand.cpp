// `plan`: lists the sources of a large run and divides them into shards for several machines.

#include "CJsonMembers.h"
#include "CJsonWriter.h"
#include "CRunPlan.h"
#include "CommandTable.h"
#include "ConversionJobs.h"
#include "JsonStatus.h"
#include "JsonText.h"
#include "OptionJson.h"
#include "Output.h"
#include "Paths.h"
#include "PlanFile.h"
#include "RunSetup.h"
#include "SystemError.h"
#include "Text.h"
#include "Words.h"

#include <algorithm>
#include <cstdio>

namespace gw {

namespace {

constexpr int64_t kShardLimit = 1'000'000;

// Plans are JSON, which cannot hold other names.
bool IsUtf8(const std::string& text)
{
    CJsonMembers json;
    std::string kept;
    json.Read(CJsonLine().Add("text", text).Text());
    return json.TakeText("text", kept) && kept == text;
}

bool MakePlan(const ShellOptions& options, const CFileRun::Jobs& jobs, CRunPlan& plan)
{
    plan.version = GAITWRIGHT_VERSION;
    plan.outputFolder = options.outputFolder;
    plan.options = OptionsJson(options, ~kHowToRun);
    plan.shardCount = static_cast<size_t>(*options.shards);
    for (const ConversionJob& job : jobs)
    {
        CRunPlan::Entry entry{.source = job.source, .output = job.output, .clip = job.clip};
        FileSize(job.source, entry.byteCount);
        if (!IsUtf8(entry.source) || !IsUtf8(entry.output))
        {
            SayError(job.source, "bad-name",
                     "the name is not valid UTF-8, which a plan needs; rename the file");
            return false;
        }
        plan.entries.push_back(std::move(entry));
    }
    plan.Share();
    return true;
}

void TellPlan(const ShellOptions& options, const CRunPlan& plan)
{
    if (options.json)
    {
        CJsonWriter json(stdout);
        json.BeginObject();
        WriteStatus(json, "ok");
        json.Key("plan").Text(options.output);
        json.Key("sources").Integer(static_cast<int64_t>(plan.entries.size()));
        json.Key("shards").Integer(static_cast<int64_t>(plan.shardCount));
        json.EndObject();
        json.EndDocument();
    }
    else if (!options.quiet)
    {
        std::printf("%s: %zu sources in %zu shards\n", Printable(options.output).c_str(), plan.entries.size(),
                    plan.shardCount);
    }
}

// Checked here, because otherwise a typo would show only when the shards run.
bool AreSourcesThere(const ShellOptions& options)
{
    for (const std::string& path : options.files)
    {
        if (IsTaken(path))
            continue;
        SayError(path, "not-found", "no such file or folder");
        return false;
    }
    return true;
}

bool AreShardsRight(const ShellOptions& options)
{
    const bool right = *options.shards >= 1 && *options.shards <= kShardLimit;
    if (!right)
        SayError("--shards must be a number from 1 to 1000000");
    return right;
}

} // namespace

EExit RunPlan(const ShellOptions& options)
{
    CFileRun::Jobs jobs;
    if (!AreShardsRight(options) || !IsRunPossible(options))
        return EExit::Usage;
    if (!AreSourcesThere(options))
        return EExit::Failed;
    if (const EExit listed = ListConversions(options, jobs); listed != EExit::Done)
        return listed;
    CRunPlan plan;
    if (!MayWrite(options, options.output) || !MakePlan(options, jobs, plan))
        return EExit::Failed;
    if (!WritePlan(options.output, plan))
    {
        SayError(options.output, "write-error", "the plan cannot be written" + TakeSystemErrorWords());
        return EExit::Failed;
    }
    TellPlan(options, plan);
    return EExit::Done;
}

} // namespace gw
