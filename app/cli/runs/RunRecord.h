#pragma once

#include "CJobHandler.h"
#include "ConvertFile.h"
#include "Notice.h"

#include <string>

namespace gw {

// The line of JSON about one source of a run.

/// Returns the beginning of a line, with the members that differ between runs. The rest is the same in every
/// run that converts the same source the same way.
std::string RecordHead(const ConversionJob& job);
/// Returns a writer's line, still open at the end, with the job's duration added.
std::string Timed(std::string record, double seconds);
/// Returns the failure of a job that could not report it itself. `limit` is the time limit in seconds.
Notice LostNotice(const ConversionJob& job, const JobEnd& end, float limit);

} // namespace gw
