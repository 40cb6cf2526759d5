#include "CConversionPage.h"

#include "CMarkup.h"
#include "CPagePart.h"
#include "CSafeFile.h"
#include "ConversionDetail.h"
#include "ConversionMeasures.h"
#include "KeyFigures.h"
#include "PageStyle.h"
#include "Paths.h"

#include <algorithm>
#include <limits>

namespace gw {

void CConversionPage::Add(const std::string& source, const CPagePart& part)
{
    ++m_uiSections;
    m_kSections.Write(part.Section());
    m_kRows.push_back({source, part.Row(), part.Badness()});
}

void CConversionPage::AddWithoutFigures(const std::string& source, const std::string& outcome)
{
    CMarkup row;
    row.Raw("<tr><td class=\"word\">").FileName(source).Raw("</td><td class=\"word none\" colspan=\"");
    row.Integer(static_cast<long long>(KeyFigureCount()) + 1).Raw("\">").Name(outcome).Raw("</td></tr>\n");
    m_kRows.push_back({source, row.Text(), std::numeric_limits<double>::infinity()});
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
    page.Raw(
        "<h1>Conversion report</h1>\n<p class=\"about\">The result compared with the source, at every frame "
        "of the source, starting at 0. Lengths are millimeters of the result; the source is scaled to "
        "the result's leg length.</p>\n");
    if (m_kRows.size() > 1 || m_uiSections == 0)
        AppendSummary(page);
    return page.Text();
}

void CConversionPage::AppendSummary(CMarkup& page) const
{
    std::vector<const Row*> rows;
    for (const Row& row : m_kRows)
        rows.push_back(&row);
    std::ranges::stable_sort(rows, std::ranges::greater(), &Row::badness);
    page.Raw("<div class=\"wide\"><table class=\"summary\"><thead><tr><th class=\"word\">source, worst "
             "first</th><th>frames</th>");
    for (const KeyFigure& figure : KeyFiguresOf({}, {}))
        page.Raw("<th>").Raw(figure.label).Raw("</th>");
    page.Raw("</tr></thead><tbody>\n");
    for (const Row* row : rows)
        page.Raw(row->markup);
    page.Raw("</tbody></table></div>\n<p class=\"about\">");
    for (const EVerdict verdict : {EVerdict::Good, EVerdict::Fair, EVerdict::Poor, EVerdict::None})
        page.Raw(VerdictSign(verdict)).Raw(" ").Raw(VerdictWord(verdict)).Raw("   ");
    page.Raw("</p>\n");
}

std::string CConversionPage::Foot()
{
    CMarkup page;
    page.Raw("<h2>What the figures mean</h2>\n<dl>\n");
    for (const KeyFigure& figure : KeyFiguresOf({}, {}))
        page.Raw("<dt>").Raw(figure.label).Raw("</dt><dd>").Raw(figure.meaning).Raw("</dd>\n");
    page.Raw("</dl>\n</body>\n</html>\n");
    return page.Text();
}

bool CConversionPage::Write(const std::string& path)
{
    CSafeFile file;
    return file.Open(path) && file.Write(Head()) && m_kSections.CopyTo(file) && file.Write(Foot()) &&
           file.Commit();
}

} // namespace gw
