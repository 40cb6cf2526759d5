#include "ConversionJobs.h"

#include "RunSetup.h"
#include "SourceList.h"
#include "Words.h"

namespace gw {

namespace {

constexpr std::string_view kSources[] = {".bvh", ".orn"};
constexpr std::string_view kResult = ".Kinetra";

} // namespace

EExit ListConversions(const ShellOptions& options, CFileRun::Jobs& jobs)
{
    std::vector<RunSource> sources;
    if (!ListSources(options, kSources, sources))
        return EExit::Failed;
    for (const RunSource& source : sources)
        jobs.push_back({source.path, OutputOf(options.outputFolder, source, kResult)});
    if (!AreOutputsApart(jobs))
        return EExit::Usage;
    if (!jobs.empty())
        return EExit::Done;
    SayError("there are no .bvh or .orn files to convert");
    return EExit::Failed;
}

} // namespace gw
