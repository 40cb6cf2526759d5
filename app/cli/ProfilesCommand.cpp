#include "CFilePlatform.h"
#include "CJsonWriter.h"
#include "CShellContent.h"
#include "CShellWindow.h"
#include "Commands.h"
#include "FitWords.h"
#include "ProfileChoice.h"
#include "ProfileFit.h"
#include "Text.h"
#include "Words.h"

#include <cstdio>
#include <optional>

namespace gw {

namespace {

struct Entry
{
    CInstalledProfile profile;
    std::optional<CProfileFit> fit; // with a source
};

std::vector<Entry> Entries(CShellContent& content, bool withFit)
{
    std::vector<Entry> entries;
    for (const CInstalledProfile& profile : content.InstalledProfiles())
    {
        CProfileFit fit;
        const bool measured = withFit && content.Measure(profile.path, fit);
        entries.push_back({profile, measured ? std::optional(fit) : std::nullopt});
    }
    return entries;
}

void Print(const Entry& entry)
{
    std::printf("%s (%s, %s)%s%s\n", Printable(entry.profile.name).c_str(),
                entry.profile.stock ? "stock" : "own", Printable(entry.profile.path).c_str(),
                entry.fit ? ": " : "", entry.fit ? FitSummary(*entry.fit).c_str() : "");
    const std::string missing = entry.fit ? MissingLines(*entry.fit) : "";
    if (!missing.empty())
        std::puts(missing.c_str());
}

void WriteJson(const std::vector<Entry>& entries)
{
    CJsonWriter json(stdout);
    json.BeginObject();
    json.Key("profiles").BeginArray();
    for (const Entry& entry : entries)
    {
        json.BreakLine();
        json.BeginObject();
        json.Key("name").Text(entry.profile.name);
        json.Key("path").Text(entry.profile.path);
        json.Key("stock").Bool(entry.profile.stock);
        if (entry.fit)
            WriteFit(json, *entry.fit);
        json.EndObject();
    }
    json.EndArray();
    json.EndObject();
    json.EndDocument();
}

} // namespace

EExit RunProfiles(const COptions& options)
{
    CShellWindow window(options);
    CFilePlatform platform(EPlatformWriting::No, options.dataFolder);
    CShellContent content(window, platform);
    const bool hasSource = !options.files.empty();
    if (hasSource)
    {
        window.SetPaths(options.files[0], {});
        if (content.OpenSource() == 0 || window.HasFailed())
            return EExit::Failed;
    }
    const std::vector<Entry> entries = Entries(content, hasSource);
    if (options.json)
        WriteJson(entries);
    for (const Entry& entry : options.json ? std::vector<Entry>() : entries)
        Print(entry);
    if (entries.empty())
        SayWord(options, "no profile is installed");
    return EExit::Done;
}

} // namespace gw
