#pragma once

#include "CRunPlan.h"

namespace gw {

/// Reads a plan written by this version of the program. Returns false, after printing the reason, if that
/// fails.
bool LoadPlan(const std::string& path, CRunPlan& plan);

/// Returns the default report file of a shard, next to the plan.
std::string ShardReport(const std::string& planPath, size_t shard);

} // namespace gw
