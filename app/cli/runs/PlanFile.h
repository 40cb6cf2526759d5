#pragma once

#include "CRunPlan.h"

namespace gw {

/// Reads a plan that this version of the program made. Says why it cannot.
bool LoadPlan(const std::string& path, CRunPlan& plan);

/// Where the report of a shard goes unless told: beside the plan.
std::string ShardReport(const std::string& planPath, size_t shard);

} // namespace gw
