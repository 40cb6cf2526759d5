#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace gw {

/// A run that several machines share, as a file of lines of JSON: the first says how to convert, every other
/// one is a source with its output and the number of its shard, from 0 on.
struct CRunPlan
{
    struct Entry
    {
        std::string source;
        std::string output;
        uint64_t byteCount = 0;
        size_t shard = 0;
    };

    std::string version;      ///< of the program that made it
    std::string outputFolder; ///< where results and what is known of them go; empty for beside the sources
    std::string options;      ///< a JSON object, whoever runs the plan reads it
    size_t shardCount = 1;
    std::vector<Entry> entries;

    /// Gives every entry a shard, so that all shards are about equally much work.
    void Share();
    /// The entries of one shard, in the order of the plan.
    std::vector<Entry> Shard(size_t shard) const;
};

/// Writes a plan in one step. False when the file cannot be written.
bool WritePlan(const std::string& path, const CRunPlan& plan);

enum class EPlanFault : uint8_t
{
    None,
    Unreadable, ///< there is no such file
    NoPlan,     ///< its first line is none of a plan
    BadLine,    ///< another line is none, or names a shard that there is not
    TooDeep,    ///< a line is nested deeper than any plan
};

/// Reads a plan. `line` becomes the one that was refused, from 1 on.
EPlanFault ReadPlan(const std::string& path, CRunPlan& plan, size_t& line);

} // namespace gw
