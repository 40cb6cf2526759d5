#include "CDeferredSync.h"
#include "CHTMLDump.h"
#include "COrnHTMLPage.h"
#include "COutputFile.h"
#include "CSafeFile.h"
#include "CSceneFile.h"
#include "CSinglePageDump.h"
#include "CommandTable.h"
#include "Output.h"
#include "Paths.h"
#include "Streams.h"
#include "SystemError.h"
#include "Text.h"
#include "TreeViewScript.h"
#include "Words.h"

namespace gw {

namespace {

EExit Fail(const std::string& path, const std::string& words)
{
    SayError(path, "write-error", words);
    return EExit::Failed;
}

bool WriteTreeView(const std::string& folder)
{
    COrnHTMLPage script;
    std::string text(kTreeViewScript);
    text.pop_back(); // the line feed is added when the page is written
    script.AddLine(std::move(text));
    return script.SaveAs(folder + "TreeView.js");
}

bool IsPageNamed(const ShellOptions& options)
{
    const std::string& page = options.output;
    return IsStream(page) || HasExtension(page, ".html") || HasExtension(page, ".htm") ||
           Refuse(Printable(page) + ": the name of a page must end in .html; --out-dir writes many pages");
}

EExit WriteOnePage(const ShellOptions& options, const std::vector<CObject*>& roots)
{
    COutputFile output;
    if (!output.Open(options, options.output, ".html"))
        return EExit::Failed;
    CSinglePageDump dump;
    for (CObject* root : roots)
        dump.WriteSite(*root);
    if (dump.FailedCount() != 0 || !dump.WriteTo(output.Path()))
        return Fail(options.output, "the page cannot be written" + TakeSystemErrorWords());
    return output.DeliverOrSay() ? TellWritten(options, options.files[0], options.output) : EExit::Failed;
}

EExit WritePages(const ShellOptions& options, const std::vector<CObject*>& roots)
{
    const std::string& source = options.files[0];
    const std::string folder = WithSeparator(options.outputFolder);
    if (!CreateFolder(options.outputFolder))
        return Fail(folder, "the folder cannot be created" + TakeSystemErrorWords());
    if (!WriteTreeView(folder))
        return Fail(folder + "TreeView.js", "the file cannot be written" + TakeSystemErrorWords());

    // Thousands of pages are synced together; syncing them one by one would take half of the time.
    CDeferredSync sync;
    sync.Add(folder);
    CSafeFile::DeferSyncs(true);
    CHTMLDump dump(folder);
    for (CObject* root : roots)
        TellWritten(options, source, folder + dump.WriteSite(*root));
    CSafeFile::DeferSyncs(false);
    if (const std::string lost = sync.Sync(); !lost.empty())
        return Fail(lost, "the pages may be lost after a power failure");
    if (dump.FailedCount() == 0)
        return EExit::Done;
    std::string reason = TakeSystemErrorWords();
    if (reason.empty())
        reason = ": a link, a folder or a pipe has its name";
    const std::string all = dump.FailedCount() == 1
                                ? ""
                                : "; in all, " + std::to_string(dump.FailedCount()) + " of " +
                                      std::to_string(dump.PageCount()) + " pages failed";
    return Fail(folder + dump.FirstFailed(), "the page cannot be written" + reason + all);
}

} // namespace

EExit RunDump(const ShellOptions& options)
{
    const std::string& source = options.files[0];
    if (options.outputFolder == kStandardStream)
        Refuse("--out-dir -: a folder is needed; '-o -' writes one page to standard output");
    if (options.outputFolder == kStandardStream || (!options.output.empty() && !IsPageNamed(options)))
        return EExit::Usage;
    CSceneFile file;
    if (!file.LoadWhole(source))
        return EExit::Failed;
    SayWarnings(options, source, file.Record());
    const std::vector<CObject*> roots = file.Roots();
    if (roots.empty())
        SayWarning(options, Printable(source) + ": the file has no roots to show");
    return options.output.empty() ? WritePages(options, roots) : WriteOnePage(options, roots);
}

} // namespace gw
