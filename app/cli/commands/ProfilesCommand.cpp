// `profiles`: lists the installed profiles and, given a source, how well each one fits.

#include "CJsonWriter.h"
#include "CShellConversion.h"
#include "CShellNotices.h"
#include "CommandTable.h"
#include "DoubtWords.h"
#include "FitWords.h"
#include "JsonStatus.h"
#include "ProfileChoice.h"
#include "ProfileFit.h"
#include "Text.h"
#include "Words.h"

#include <algorithm>
#include <cstdio>
#include <optional>

namespace gw {

namespace {

struct Entry
{
    std::string name;
    std::string path;
    bool stock = false;
    std::optional<CProfileFit> fit;        // if a source is given
    std::optional<ProfileVerdict> verdict; // of a profile that fits
};

std::vector<Entry> Installed(CShellConversion& conversion)
{
    std::vector<Entry> entries;
    for (const InstalledProfile& profile : conversion.InstalledProfiles())
        entries.push_back({profile.name, profile.path, profile.stock, {}, {}});
    return entries;
}

CProfileFit FitOf(const CShellConversion& conversion, const ProfileChoice& choice)
{
    CProfileFit fit{
        choice.profile.name, choice.match.rowCount, choice.match.foundCount, choice.match.drivesRoot, {}};
    if (!choice.match.IsWhole())
        conversion.Measure(choice.path, fit);
    return fit;
}

// Sorted, starting with the one that a conversion uses.
std::vector<Entry> ByFit(CShellConversion& conversion)
{
    const std::vector<InstalledProfile> installed = conversion.InstalledProfiles();
    std::vector<Entry> entries;
    for (const ProfileChoice& choice : conversion.Choices())
    {
        const auto profile = std::ranges::find(installed, choice.path, &InstalledProfile::path);
        const bool stock = profile != installed.end() && profile->stock;
        entries.push_back({choice.profile.name, choice.path, stock, FitOf(conversion, choice), {}});
        if (choice.match.IsWhole())
            entries.back().verdict = choice.verdict;
    }
    return entries;
}

// The bones missing for a profile of another skeleton are not worth printing.
std::string Missing(const CProfileFit& fit)
{
    return 2 * fit.foundCount < fit.rowCount ? "" : MissingLines(fit);
}

void Print(const Entry& entry)
{
    std::string line =
        Printable(entry.name) + " (" + (entry.stock ? "stock" : "own") + ", " + Printable(entry.path) + ')';
    if (entry.fit)
        line += ": " + FitSummary(*entry.fit);
    if (entry.verdict)
        line += std::string(", ") + SurenessName(entry.verdict->sureness);
    std::puts(line.c_str());
    if (const std::string missing = entry.fit ? Missing(*entry.fit) : ""; !missing.empty())
        std::puts(missing.c_str());
    for (const std::string& words : entry.verdict ? DoubtWords(*entry.verdict) : std::vector<std::string>())
        std::printf("  %s\n", words.c_str());
}

void WriteJson(const std::vector<Entry>& entries)
{
    CJsonWriter json(stdout);
    json.BeginObject();
    WriteStatus(json, "ok");
    json.Key("profiles").BeginArray();
    for (const Entry& entry : entries)
    {
        json.BeginObject();
        json.Key("name").Text(entry.name);
        json.Key("path").Text(entry.path);
        json.Key("stock").Bool(entry.stock);
        if (entry.fit)
            WriteFit(json, *entry.fit);
        if (entry.verdict)
            WriteVerdict(json, *entry.verdict);
        json.EndObject();
    }
    json.EndArray();
    json.EndObject();
    json.EndDocument();
}

} // namespace

EExit RunProfiles(const ShellOptions& options)
{
    CShellNotices notices(options);
    CShellConversion conversion(options, {}, notices);
    const bool hasSource = !options.files.empty();
    if (hasSource && !conversion.Open(options.files[0]))
        return EExit::Failed;
    const std::vector<Entry> entries = hasSource ? ByFit(conversion) : Installed(conversion);
    if (options.json)
        WriteJson(entries);
    for (const Entry& entry : options.json ? std::vector<Entry>() : entries)
        Print(entry);
    if (entries.empty())
        SayWord(options, "no profile is installed");
    return EExit::Done;
}

} // namespace gw
