#include "CConversionPage.h"
#include "CJsonWriter.h"
#include "Commands.h"
#include "ConvertFile.h"
#include "Output.h"
#include "PageOutput.h"
#include "Paths.h"
#include "PrivateNames.h"
#include "Text.h"
#include "Words.h"

#include <array>
#include <cstdio>
#include <optional>
#include <unordered_set>

namespace gw {

namespace {

using Jobs = std::vector<CConversionJob>;

bool Refuse(const std::string& words)
{
    SayError(words);
    return false;
}

// The file that will be written for a name: a name without an extension gets the save dialog's, and an .htr
// is written in small letters.
bool ResolveOutput(std::string& output)
{
    const CPathParts parts = SplitPath(output);
    if (parts.extension.empty())
        output += ".Kinetra";
    else if (EqualNoCase(parts.extension, ".htr"))
        output = parts.folder + parts.stem + ".htr";
    else if (!EqualNoCase(parts.extension, ".Kinetra"))
        return Refuse(Printable(output) + ": a result is a .Kinetra or an .htr file");
    return true;
}

std::string OutputOf(const std::string& source, const std::string& folder)
{
    return folder + SplitPath(source).stem + ".Kinetra";
}

bool PlanOne(const COptions& options, Jobs& jobs)
{
    const std::string& source = options.files[0];
    std::string output = options.output;
    if (output.empty())
        output = OutputOf(source, SplitPath(source).folder);
    if (!ResolveOutput(output))
        return false;
    jobs.push_back({source, output});
    return true;
}

// What the open dialog would show of a folder.
void AddFolder(const std::string& source, std::vector<std::string>& sources)
{
    const std::string folder = WithSeparator(source);
    for (const char* extension : {".bvh", ".orn"})
    {
        for (const std::string& name : FilesInFolder(folder, extension))
            sources.push_back(folder + name);
    }
}

bool PlanMany(const COptions& options, Jobs& jobs)
{
    if (options.outputFolder.empty())
        return Refuse("several sources, or a folder, need --out-dir DIR");
    if (!options.output.empty())
        return Refuse("-o names a single file; with --out-dir every result takes the name of its source");
    std::vector<std::string> sources;
    for (const std::string& file : options.files)
    {
        if (FolderExists(file))
            AddFolder(file, sources);
        else
            sources.push_back(file);
    }
    std::unordered_set<std::string> outputs;
    for (const std::string& source : sources)
    {
        jobs.push_back({source, OutputOf(source, WithSeparator(options.outputFolder))});
        if (!outputs.insert(jobs.back().output).second)
            return Refuse(Printable(source) + ": another source becomes " + Printable(jobs.back().output) +
                          " too");
    }
    return true;
}

bool Plan(const COptions& options, Jobs& jobs)
{
    if (!IsDecidedOnExisting(options))
        return false;
    const bool isOne =
        options.files.size() == 1 && options.outputFolder.empty() && !FolderExists(options.files[0]);
    return isOne ? PlanOne(options, jobs) : PlanMany(options, jobs);
}

// How many jobs came to each end, by EConversion.
using Tally = std::array<size_t, 4>;

size_t Count(const Tally& tally, EConversion outcome)
{
    return tally[static_cast<size_t>(outcome)];
}

void TellTally(const COptions& options, const Tally& tally, size_t left)
{
    const size_t converted = Count(tally, EConversion::Converted) + Count(tally, EConversion::Planned);
    const size_t skipped = Count(tally, EConversion::Skipped);
    const size_t failed = Count(tally, EConversion::Failed);
    if (!options.json)
    {
        SayWord(options, std::to_string(converted) + (options.dryRun ? " to convert, " : " converted, ") +
                             std::to_string(skipped) + " skipped, " + std::to_string(failed) + " failed, " +
                             std::to_string(left) + " left");
        return;
    }
    CJsonWriter json(stdout);
    json.BeginObject();
    json.Key("converted").Integer(static_cast<int64_t>(converted));
    json.Key("skipped").Integer(static_cast<int64_t>(skipped));
    json.Key("failed").Integer(static_cast<int64_t>(failed));
    json.Key("left").Integer(static_cast<int64_t>(left));
    json.EndObject();
    json.EndDocument();
}

EExit RunJobs(const COptions& options, const Jobs& jobs)
{
    Tally tally{};
    size_t done = 0;
    std::optional<CConversionPage> page;
    if (!options.html.empty() && !options.dryRun)
        page.emplace(jobs.size());
    for (; done < jobs.size() && (options.keepGoing || Count(tally, EConversion::Failed) == 0); ++done)
        ++tally[static_cast<size_t>(ConvertFile(options, jobs[done], page ? &*page : nullptr))];
    if (!options.outputFolder.empty())
        TellTally(options, tally, jobs.size() - done);
    for (size_t left = done; page && left < jobs.size(); ++left)
        page->AddWithoutFigures(jobs[left].source, "left");
    const bool isWritten = !page || !page->HasConversions() || WritePage(options, *page);
    return Count(tally, EConversion::Failed) == 0 && isWritten ? EExit::Done : EExit::Failed;
}

// The folder of the results is made where it is missing; a page may lie in it.
bool PrepareFolders(const COptions& options)
{
    if (options.dryRun)
        return true;
    if (!options.outputFolder.empty() && !CreateFolder(options.outputFolder))
    {
        SayError(Printable(options.outputFolder) + ": the folder cannot be made");
        return false;
    }
    if (!options.outputFolder.empty())
        RemoveLeftovers(options.outputFolder);
    return HasPageFolder(options);
}

} // namespace

EExit RunConvert(const COptions& options)
{
    Jobs jobs;
    if (!Plan(options, jobs))
        return EExit::Usage;
    if (const EExit page = CheckPagePath(options); page != EExit::Done)
        return page;
    if (jobs.empty())
    {
        SayError("there is no .bvh and no .orn to convert");
        return EExit::Failed;
    }
    return PrepareFolders(options) ? RunJobs(options, jobs) : EExit::Failed;
}

} // namespace gw
