#include "ConversionJobs.h"

#include "SourceList.h"

namespace gw {

namespace {

constexpr std::string_view kSources[] = {".bvh", ".orn"};
constexpr std::string_view kResult = ".Kinetra";

} // namespace

bool ListConversions(const COptions& options, CFileRun::Jobs& jobs)
{
    std::vector<CSource> sources;
    if (!ListSources(options, kSources, sources))
        return false;
    for (const CSource& source : sources)
        jobs.push_back({source.path, OutputOf(options.outputFolder, source, kResult)});
    return true;
}

} // namespace gw
