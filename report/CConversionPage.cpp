#include "CConversionPage.h"

#include "CConversionSection.h"
#include "CSafeFile.h"
#include "PageStyle.h"
#include "Paths.h"

#include <algorithm>
#include <limits>

namespace gw {

namespace {

// Points of one curve: two for each pixel of a wide screen at most, and for many motions so few that a
// thousand of them make some dozen megabytes.
constexpr size_t kMostPoints = 2000;
constexpr size_t kLeastPoints = 200;
constexpr size_t kPointsOfPage = 40000;

size_t PointsFor(size_t motionCount)
{
    return std::clamp(kPointsOfPage / std::max<size_t>(motionCount, 1), kLeastPoints, kMostPoints);
}

std::string Anchor(size_t section)
{
    return "motion" + std::to_string(section);
}

} // namespace

CConversionPage::CConversionPage(size_t motionCount) : m_uiMotionCount(motionCount) {}

void CConversionPage::Add(const ConvertedMotion& motion)
{
    Row row;
    row.source = motion.source;
    row.frameCount = motion.measured->sums.frameCount;
    row.figures = KeyFiguresOf(motion.measured->sums, motion.measured->detail);
    row.badness = BadnessOf(row.figures);
    row.section = ++m_uiSections;
    CMarkup section;
    CConversionSection(motion, PointsFor(m_uiMotionCount)).Append(section, Anchor(row.section));
    m_kSections.Write(section.Text());
    m_kRows.push_back(std::move(row));
}

void CConversionPage::AddWithoutFigures(const std::string& source, const std::string& outcome)
{
    Row row;
    row.source = source;
    row.outcome = outcome;
    row.badness = std::numeric_limits<double>::infinity();
    m_kRows.push_back(std::move(row));
}

std::string CConversionPage::Head() const
{
    CMarkup page;
    page.Raw("<!DOCTYPE html>\n<html lang=\"en\">\n<head>\n<meta charset=\"utf-8\"/>\n"
             "<meta name=\"viewport\" content=\"width=device-width, initial-scale=1\"/>\n"
             "<meta name=\"color-scheme\" content=\"light dark\"/>\n<title>");
    if (m_kRows.size() == 1)
        page.Name(SplitPath(m_kRows[0].source).stem);
    else
        page.Integer(static_cast<long long>(m_kRows.size())).Raw(" motions");
    page.Raw(": conversion report</title>\n<style>\n").Raw(kPageStyle).Raw("</style>\n</head>\n<body>\n");
    page.Raw("<h1>Conversion report</h1>\n<p class=\"about\">Result against source, at every frame of the "
             "source, counted from 0. Lengths are the result's millimetres; the source is scaled to the "
             "result's legs.</p>\n");
    if (m_kRows.size() > 1 || m_uiSections == 0)
        AppendSummary(page);
    return page.Text();
}

void CConversionPage::AppendSummaryRow(CMarkup& page, const Row& row)
{
    page.Raw("<tr><td class=\"word\">");
    if (!row.outcome.empty())
    {
        page.FileName(row.source).Raw("</td><td class=\"word none\" colspan=\"");
        page.Integer(static_cast<long long>(KeyFigureCount() + 1)).Raw("\">");
        page.Name(row.outcome).Raw("</td></tr>\n");
        return;
    }
    page.Raw("<a href=\"#").Raw(Anchor(row.section)).Raw("\">").FileName(row.source).Raw("</a></td><td>");
    page.Integer(row.frameCount).Raw("</td>");
    for (const KeyFigure& figure : row.figures)
    {
        page.Raw("<td class=\"").Raw(VerdictClass(figure.verdict)).Raw("\" title=\"");
        page.Raw(VerdictWord(figure.verdict)).Raw("\"><em>").Raw(VerdictSign(figure.verdict)).Raw("</em> ");
        AppendFigure(page, figure);
        page.Raw("</td>");
    }
    page.Raw("</tr>\n");
}

void CConversionPage::AppendSummary(CMarkup& page) const
{
    std::vector<const Row*> rows;
    for (const Row& row : m_kRows)
        rows.push_back(&row);
    std::ranges::stable_sort(rows, std::ranges::greater(), &Row::badness);
    page.Raw("<div class=\"wide\"><table class=\"summary\"><thead><tr><th class=\"word\">source, the worst "
             "first</th><th>frames</th>");
    for (const KeyFigure& figure : KeyFiguresOf({}, {}))
        page.Raw("<th>").Raw(figure.label).Raw("</th>");
    page.Raw("</tr></thead><tbody>\n");
    for (const Row* row : rows)
        AppendSummaryRow(page, *row);
    page.Raw("</tbody></table></div>\n<p class=\"about\">");
    for (const EVerdict verdict : {EVerdict::Good, EVerdict::Fair, EVerdict::Poor, EVerdict::None})
        page.Raw(VerdictSign(verdict)).Raw(" ").Raw(VerdictWord(verdict)).Raw("   ");
    page.Raw("</p>\n");
}

bool CConversionPage::Write(const std::string& path)
{
    CSafeFile file;
    return file.Open(path) && file.Write(Head()) && m_kSections.CopyTo(file) &&
           file.Write(std::string_view("</body>\n</html>\n")) && file.Commit();
}

} // namespace gw
