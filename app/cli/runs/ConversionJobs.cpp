#include "ConversionJobs.h"

#include "CMotionFile.h"
#include "Paths.h"
#include "ResultExtension.h"
#include "RunSetup.h"
#include "SourceList.h"
#include "StandardStreams.h"
#include "Streams.h"
#include "TKImportStream.h"
#include "Text.h"
#include "Words.h"

#include <algorithm>
#include <string>
#include <unordered_map>

namespace gw {

namespace {

constexpr std::string_view kSources[] = {".bvh", ".orn",  ".htr", ".cha", ".chb",
                                         ".fbx", ".gltf", ".glb", ".vrm", ".dae"};

// Of sources in one folder that differ only in their extensions, the first one has the usual output:
// "walk.Kinetra". The others keep their extensions: "walk.htr.Kinetra".
class COutputNames
{
public:
    explicit COutputNames(const ShellOptions& options)
        : folder_(options.outputFolder), m_kResult(ResultExtension(options))
    {
    }

    /// `clip` becomes part of the name, unless it is empty.
    std::string Next(const RunSource& source, const std::string& clip)
    {
        const std::string extension = SplitPath(source.path).extension;
        const std::string end = (clip.empty() ? "" : '-' + FileName(clip)) + m_kResult;
        std::string output = OutputOf(folder_, source, end);
        const auto [other, isNew] = m_kExtensions.emplace(output, extension);
        if (isNew || EqualNoCase(other->second, extension))
            return output;
        return OutputOf(folder_, source, extension + end);
    }

private:
    // Names of clips can contain anything.
    static std::string FileName(std::string clip)
    {
        std::ranges::replace_if(
            clip, [](char c) { return ForbiddenInFileNames().find(c) != std::string_view::npos; }, '_');
        return clip;
    }

    const std::string& folder_;
    std::string m_kResult;
    std::unordered_map<std::string, std::string> m_kExtensions; // of the source with the usual output
};

} // namespace

namespace {

// Returns the clips of which each becomes a result; an empty name for the only one, or for the longest.
std::vector<std::string> ClipsOf(const ShellOptions& options, const std::string& source)
{
    CMotionFile motion;
    if (!options.clip.empty() || !IsImported(source) || !motion.Load(source) ||
        motion.imported.clips.size() < 2)
        return {std::string()};
    return motion.imported.clips;
}

} // namespace

EExit ListConversions(const ShellOptions& options, CFileRun::Jobs& jobs)
{
    std::vector<RunSource> sources;
    if (!ListSources(options, kSources, sources))
        return EExit::Failed;
    COutputNames outputs(options);
    for (const RunSource& source : sources)
    {
        if (source.path == kStandardStream)
        {
            SayError("standard input must be the only source");
            return EExit::Usage;
        }
        for (const std::string& clip : ClipsOf(options, source.path))
            jobs.push_back({source.path, outputs.Next(source, clip), clip});
    }
    if (!AreOutputsApart(jobs))
        return EExit::Usage;
    if (!jobs.empty())
        return EExit::Done;
    SayError({}, "no-sources",
             "no motion files found (.bvh, .orn, .htr, .cha, .chb, .fbx, .gltf, .glb, .vrm, .dae)");
    return EExit::Failed;
}

} // namespace gw
