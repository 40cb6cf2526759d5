#include "PageOutput.h"

#include "CConversionPage.h"
#include "Output.h"
#include "Paths.h"
#include "SystemError.h"
#include "Text.h"
#include "Words.h"

namespace gw {

EExit CheckPagePath(const ShellOptions& options)
{
    const std::string& path = options.html;
    if (path.empty())
        return EExit::Done;
    if (!HasExtension(path, ".html") && !HasExtension(path, ".htm"))
    {
        SayError(Printable(path) + ": the name of a page must end in .html");
        return EExit::Usage;
    }
    return MayWrite(options, path) ? EExit::Done : EExit::Failed;
}

bool HasPageFolder(const ShellOptions& options)
{
    const std::string folder = SplitPath(options.html).folder;
    if (options.dryRun || folder.empty() || FolderExists(folder))
        return true;
    SayError(options.html, "no-folder", "no such folder");
    return false;
}

bool WritePage(const ShellOptions& options, CConversionPage& page)
{
    if (!page.Write(options.html))
    {
        SayError(options.html, "write-error",
                 "the page, or one of its temporary files, cannot be written" + TakeSystemErrorWords());
        return false;
    }
    SayWord(options, "page: " + Printable(options.html));
    return true;
}

} // namespace gw
