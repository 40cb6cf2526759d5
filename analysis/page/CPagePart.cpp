#include "CPagePart.h"

#include "CConversionSection.h"
#include "CMarkup.h"
#include "ConvertedMotion.h"
#include "KeyFigures.h"

#include <algorithm>
#include <charconv>
#include <iterator>

namespace gw {

namespace {

// Points per curve: at most two per pixel of a wide screen. With many motions there are fewer, so that a
// thousand motions take only a few dozen megabytes.
constexpr size_t kMostPoints = 2000;
constexpr size_t kLeastPoints = 200;
constexpr size_t kPointsOfPage = 40000;

// cannot occur in markup, because control characters of names are escaped
constexpr char kDivider = '\0';

size_t PointsFor(size_t motionCount)
{
    return std::clamp(kPointsOfPage / std::max<size_t>(motionCount, 1), kLeastPoints, kMostPoints);
}

void AppendCell(CMarkup& row, const KeyFigure& figure)
{
    row.Raw("<td class=\"").Raw(VerdictClass(figure.verdict)).Raw("\" title=\"");
    row.Raw(VerdictWord(figure.verdict)).Raw("\"><em>").Raw(VerdictSign(figure.verdict)).Raw("</em> ");
    AppendFigure(row, figure);
    row.Raw("</td>");
}

} // namespace

CPagePart::CPagePart(size_t number, size_t motionCount) : m_uiNumber(number), m_uiMotionCount(motionCount) {}

std::string CPagePart::SummaryRow(const ConvertedMotion& motion, const std::string& anchor)
{
    const std::vector<KeyFigure> figures = KeyFiguresOf(motion.measured->sums, motion.measured->detail);
    m_fBadness = BadnessOf(figures);
    CMarkup row;
    row.Raw("<tr><td class=\"word\"><a href=\"#").Raw(anchor).Raw("\">").FileName(motion.source);
    row.Raw("</a></td><td>").Integer(motion.measured->sums.frameCount).Raw("</td>");
    for (const KeyFigure& figure : figures)
        AppendCell(row, figure);
    return row.Raw("</tr>\n").Text();
}

void CPagePart::Show(const ConvertedMotion& motion)
{
    const std::string anchor = "motion" + std::to_string(m_uiNumber);
    m_kRow = SummaryRow(motion, anchor);
    CMarkup section;
    CConversionSection(motion, PointsFor(m_uiMotionCount)).Append(section, anchor);
    m_kSection = section.Text();
}

std::string CPagePart::ToText() const
{
    if (!HasFigures())
        return {};
    char digits[64];
    std::string text(digits, std::to_chars(digits, std::end(digits), m_fBadness).ptr);
    text += kDivider;
    text += m_kRow;
    text += kDivider;
    return text += m_kSection;
}

bool CPagePart::FromText(std::string_view text)
{
    const size_t row = text.find(kDivider);
    const size_t section = row == text.npos ? row : text.find(kDivider, row + 1);
    if (section == text.npos)
        return false;
    std::from_chars(text.data(), text.data() + row, m_fBadness);
    m_kRow = text.substr(row + 1, section - row - 1);
    m_kSection = text.substr(section + 1);
    return HasFigures();
}

} // namespace gw
