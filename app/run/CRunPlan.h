#pragma once

#include "Finding.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace gw {

/// A run shared by several machines, as a file of JSON lines: the first contains the conversion options, each
/// other line a source, its output and its shard number, starting at 0.
struct CRunPlan
{
    struct Entry
    {
        std::string source;
        std::string output;
        uint64_t byteCount = 0;
        size_t shard = 0;
        std::string clip = {}; ///< of a source with several; empty for the longest
    };

    std::string version;      ///< of the program that wrote it
    std::string outputFolder; ///< for results and their state; empty for next to the sources
    std::string options;      ///< a JSON object, read by the program that runs the plan
    size_t shardCount = 1;
    std::vector<Entry> entries;

    /// Assigns every entry to a shard, so that all shards take about the same work.
    void Share();
    /// Returns the entries of one shard, in plan order.
    std::vector<Entry> Shard(size_t shard) const;
};

/// Writes a plan atomically. Returns false if the file cannot be written.
bool WritePlan(const std::string& path, const CRunPlan& plan);

/// Reads a plan. Returns what failed: BadHeader if the first line is not that of a plan, UnexpectedLine if
/// another line is invalid or names a shard that does not exist, TooDeep, or why the file cannot be read.
Finding ReadPlan(const std::string& path, CRunPlan& plan);

} // namespace gw
