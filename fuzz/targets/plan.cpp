// The plan of a run: plans that were read must survive being written and read again, and their options are
// accepted or refused.

#include "CRunPlan.h"
#include "FuzzTarget.h"
#include "OptionJson.h"

#include <algorithm>

namespace gw {

namespace {

bool IsSameEntry(const CRunPlan::Entry& a, const CRunPlan::Entry& b)
{
    return a.source == b.source && a.output == b.output && a.byteCount == b.byteCount && a.shard == b.shard;
}

// Options that were accepted must be accepted again in their shorter form, without values that are defaults.
void CheckOptions(const std::string& text)
{
    ShellOptions first, second;
    std::string wrong;
    if (!ReadOptionsJson(text, ~uint64_t{0}, first, wrong))
        return;
    const std::string written = OptionsJson(first, ~uint64_t{0});
    Require(ReadOptionsJson(written, ~uint64_t{0}, second, wrong), "options that were taken are taken again");
    Require(OptionsJson(second, ~uint64_t{0}) == written, "options survive a plan");
}

} // namespace

void FuzzOne(std::span<const std::byte> input)
{
    CRunPlan first, second;
    if (ReadPlan(ScratchFile("plan.jsonl", input), first))
        return;
    for (const CRunPlan::Entry& entry : first.entries)
        Require(entry.shard < first.shardCount, "every source has a shard");
    CheckOptions(first.options);
    const std::string again = ScratchPath("again.jsonl");
    Require(WritePlan(again, first), "a plan can be written");
    Require(!ReadPlan(again, second), "a plan that was written can be read");
    Require(second.options == first.options && second.version == first.version &&
                second.outputFolder == first.outputFolder && second.shardCount == first.shardCount,
            "the head survives");
    Require(std::ranges::equal(first.entries, second.entries, IsSameEntry), "the sources survive");
}

} // namespace gw
