#pragma once

#include "CRunPlan.h"

namespace gw {

/// Reads a plan written by this version of the program. Prints why it fails.
bool LoadPlan(const std::string& path, CRunPlan& plan);

/// Returns the default report file of a shard, next to the plan.
std::string ShardReport(const std::string& planPath, size_t shard);

} // namespace gw
