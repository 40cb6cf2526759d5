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
#include "ResultExtension.h"
#include "RunSetup.h"
#include "Streams.h"
#include "Text.h"
#include "Words.h"

#include <optional>

namespace gw {

namespace {

constexpr std::string_view kLowercase[] = {".htr", ".bvh", ".glb"};

// Determines the file to write: a name without an extension gets that of the format, and other extensions
// than .Kinetra are written in lowercase.
bool ResolveOutput(const ShellOptions& options, std::string& output)
{
    const std::string_view wanted = ResultExtension(options);
    if (IsStream(output))
        return true;
    if (SplitPath(output).extension.empty())
        output += wanted;
    const PathParts parts = SplitPath(output);
    if (!options.format.empty() && !HasExtension(output, wanted))
        return Refuse("--format " + options.format + " does not fit the output " + Quoted(output));
    for (const std::string_view extension : kLowercase)
    {
        if (!EqualNoCase(parts.extension, extension))
            continue;
        output = parts.folder + parts.stem + std::string(extension);
        return true;
    }
    return HasExtension(output, ".Kinetra") ||
           Refuse(Printable(output) + ": the output must be a .Kinetra, .htr, .bvh or .glb file");
}

// Without -o, the result goes next to the source, and that of standard input to standard output.
std::string UsualOutput(const ShellOptions& options)
{
    const std::string& source = options.files[0];
    if (!options.output.empty())
        return InFolder(options.output, source, ResultExtension(options));
    return source == kStandardStream
               ? source
               : SplitPath(source).folder + StemOf(source) + std::string(ResultExtension(options));
}

bool PlanOne(const ShellOptions& options, CFileRun::Jobs& jobs)
{
    if (options.resume)
        return Refuse("--resume is for many files; it needs --out-dir DIR");
    const std::string& source = options.files[0];
    std::string output = UsualOutput(options);
    if (options.output.empty() && IsStream(source) && !IsStream(output))
        return Refuse("the source is a pipe or device; -o OUT names the result");
    if (!ResolveOutput(options, output))
        return false;
    if (options.json && IsStandardOutput(output))
        return Refuse("--json and the result would both go to standard output");
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
