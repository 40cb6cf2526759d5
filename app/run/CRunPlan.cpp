// Plans divide a run into shards of about equal work, estimated from file sizes: largest first, each to the
// shard with the least work so far.

#include "CRunPlan.h"

#include "CJsonMembers.h"
#include "CMappedFile.h"
#include "CSafeFile.h"
#include "JsonText.h"
#include "SystemError.h"
#include "Text.h"

#include <algorithm>
#include <functional>
#include <numeric>
#include <queue>

namespace gw {

namespace {

constexpr uint64_t kPlanVersion = 1;
// The fixed cost of a file (opening, syncing, the skeleton), as an equivalent number of bytes.
constexpr uint64_t kFileCost = 16'384;
constexpr size_t kShardLimit = 1'000'000;

bool TakeHead(const CJsonMembers& json, CRunPlan& plan)
{
    uint64_t planVersion = 0;
    uint64_t shardCount = 0;
    if (!json.TakeCount("plan", planVersion) || planVersion != kPlanVersion ||
        !json.TakeText("version", plan.version) || !json.TakeText("outputFolder", plan.outputFolder) ||
        !json.TakeCount("shards", shardCount) || shardCount == 0 || shardCount > kShardLimit)
        return false;
    plan.shardCount = shardCount;
    const CJsonMembers::Member* const options = json.Find("options");
    plan.options = options ? options->text : "{}";
    return !options || options->kind == CJsonMembers::EKind::Nested;
}

bool TakeEntry(const CJsonMembers& json, CRunPlan& plan)
{
    CRunPlan::Entry entry;
    uint64_t shard = 0;
    if (!json.TakeText("source", entry.source) || !json.TakeText("output", entry.output) ||
        !json.TakeCount("shard", shard) || shard >= plan.shardCount ||
        !json.TakeCount("bytes", entry.byteCount))
        return false;
    entry.shard = shard;
    json.TakeText("clip", entry.clip);
    plan.entries.push_back(std::move(entry));
    return true;
}

} // namespace

// Largest first, each to the shard with the least work: no shard gets more than a third above the optimum
// (Graham 1969).
void CRunPlan::Share()
{
    using Load = std::pair<uint64_t, size_t>; // work, shard
    std::priority_queue<Load, std::vector<Load>, std::greater<>> loads;
    for (size_t shard = 0; shard < shardCount; ++shard)
        loads.emplace(0, shard);
    std::vector<size_t> order(entries.size());
    std::iota(order.begin(), order.end(), size_t{0});
    std::ranges::stable_sort(order, std::greater<>(), [&](size_t i) { return entries[i].byteCount; });
    for (const size_t i : order)
    {
        const auto [work, shard] = loads.top();
        loads.pop();
        entries[i].shard = shard;
        loads.emplace(work + entries[i].byteCount + kFileCost, shard);
    }
}

std::vector<CRunPlan::Entry> CRunPlan::Shard(size_t shard) const
{
    std::vector<Entry> own;
    std::ranges::copy_if(entries, std::back_inserter(own),
                         [=](const Entry& entry) { return entry.shard == shard; });
    return own;
}

bool WritePlan(const std::string& path, const CRunPlan& plan)
{
    CSafeFile file;
    bool good = file.Open(path) && file.Write(CJsonLine()
                                                  .Add("plan", kPlanVersion)
                                                  .Add("version", plan.version)
                                                  .Add("shards", plan.shardCount)
                                                  .Add("outputFolder", plan.outputFolder)
                                                  .AddJson("options", plan.options)
                                                  .Text() +
                                              '\n');
    for (const CRunPlan::Entry& entry : plan.entries)
    {
        CJsonLine line;
        line.Add("shard", entry.shard).Add("source", entry.source).Add("output", entry.output);
        if (!entry.clip.empty())
            line.Add("clip", entry.clip);
        good = good && file.Write(line.Add("bytes", entry.byteCount).Text() + '\n');
    }
    return good && file.Commit();
}

Finding ReadPlan(const std::string& path, CRunPlan& plan)
{
    CMappedFile file;
    if (const EFailure failure = file.Open(path); failure != EFailure::None)
        return {.reason = failure, .systemError = TakeSystemError()};
    std::string_view rest = file.Text();
    size_t line = 0;
    for (std::string_view text; NextLine(rest, text);)
    {
        ++line;
        CJsonMembers json;
        if (json.Read(text) == EFailure::TooDeep)
            return {EFailure::TooDeep, line};
        if (line == 1 && !TakeHead(json, plan))
            return {EFailure::BadHeader, line};
        if (line > 1 && !TakeEntry(json, plan))
            return {EFailure::UnexpectedLine, line};
    }
    return {line > 0 ? EFailure::None : EFailure::BadHeader};
}

} // namespace gw
