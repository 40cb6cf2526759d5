#include "CRunPlan.h"

#include "CMappedFile.h"
#include "CSafeFile.h"
#include "JsonText.h"
#include "Text.h"

#include <algorithm>
#include <functional>
#include <numeric>
#include <queue>

namespace gw {

namespace {

using Json = nlohmann::ordered_json;

constexpr int kPlanVersion = 1;
// What a file costs beside its bytes (opening, syncing, the skeleton), in bytes that take as long.
constexpr uint64_t kFileCost = 16'384;
constexpr size_t kShardLimit = 1'000'000;

bool TakeCount(const Json& json, const char* key, uint64_t& count)
{
    const auto found = json.is_object() ? json.find(key) : json.end();
    if (found == json.end() || !found->is_number_unsigned())
        return false;
    count = found->get<uint64_t>();
    return true;
}

bool TakeHead(const Json& json, CRunPlan& plan)
{
    uint64_t planVersion = 0;
    uint64_t shardCount = 0;
    if (!TakeCount(json, "plan", planVersion) || planVersion != kPlanVersion ||
        !TakeText(json, "version", plan.version) || !TakeText(json, "outputFolder", plan.outputFolder) ||
        !TakeCount(json, "shards", shardCount) || shardCount == 0 || shardCount > kShardLimit)
        return false;
    plan.shardCount = shardCount;
    const auto options = json.find("options");
    plan.options = options != json.end() ? DumpJson(*options) : "{}";
    return true;
}

bool TakeEntry(const Json& json, CRunPlan& plan)
{
    CRunPlan::Entry entry;
    uint64_t shard = 0;
    if (!TakeText(json, "source", entry.source) || !TakeText(json, "output", entry.output) ||
        !TakeCount(json, "shard", shard) || shard >= plan.shardCount ||
        !TakeCount(json, "bytes", entry.byteCount))
        return false;
    entry.shard = shard;
    plan.entries.push_back(std::move(entry));
    return true;
}

} // namespace

// The largest first, each to the shard that has least: no shard gets more than a third above the best
// division (Graham 1969).
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
    bool good = file.Open(path) && file.Write(DumpJson(Json{
                                                  {"plan",         kPlanVersion             },
                                                  {"version",      plan.version             },
                                                  {"shards",       plan.shardCount          },
                                                  {"outputFolder", plan.outputFolder        },
                                                  {"options",      Json::parse(plan.options)}
    }) +
                                              '\n');
    for (const CRunPlan::Entry& entry : plan.entries)
        good = good && file.Write(DumpJson(Json{
                                      {"shard",  entry.shard    },
                                      {"source", entry.source   },
                                      {"output", entry.output   },
                                      {"bytes",  entry.byteCount}
        }) +
                                  '\n');
    return good && file.Commit();
}

EPlanFault ReadPlan(const std::string& path, CRunPlan& plan, size_t& line)
{
    CMappedFile file;
    if (file.Open(path) != EFailure::None)
        return EPlanFault::Unreadable;
    std::string_view rest = file.Text();
    std::string_view text;
    line = 1;
    if (!NextLine(rest, text) || !TakeHead(Json::parse(text, nullptr, false), plan))
        return EPlanFault::NoPlan;
    while (NextLine(rest, text))
    {
        ++line;
        if (!TakeEntry(Json::parse(text, nullptr, false), plan))
            return EPlanFault::BadLine;
    }
    return EPlanFault::None;
}

} // namespace gw
