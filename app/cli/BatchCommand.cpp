#include "CCntComboExControl.h"
#include "CFilePlatform.h"
#include "CJsonWriter.h"
#include "CShellContent.h"
#include "CShellWindow.h"
#include "Commands.h"
#include "Paths.h"
#include "PrivateNames.h"
#include "ProfileFit.h"
#include "ReportJson.h"
#include "Text.h"
#include "Words.h"

#include <cstdio>
#include <optional>

namespace gw {

namespace {

// The desktop program takes the profile that is selected. Without --profile it is the one that `convert`
// would take for the first file.
bool SelectProfile(const COptions& options, CShellWindow& window, CShellContent& content,
                   const std::string& first)
{
    if (options.job != "htr")
        return true;
    if (!options.profile.empty())
        return content.SelectProfile(options.profile);
    window.SetPaths(first, {});
    if (content.OpenSource() == 0 || window.HasFailed())
        return false;
    std::optional<CProfileFit> nearest;
    return content.SelectFittingProfile(first, nearest);
}

void WriteJson(const COptions& options, const CShellWindow& window, size_t finished)
{
    CJsonWriter json(stdout);
    json.BeginObject();
    json.Key("folder").Text(options.files[0]);
    json.Key("job").Text(options.job);
    json.Key("finished").Integer(static_cast<int64_t>(finished));
    WriteReports(json, window.Reports());
    json.EndObject();
    json.EndDocument();
}

EExit RunFolder(const COptions& options, const std::string& first)
{
    CShellWindow window(options);
    CFilePlatform platform(EPlatformWriting::No, options.dataFolder);
    CShellContent content(window, platform);
    const bool ran = SelectProfile(options, window, content, first) && content.RunBatch() != 0;
    const bool good = ran && !window.HasFailed();
    const size_t taken = window.BatchFileCount();
    if (options.json)
        WriteJson(options, window, good || taken == 0 ? taken : taken - 1);
    return good ? EExit::Done : EExit::Failed;
}

} // namespace

EExit RunBatchFolder(const COptions& options)
{
    const std::string& folder = options.files[0];
    if (!FolderExists(folder))
    {
        SayError(Printable(folder) + ": there is no such folder");
        return EExit::Failed;
    }
    RemoveLeftovers(folder);
    const char* extension = options.job == "htr" ? ".bvh" : ".htr";
    const std::vector<std::string> names = FilesInFolder(folder, extension);
    if (names.empty())
    {
        SayError(Printable(folder) + ": the folder holds no " + extension + " file");
        return EExit::Failed;
    }
    return RunFolder(options, WithSeparator(folder) + names.front());
}

} // namespace gw
