#include "RunSetup.h"

#include "Output.h"
#include "Paths.h"
#include "Streams.h"
#include "SystemError.h"
#include "Text.h"
#include "Words.h"

#include <unordered_set>

namespace gw {

namespace {

constexpr int64_t kWorkerLimit = 1024; // far more than any machine has cores, far below the system's limit

} // namespace

bool IsRunPossible(const ShellOptions& options)
{
    const char* words = nullptr;
    if (options.jobs && (*options.jobs < 1 || *options.jobs > kWorkerLimit))
        words = "--jobs must be a number from 1 to 1024";
    else if (options.resume && options.skipExisting)
        words = "--resume and --skip-existing cannot be combined";
    else if (options.dryRun && !options.report.empty())
        words = "--dry-run writes nothing, so it cannot be combined with --report";
    else if (options.nullSeparated && options.filesFrom.empty())
        words = "--null needs a list; pass one with --files-from";
    else if (options.resume && options.outputFolder.empty() && options.files.empty())
        words = "--resume keeps its records in the output folder; pass --out-dir DIR";
    if (words)
        SayError(words);
    return !words;
}

bool AreOutputsApart(const CFileRun::Jobs& jobs)
{
    std::unordered_set<std::string_view> outputs;
    for (const ConversionJob& job : jobs)
    {
        if (outputs.insert(job.output).second)
            continue;
        SayError(job.source, "output-conflict",
                 "another source would also be written to " + Printable(job.output));
        return false;
    }
    return true;
}

bool MakeOutputFolder(const ShellOptions& options)
{
    if (options.outputFolder == kStandardStream || options.drafts == kStandardStream)
    {
        SayError(std::string(kStandardStream), "no-stream",
                 "a folder is needed; only a single result can be a stream");
        return false;
    }
    for (const std::string& folder : {options.outputFolder, options.drafts})
    {
        if (folder.empty() || options.dryRun || CreateFolder(folder))
            continue;
        SayError(folder, "no-folder", "the folder cannot be created" + TakeSystemErrorWords());
        return false;
    }
    return true;
}

std::string ResumeDrafts(const std::string& stateFolder)
{
    return WithSeparator(stateFolder) + ".gaitwright.drafts";
}

RunState StateOf(const ShellOptions& options)
{
    RunState state;
    if (!options.outputFolder.empty())
        state.folder = WithSeparator(options.outputFolder);
    else if (!options.files.empty())
        state.folder = WithSeparator(options.files[0]);
    return state;
}

} // namespace gw
