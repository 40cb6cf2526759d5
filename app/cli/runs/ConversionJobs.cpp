#include "ConversionJobs.h"

#include "Paths.h"
#include "RunSetup.h"
#include "SourceList.h"
#include "Text.h"
#include "Words.h"

#include <string>
#include <unordered_map>

namespace gw {

namespace {

constexpr std::string_view kSources[] = {".bvh", ".orn", ".htr", ".cha", ".chb"};
constexpr std::string_view kResult = ".Kinetra";

// Of sources in one folder that differ only in their extensions, the first one has the usual output:
// "walk.Kinetra". The others keep their extensions: "walk.htr.Kinetra".
class COutputNames
{
public:
    explicit COutputNames(const std::string& folder) : folder_(folder) {}

    std::string Next(const RunSource& source)
    {
        const std::string extension = SplitPath(source.path).extension;
        std::string output = OutputOf(folder_, source, kResult);
        const auto [other, isNew] = m_kExtensions.emplace(output, extension);
        if (isNew || EqualNoCase(other->second, extension))
            return output;
        return OutputOf(folder_, source, extension + std::string(kResult));
    }

private:
    const std::string& folder_;
    std::unordered_map<std::string, std::string> m_kExtensions; // of the source with the usual output
};

} // namespace

EExit ListConversions(const ShellOptions& options, CFileRun::Jobs& jobs)
{
    std::vector<RunSource> sources;
    if (!ListSources(options, kSources, sources))
        return EExit::Failed;
    COutputNames outputs(options.outputFolder);
    for (const RunSource& source : sources)
        jobs.push_back({source.path, outputs.Next(source)});
    if (!AreOutputsApart(jobs))
        return EExit::Usage;
    if (!jobs.empty())
        return EExit::Done;
    SayError("there are no motion files to convert (.bvh, .orn, .htr, .cha, .chb)");
    return EExit::Failed;
}

} // namespace gw
