// `batch`: the desktop program's folder run, with the same profile rules and messages.

#include "CBatchRun.h"
#include "CDraftShelf.h"
#include "CJsonWriter.h"
#include "CShellConversion.h"
#include "CShellNotices.h"
#include "CheckResult.h"
#include "CommandTable.h"
#include "JsonStatus.h"
#include "NoticeJson.h"
#include "Output.h"
#include "Paths.h"
#include "RunSetup.h"
#include "SourceList.h"
#include "Text.h"
#include "Words.h"

#include <algorithm>
#include <cstdio>
#include <optional>

namespace gw {

namespace {

void WriteJson(const ShellOptions& options, const std::vector<Notice>& notices, size_t finished, bool failed)
{
    CJsonWriter json(stdout);
    json.BeginObject();
    json.Key("summary").Bool(true);
    if (failed && std::ranges::all_of(notices, &Notice::IsWarning))
        WriteFailed(json, FirstError());
    else
        WriteStatus(json, "ok", notices);
    json.Key("folder").Text(options.files.empty() ? std::string() : options.files[0]);
    json.Key("job").Text(options.job);
    json.Key("finished").Integer(static_cast<int64_t>(finished));
    WriteNotices(json, notices);
    json.EndObject();
    json.EndDocument();
}

// The file that ended the run does not count as finished.
size_t FinishedCount(const ShellOptions& options, const CBatchRun& run, bool failed)
{
    const size_t taken = run.TakenCount();
    if (options.keepGoing)
        return taken - run.Tally()[EConversion::Failed];
    return failed && taken > 0 ? taken - 1 : taken;
}

EExit RunBatchJobs(const ShellOptions& options, const CFileRun::Jobs& jobs)
{
    CShellNotices ownNotices(options);
    std::optional<CDraftShelf> drafts;
    CShellConversion conversion(options, ChoicesOf(options), ownNotices);
    if (options.draft) // one profile for all files, so one draft at most
        conversion.UseDrafts(drafts.emplace(options.drafts, 1));
    CBatchRun run(options, jobs, StateOf(options), conversion, ownNotices);
    const bool begins = SelectBatchProfile(options, conversion, jobs.front().source);
    const EExit exit = begins ? run.RunAll() : EExit::Failed;
    std::vector<Notice> notices = ownNotices.All();
    notices.insert(notices.end(), run.Notices().begin(), run.Notices().end());
    const bool failed = exit == EExit::Failed || !std::ranges::all_of(notices, &Notice::IsWarning);
    if (options.json)
        WriteJson(options, notices, FinishedCount(options, run, failed), exit != EExit::Done || failed);
    return exit == EExit::Done && failed ? EExit::Failed : exit;
}

// Only the folder itself, with results next to their sources, as in the desktop program; with an output
// folder, its subfolders as well.
bool ListJobs(const ShellOptions& options, CFileRun::Jobs& jobs)
{
    const EBatchJob job = BatchJobOf(options);
    const std::string_view extensions[] = {BatchSource(job)};
    std::vector<RunSource> sources;
    if (options.outputFolder.empty() && options.filesFrom.empty())
    {
        for (const std::string& name : FilesInFolder(options.files[0], extensions[0]))
            sources.push_back({WithSeparator(options.files[0]) + name, name});
    }
    else if (!ListSources(options, extensions, sources))
    {
        return false;
    }
    for (const RunSource& source : sources)
        jobs.push_back({source.path, OutputOf(options.outputFolder, source, BatchResult(job))});
    return true;
}

EExit FailWith(const std::string& path, const char* code, const std::string& words)
{
    SayError(path, code, words);
    return EExit::Failed;
}

} // namespace

EExit RunBatchFolder(const ShellOptions& options)
{
    if (!options.files.empty() && !FolderExists(options.files[0]))
        return FailWith(options.files[0], "not-found", "no such folder");
    if (!IsRunPossible(options))
        return EExit::Usage;
    if (!options.files.empty() && !CanListFolder(options, options.files[0]))
        return EExit::Failed;
    CFileRun::Jobs jobs;
    if (!ListJobs(options, jobs))
        return EExit::Failed;
    if (!AreOutputsApart(jobs))
        return EExit::Usage;
    if (jobs.empty())
        return FailWith(options.files.empty() ? options.filesFrom : options.files[0], "no-sources",
                        "the folder contains no " + std::string(BatchSource(BatchJobOf(options))) + " file");
    if (!MakeOutputFolder(options))
        return EExit::Failed;
    return RunBatchJobs(options, jobs);
}

} // namespace gw
