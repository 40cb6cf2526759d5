// `convert`: one source in this process, or many in worker processes.

#include "CConversionPage.h"
#include "CConversionRun.h"
#include "CDraftShelf.h"
#include "CPagePart.h"
#include "CommandTable.h"
#include "ConversionJobs.h"
#include "Output.h"
#include "PageOutput.h"
#include "Paths.h"
#include "RunSetup.h"
#include "Text.h"
#include "Words.h"

#include <optional>

namespace gw {

namespace {

// Determines the file to write: a name without an extension gets the save dialog's, and .htr is written in
// lowercase.
bool ResolveOutput(std::string& output)
{
    const PathParts parts = SplitPath(output);
    if (parts.extension.empty())
        output += ".Kinetra";
    else if (EqualNoCase(parts.extension, ".htr"))
        output = parts.folder + parts.stem + ".htr";
    else if (!EqualNoCase(parts.extension, ".Kinetra"))
        return Refuse(Printable(output) + ": the output must be a .Kinetra or .htr file");
    return true;
}

bool PlanOne(const ShellOptions& options, CFileRun::Jobs& jobs)
{
    if (options.resume)
        return Refuse("--resume is for many files; it needs --out-dir DIR");
    const std::string& source = options.files[0];
    std::string output = options.output;
    if (output.empty())
        output = SplitPath(source).folder + SplitPath(source).stem + ".Kinetra";
    if (!ResolveOutput(output))
        return false;
    jobs.push_back({source, output});
    return true;
}

bool IsOne(const ShellOptions& options)
{
    return options.files.size() == 1 && options.filesFrom.empty() && options.outputFolder.empty() &&
           !FolderExists(options.files[0]);
}

// In this process, since a crash would lose nothing else.
EExit RunOne(const ShellOptions& options, const ConversionJob& job)
{
    std::optional<CPagePart> part;
    if (IsPageAsked(options))
        part.emplace(1, 1);
    std::optional<CDraftShelf> drafts;
    if (options.draft)
        drafts.emplace(options.dryRun ? std::string() : options.drafts, 1);
    const EConversion outcome = ConvertFile(
        options, job,
        {.part = part ? &*part : nullptr, .drafts = drafts ? &*drafts : nullptr, .process = EProcess::Ends});
    bool isWritten = true;
    if (part && part->HasFigures())
    {
        CConversionPage page;
        page.Add({.source = job.source});
        page.AddDetails(*part);
        isWritten = WritePage(options, page);
    }
    return outcome == EConversion::Failed || !isWritten ? EExit::Failed : EExit::Done;
}

EExit ConvertOne(const ShellOptions& options)
{
    CFileRun::Jobs jobs;
    if (!PlanOne(options, jobs))
        return EExit::Usage;
    if (!HasPageFolder(options))
        return EExit::Failed;
    return options.report.empty() ? RunOne(options, jobs[0]) : CConversionRun(options, jobs, {}).RunAll();
}

bool IsManyPossible(const ShellOptions& options)
{
    if (options.outputFolder.empty())
        return Refuse("several sources, or a folder, need --out-dir DIR");
    if (!options.output.empty())
        return Refuse("-o names a single file and cannot be combined with --out-dir, which names results "
                      "after their sources");
    return true;
}

EExit ConvertMany(const ShellOptions& options)
{
    CFileRun::Jobs jobs;
    if (!IsManyPossible(options))
        return EExit::Usage;
    if (const EExit listed = ListConversions(options, jobs); listed != EExit::Done)
        return listed;
    if (!MakeOutputFolder(options) || !HasPageFolder(options)) // both can be the same folder
        return EExit::Failed;
    return CConversionRun(options, jobs, StateOf(options)).RunAll();
}

} // namespace

EExit RunConvert(const ShellOptions& options)
{
    if (!IsDecidedOnExisting(options) || !IsRunPossible(options))
        return EExit::Usage;
    if (const EExit page = CheckPagePath(options); page != EExit::Done)
        return page;
    return IsOne(options) ? ConvertOne(options) : ConvertMany(options);
}

} // namespace gw
