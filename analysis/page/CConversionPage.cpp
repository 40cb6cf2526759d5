#include "CConversionPage.h"

#include "CMarkup.h"
#include "CPagePart.h"
#include "CSafeFile.h"
#include "ConversionDetail.h"
#include "ConversionMeasures.h"
#include "KeyFigures.h"
#include "PageStyle.h"
#include "PageTable.h"
#include "Paths.h"

#include <algorithm>

namespace gw {

void CConversionPage::AddDetails(const CPagePart& part)
{
    if (!part.HasFigures() || IsDetailed(part.Number()))
        return;
    m_kDetailed.push_back(part.Number());
    m_kSections.Write(part.Section());
}

bool CConversionPage::IsDetailed(size_t number) const
{
    return std::ranges::find(m_kDetailed, number) != m_kDetailed.end();
}

std::vector<size_t> CConversionPage::WorstWithoutDetails() const
{
    std::vector<size_t> worst;
    const std::vector<RankedRow> ranked = RankRows(m_kRows);
    for (const RankedRow& row : std::span(ranked).first(std::min(ranked.size(), kDetailCount)))
    {
        if (!row.figures.empty() && !IsDetailed(row.number))
            worst.push_back(row.number - 1);
    }
    return worst;
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
    if (m_kRows.size() > 1)
        AppendOverview(page);
    return page.Text();
}

void CConversionPage::AppendOverview(CMarkup& page) const
{
    std::vector<RankedRow> ranked = RankRows(m_kRows);
    for (RankedRow& row : ranked)
        row.hasSection = IsDetailed(row.number);
    AppendFailures(page, m_kRows);
    AppendTotals(page, m_kRows, ranked);
    AppendRunTable(page, ranked);
    if (!m_kDetailed.empty() && m_kDetailed.size() < ranked.size())
        page.Raw("<h3>The worst ")
            .Integer(static_cast<long long>(m_kDetailed.size()))
            .Raw(" in detail</h3>\n");
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
