// The summary is made from the records that the workers send, so it is the same for any number of processes,
// and for the merged reports of many shards.

#include "CRunSummary.h"

#include "CJsonMembers.h"
#include "CJsonWriter.h"
#include "CProgressBar.h"
#include "FindingWords.h"
#include "HelpWords.h"
#include "JsonStatus.h"
#include "NoticeJson.h"
#include "NoticeKinds.h"
#include "ProfileNames.h"
#include "Terminal.h"
#include "Text.h"
#include "Words.h"

#include <algorithm>
#include <cstdio>
#include <set>

namespace gw {

namespace {

constexpr size_t kNamedFailures = 20;
constexpr size_t kNamedKinds = 6; // of causes and of warnings, so that everything fits on one screen

struct FigureWords
{
    const char* key;
    const char* words;
    const char* unit;
};
constexpr FigureWords kBetterFigures[] = {
    {"directionError",   "direction error", "deg"},
    {"footTurn",         "foot turn",       "deg"},
    {"ankleSlideMedian", "ankle slide",     "mm" },
    {"heldSole",         "held soles",      "mm" },
    {"sinking",          "sinking",         "mm" },
};

// A record does not need to be parsed to see whether it has a member: names in records are escaped.
bool HasMember(std::string_view record, std::string_view key)
{
    return record.find(",\"" + std::string(key) + "\":") != record.npos;
}

// Returns a line that fits the terminal; whole lines go to files and pipes.
std::string Fitting(std::string line)
{
    if (!IsTerminal(stderr) || line.size() < TerminalWidth(stderr))
        return line;
    return std::string(FirstCharacters(line, TerminalWidth(stderr) - 4)) + "...";
}

void SayLine(const std::string& line)
{
    std::fputs((Fitting("  " + line) + '\n').c_str(), stderr);
}

std::string FirstLine(const std::string& text)
{
    return text.substr(0, text.find('\n'));
}

struct KindRow
{
    size_t sources;
    std::string words;
};

template <class Kinds>
void SayKinds(const char* title, const Kinds& kinds)
{
    std::vector<KindRow> rows;
    rows.reserve(kinds.size());
    for (const auto& [code, kind] : kinds)
        rows.push_back({kind.sources, kind.words});
    std::ranges::stable_sort(rows, std::ranges::greater(), &KindRow::sources);
    if (!rows.empty())
        SayPlain(title);
    for (size_t i = 0; i < std::min(rows.size(), kNamedKinds); ++i)
    {
        char count[32];
        std::snprintf(count, sizeof count, "%6zu  ", rows[i].sources);
        SayLine(count + rows[i].words);
    }
    if (rows.size() > kNamedKinds)
        SayLine("        and " + std::to_string(rows.size() - kNamedKinds) + " more kinds");
}

template <class Kinds>
void WriteKinds(CJsonWriter& json, const char* key, const Kinds& kinds)
{
    json.Key(key).BeginObject();
    for (const auto& [code, kind] : kinds)
        json.Key(code).Integer(static_cast<int64_t>(kind.sources));
    json.EndObject();
}

} // namespace

void CRunSummary::Take(const std::string& source, EConversion outcome, std::string_view record)
{
    if (outcome == EConversion::Skipped) // the notices are of an earlier run
        return;
    std::vector<Notice> notices;
    ReadNotices(record, notices);
    if (outcome == EConversion::Failed)
        return TakeCause(source, notices);
    TakeWarnings(notices);
    m_uiDrafted += HasMember(record, "drafted") ? 1 : 0;
    m_uiMended += HasMember(record, "mended") ? 1 : 0;
    if (HasMember(record, "betterFigures"))
        TakeFigures(record);
}

void CRunSummary::Kind::Add(const Notice& notice)
{
    const std::string message = FirstLine(notice.words);
    common = sources == 0 || common == message ? message : std::string();
    ++sources;
    words = sources == 1 || common.empty() ? KindWords(notice) : common;
}

void CRunSummary::TakeWarnings(const std::vector<Notice>& notices)
{
    std::set<std::string> codes;
    for (const Notice& notice : notices)
    {
        if (notice.IsWarning() && codes.insert(notice.code).second)
            m_kWarnings[notice.code].Add(notice);
    }
}

void CRunSummary::TakeCause(const std::string& source, const std::vector<Notice>& notices)
{
    const auto found = std::ranges::find_if_not(notices, &Notice::IsWarning);
    const Notice cause =
        found != notices.end() ? *found : MakeNotice(source, "unknown", "the cause is unknown");
    m_uiMendable += NamesMending(cause) ? 1 : 0;
    m_kCauses[cause.code].Add(cause);
    if (m_uiFailed == 0)
        m_kFirst = cause;
    ++m_uiFailed;
    if (m_kFailed.size() < kNamedFailures)
        m_kFailed.push_back((cause.path == source ? "" : Printable(source) + ": ") +
                            FirstLine(NoticeLine(cause)));
}

void CRunSummary::TakeFigures(std::string_view record)
{
    CJsonMembers members;
    members.Read(record);
    const CJsonMembers::Member* const text = members.Find("figures");
    const CJsonMembers::Member* const betterText = members.Find("betterFigures");
    if (!text || !betterText)
        return;
    CJsonMembers figures;
    CJsonMembers better;
    figures.Read(text->text);
    better.Read(betterText->text);
    ++m_uiBetter;
    for (const FigureWords& figure : kBetterFigures)
    {
        const CJsonMembers::Member* const is = figures.Find(figure.key);
        const CJsonMembers::Member* const would = better.Find(figure.key);
        if (!is || !would || is->kind == CJsonMembers::EKind::Null ||
            would->kind == CJsonMembers::EKind::Null)
            continue;
        Improvement& improvement = m_kBetter[figure.key];
        improvement.is += is->number;
        improvement.would += would->number;
        ++improvement.results;
    }
}

void CRunSummary::Tell(const ShellOptions& options, const RunTally& tally, bool areFailuresTold) const
{
    if (options.json)
        WriteJson(options, tally);
    else
        Say(options, tally, areFailuresTold);
}

void CRunSummary::Say(const ShellOptions& options, const RunTally& tally, bool areFailuresTold) const
{
    if (!options.quiet)
        SayKinds("warnings, by the number of files:", m_kWarnings);
    if (!options.quiet && (!areFailuresTold || m_uiFailed > 1)) // one that was told would be repeated
        SayKinds("causes of failures, by the number of files:", m_kCauses);
    if (!areFailuresTold)
        SayFailures();
    if (!options.quiet)
        SayHelp(options);
    if (m_uiBetter > 0 && !options.quiet)
        SayBetter();
    SayWord(options, TallyWords(options, tally) +
                         (options.draft ? ", " + std::to_string(m_uiDrafted) + " by drafted profiles" : "") +
                         (options.mend ? ", " + std::to_string(m_uiMended) + " mended" : ""));
}

// Each command line is helped once, not every file.
void CRunSummary::SayHelp(const ShellOptions& options) const
{
    if (!options.draft && (m_kCauses.contains("misfit") || m_kCauses.contains("doubtful")))
        SayPlain("--draft makes profiles for skeletons that no installed one fits");
    if (!options.mend && m_uiMendable > 0)
        SayPlain("--mend reads " + std::to_string(m_uiMendable) + " of the failed files repaired");
}

void CRunSummary::SayBetter() const
{
    SayPlain("directions, feet or the floor are far off in " + std::to_string(m_uiBetter) +
             " of the results; --align --faithful would give (measured, on average):");
    for (const FigureWords& figure : kBetterFigures)
    {
        const auto found = m_kBetter.find(figure.key);
        if (found == m_kBetter.end())
            continue;
        const auto& [is, would, results] = found->second;
        char words[96];
        std::snprintf(words, sizeof words, "%s %.1f instead of %.1f %s", figure.words,
                      would / static_cast<double>(results), is / static_cast<double>(results), figure.unit);
        SayLine(words);
    }
}

void CRunSummary::SayFailures() const
{
    if (m_uiFailed > 0)
        SayPlain("failed:");
    for (const std::string& line : m_kFailed)
        SayLine(line);
    if (m_uiFailed > m_kFailed.size())
        SayLine(std::to_string(m_uiFailed - m_kFailed.size()) +
                " more; a report (--report FILE) lists all, and so does --verbose");
}

// A failure of the run itself matters more than that of a source.
Notice CRunSummary::CauseOf(const RunTally& tally) const
{
    if (!FirstError().words.empty())
        return FirstError();
    return m_uiFailed > 0 ? m_kFirst
                          : MakeNotice({}, "unfinished", std::to_string(tally.left) + " sources are left");
}

void CRunSummary::WriteJson(const ShellOptions& options, const RunTally& tally) const
{
    CJsonWriter json(stdout);
    json.BeginObject();
    json.Key("summary").Bool(true);
    if (tally[EConversion::Failed] + tally.left == 0 && FirstError().words.empty())
        WriteStatus(json, "ok");
    else
        WriteFailed(json, CauseOf(tally));
    WriteTally(json, options, tally);
    if (options.draft)
        json.Key("drafted").Integer(static_cast<int64_t>(m_uiDrafted));
    if (options.mend)
        json.Key("mended").Integer(static_cast<int64_t>(m_uiMended));
    WriteKinds(json, "causes", m_kCauses);
    WriteKinds(json, "warnings", m_kWarnings);
    json.EndObject();
    json.EndDocument();
}

} // namespace gw
