#include "PageTable.h"

#include "CMarkup.h"
#include "ConversionDetail.h"
#include "ConversionMeasures.h"
#include "PageStyle.h"
#include "Paths.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>
#include <map>
#include <unordered_map>

namespace gw {

namespace {

constexpr size_t kOpenFailures = 20; // a longer list is folded

// Texts that many rows share, such as folders and profiles, are stored once.
class CTextList
{
public:
    size_t IndexOf(const std::string& text)
    {
        const auto [found, isNew] = m_kIndices.try_emplace(text, m_kTexts.size());
        if (isNew)
            m_kTexts.push_back(text);
        return found->second;
    }
    void Append(CMarkup& page) const
    {
        page.Raw("[");
        for (size_t i = 0; i < m_kTexts.size(); ++i)
            page.Raw(i > 0 ? "," : "").JsonText(m_kTexts[i]);
        page.Raw("]");
    }

private:
    std::unordered_map<std::string, size_t> m_kIndices;
    std::vector<std::string> m_kTexts;
};

struct TextLists
{
    CTextList folders;
    CTextList profiles;
    CTextList confidences;
    CTextList warnings;
};

struct ColumnRow
{
    std::string_view label;
    bool isWord; ///< aligned like text
};
constexpr ColumnRow kColumns[] = {
    {"folder",     true },
    {"file",       true },
    {"map",        true },
    {"confidence", true },
    {"frames",     false},
    {"warnings",   false},
};

CMarkup& AppendIndex(CMarkup& page, size_t index)
{
    return page.Integer(static_cast<long long>(index)).Raw(",");
}

void AppendWarnings(CMarkup& page, const PageRow& row, CTextList& kinds)
{
    page.Raw("[");
    for (size_t i = 0; i < row.warnings.size(); ++i)
        page.Raw(i > 0 ? "," : "").Integer(static_cast<long long>(kinds.IndexOf(row.warnings[i])));
    page.Raw("]");
}

// One letter per figure: the first one of its class in the style sheet.
std::string VerdictLetters(const std::vector<KeyFigure>& figures)
{
    std::string letters;
    for (const KeyFigure& figure : figures)
        letters += VerdictClass(figure.verdict).front();
    return letters;
}

void AppendRow(CMarkup& page, const RankedRow& ranked, TextLists& lists)
{
    const PageRow& row = *ranked.row;
    const PathParts parts = SplitPath(row.source);
    page.Raw("[");
    AppendIndex(page, lists.folders.IndexOf(parts.folder)).JsonText(parts.stem + parts.extension).Raw(",");
    AppendIndex(page, lists.profiles.IndexOf(row.profile));
    AppendIndex(page, lists.confidences.IndexOf(row.confidence)).Integer(row.frames).Raw(",");
    AppendWarnings(page, row, lists.warnings);
    page.Raw(",").Integer(ranked.hasSection ? static_cast<long long>(ranked.number) : 0);
    page.Raw(",\"").Raw(VerdictLetters(ranked.figures)).Raw("\"");
    for (const KeyFigure& figure : ranked.figures)
    {
        page.Raw(",");
        if (figure.value && std::isfinite(*figure.value))
            page.Number(*figure.value, figure.decimals);
        else
            page.Raw("null");
    }
    page.Raw("]");
}

void AppendData(CMarkup& page, std::span<const RankedRow> ranked)
{
    TextLists lists;
    page.Raw("<script type=\"application/json\" id=\"rows\">\n{\"rows\":[");
    for (size_t i = 0; i < ranked.size(); ++i)
    {
        page.Raw(i > 0 ? ",\n" : "\n");
        AppendRow(page, ranked[i], lists);
    }
    page.Raw("],\n\"folders\":");
    lists.folders.Append(page);
    page.Raw(",\n\"maps\":");
    lists.profiles.Append(page);
    page.Raw(",\n\"confidences\":");
    lists.confidences.Append(page);
    page.Raw(",\n\"warnings\":");
    lists.warnings.Append(page);
    page.Raw(",\n\"decimals\":[");
    const std::vector<KeyFigure> figures = KeyFiguresOf({}, {});
    for (size_t i = 0; i < figures.size(); ++i)
        page.Raw(i > 0 ? "," : "").Integer(figures[i].decimals);
    page.Raw("]}\n</script>\n");
}

void AppendHeader(CMarkup& page, std::string_view label, std::string_view unit, bool isWord)
{
    page.Raw(isWord ? "<th class=\"word\">" : "<th>").Raw("<button type=\"button\">").Raw(label);
    page.Raw("</button>");
    if (!unit.empty())
        page.Raw("<small>").Raw(unit).Raw("</small>");
    page.Raw("</th>");
}

using Failures = std::map<std::string, std::vector<const PageRow*>>;

void AppendFailureKind(CMarkup& page, const std::string& kind, const std::vector<const PageRow*>& rows)
{
    page.Raw(rows.size() <= kOpenFailures ? "<details open=\"open\"><summary><b>" : "<details><summary><b>");
    page.Integer(static_cast<long long>(rows.size())).Raw("</b> ").Name(kind).Raw("</summary>\n<ul>\n");
    for (const PageRow* row : rows)
    {
        page.Raw("<li>").Name(row->source);
        if (!row->cause.empty() && row->cause != kind)
            page.Raw("<small>").Name(row->cause).Raw("</small>");
        page.Raw("</li>\n");
    }
    page.Raw("</ul></details>\n");
}

void AppendTotal(CMarkup& page, size_t count, std::string_view what, std::string_view style)
{
    page.Raw("<div class=\"tile ").Raw(style).Raw("\"><span>").Raw(what).Raw("</span><strong>");
    page.Integer(static_cast<long long>(count)).Raw("</strong></div>\n");
}

EVerdict WorstVerdict(const std::vector<KeyFigure>& figures)
{
    for (const EVerdict verdict : {EVerdict::Poor, EVerdict::Fair, EVerdict::Good})
    {
        if (std::ranges::count(figures, verdict, &KeyFigure::verdict) > 0)
            return verdict;
    }
    return EVerdict::None;
}

void AppendWarningKinds(CMarkup& page, std::span<const RankedRow> ranked)
{
    std::map<std::string, size_t> kinds;
    for (const RankedRow& row : ranked)
    {
        for (const std::string& warning : row.row->warnings)
            ++kinds[warning];
    }
    if (kinds.empty())
        return;
    std::vector<std::pair<std::string, size_t>> sorted(kinds.begin(), kinds.end());
    std::ranges::stable_sort(sorted, std::ranges::greater(), &std::pair<std::string, size_t>::second);
    page.Raw("<details><summary>Warnings by kind</summary>\n<ul>\n");
    for (const auto& [kind, count] : sorted)
        page.Raw("<li><b>").Integer(static_cast<long long>(count)).Raw("</b> ").Name(kind).Raw("</li>\n");
    page.Raw("</ul></details>\n");
}

} // namespace

std::vector<RankedRow> RankRows(std::span<const PageRow> rows)
{
    std::vector<RankedRow> ranked;
    for (size_t i = 0; i < rows.size(); ++i)
    {
        if (rows[i].outcome == "failed" || rows[i].outcome == "left")
            continue;
        RankedRow row{.row = &rows[i], .badness = -1.0, .number = i + 1};
        if (!rows[i].figures.empty())
        {
            row.figures = KeyFiguresFrom(rows[i].figures);
            row.badness = BadnessOf(row.figures);
        }
        ranked.push_back(std::move(row));
    }
    std::ranges::stable_sort(ranked, std::ranges::greater(), &RankedRow::badness);
    return ranked;
}

void AppendFailures(CMarkup& page, std::span<const PageRow> rows)
{
    Failures failures;
    size_t count = 0;
    for (const PageRow& row : rows)
    {
        if (row.outcome != "failed")
            continue;
        failures[row.causeKind.empty() ? "the cause is unknown" : row.causeKind].push_back(&row);
        ++count;
    }
    if (count == 0)
        return;
    std::vector<const Failures::value_type*> sorted;
    for (const Failures::value_type& kind : failures)
        sorted.push_back(&kind);
    std::ranges::stable_sort(sorted, std::ranges::greater(),
                             [](const Failures::value_type* kind) { return kind->second.size(); });
    page.Raw("<div class=\"failures\">\n<h2>Failed: ").Integer(static_cast<long long>(count)).Raw("</h2>\n");
    for (const Failures::value_type* kind : sorted)
        AppendFailureKind(page, kind->first, kind->second);
    page.Raw("</div>\n");
}

void AppendTotals(CMarkup& page, std::span<const PageRow> rows, std::span<const RankedRow> ranked)
{
    page.Raw("<h3>Totals</h3>\n<div class=\"tiles totals\">\n");
    for (const std::string_view outcome : {"failed", "left", "converted", "skipped"})
    {
        const auto count = static_cast<size_t>(std::ranges::count(rows, outcome, &PageRow::outcome));
        if (count > 0 || outcome == "converted")
            AppendTotal(page, count, outcome == "left" ? "not reached" : outcome,
                        outcome == "failed" ? "poor" : "");
    }
    std::array<size_t, 4> verdicts{};
    for (const RankedRow& row : ranked)
        ++verdicts[static_cast<size_t>(WorstVerdict(row.figures))];
    constexpr std::string_view kLabels[] = {"all figures good", "worst figure is fair",
                                            "worst figure is poor", "not measured"};
    for (const EVerdict verdict : {EVerdict::Poor, EVerdict::Fair, EVerdict::Good, EVerdict::None})
    {
        const auto index = static_cast<size_t>(verdict);
        if (verdicts[index] > 0)
            AppendTotal(page, verdicts[index], kLabels[index], VerdictClass(verdict));
    }
    page.Raw("</div>\n");
    AppendWarningKinds(page, ranked);
}

void AppendRunTable(CMarkup& page, std::span<const RankedRow> ranked)
{
    if (ranked.empty())
        return;
    page.Raw("<h3>All results, worst first</h3>\n<p class=\"finder\"><input type=\"search\" id=\"find\" "
             "placeholder=\"folder, file, map or warning\" aria-label=\"Show only rows that contain this "
             "text\"/> <span id=\"shown\"></span></p>\n"
             "<noscript><p class=\"about\">The table needs scripts.</p></noscript>\n"
             "<div class=\"wide\"><table class=\"summary\" id=\"results\"><thead><tr>");
    for (const ColumnRow& column : kColumns)
        AppendHeader(page, column.label, {}, column.isWord);
    for (const KeyFigure& figure : KeyFiguresOf({}, {}))
        AppendHeader(page, figure.label, figure.unit, false);
    page.Raw("</tr></thead><tbody></tbody></table></div>\n"
             "<p><button type=\"button\" id=\"more\" hidden=\"hidden\">Show more</button></p>\n"
             "<p class=\"about\">");
    for (const EVerdict verdict : {EVerdict::Good, EVerdict::Fair, EVerdict::Poor, EVerdict::None})
        page.Raw(VerdictSign(verdict)).Raw(" ").Raw(VerdictWord(verdict)).Raw("   ");
    page.Raw("</p>\n");
    AppendData(page, ranked);
    page.Raw("<script>\n").Raw(kTableScript).Raw("</script>\n");
}

} // namespace gw
