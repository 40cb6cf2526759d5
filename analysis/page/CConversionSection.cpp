#include "CConversionSection.h"

#include "FigureDrawing.h"
#include "HostBones.h"
#include "PathDrawing.h"
#include "Player.h"
#include "SourceScale.h"
#include "Tables.h"

#include <algorithm>
#include <iterator>

namespace gw {

namespace {

constexpr size_t kWorstFrames = 3;

// The text around a fault's bone name and amount. All of it may be empty.
struct FaultSentence
{
    std::string_view before; // before the bone's name
    std::string_view after;  // between the name and the amount
    std::string_view end;
};

// Indexed by EFrameFault. A direction has two amounts and its own code.
constexpr FaultSentence kFaults[] = {
    {"",                       "",                             ""                                     },
    {"the line from hips to ", " leans ",                      "° away from the source's"            },
    {"the knee above ",        " jumps by ",                   "° more than in the source"           },
    {"",                       " is planted but slides ",      " mm farther than in the source"       },
    {"the toe of ",            " is planted but slides ",      " mm farther than in the source"       },
    {"",                       " is planted but its sole is ", " mm off the floor"                    },
    {"",                       " is ",                         " mm off what it touches in the source"},
    {"",                       " is ",                         " mm below the floor"                  },
};

void AppendFault(CMarkup& page, const WorstFrame& worst)
{
    if (worst.fault == EFrameFault::Direction)
    {
        page.Raw("mean error of the main bones ").Number(worst.amount, 1).Raw("°, largest at ");
        page.Name(worst.target).Raw(", ").Number(worst.most, 1).Raw("°");
        return;
    }
    const FaultSentence& words = kFaults[static_cast<size_t>(worst.fault)];
    page.Raw(words.before).Name(worst.target).Raw(words.after).Number(worst.amount, 1).Raw(words.end);
    if (!worst.part.empty())
        page.Raw(": ").Raw(worst.part);
}

std::vector<float> Heights(const std::vector<Vec3>& places)
{
    std::vector<float> heights;
    std::ranges::transform(places, std::back_inserter(heights), &Vec3::y);
    return heights;
}

void AddBothSides(Chart& chart, std::span<const float> source, std::span<const float> result)
{
    chart.curves.push_back({"source", "source", source});
    chart.curves.push_back({"result", "result", result});
}

} // namespace

CConversionSection::CConversionSection(const ConvertedMotion& motion, const SectionExtent& extent)
    : motion_(motion), m_kExtent(extent),
      m_kWorst(FindWorstFrames(motion.measured->sums, motion.measured->detail, kWorstFrames))
{
    for (const WorstFrame& worst : m_kWorst)
        m_kMarks.push_back({worst.frame, m_kMarks.size() + 1});
}

void CConversionSection::Append(CMarkup& page, const std::string& anchor)
{
    page.Raw("<section id=\"").Raw(anchor).Raw("\">\n");
    AppendHead(page);
    AppendTiles(page);
    if (m_kExtent.hasPlayer)
        AppendPlayer(page, motion_, m_kMarks);
    AppendWorstFrames(page);
    page.Raw("<h3>Over time</h3>\n<div class=\"charts\">\n");
    AppendCurves(page);
    page.Raw("</div>\n<h3>Measurements</h3>\n<div class=\"tables\">\n<div>\n");
    AppendPartTable(page, *motion_.measured, motion_.plain);
    AppendFeetAndHands(page, *motion_.measured);
    page.Raw("</div>\n");
    AppendBoneTable(page, *motion_.measured, motion_.plain);
    page.Raw("</div>\n</section>\n");
}

void CConversionSection::AppendHead(CMarkup& page) const
{
    const ConversionMeasures& sums = motion_.measured->sums;
    page.Raw("<h2><span class=\"source\">").FileName(motion_.source).Raw("</span> → <span class=\"result\">");
    page.FileName(motion_.result).Raw("</span></h2>\n<p class=\"about\">profile ").Name(motion_.profile);
    page.Raw(" · ").Integer(sums.frameCount).Raw(" frames compared · ");
    page.Number(sums.frameCount * motion_.measured->detail.secondsPerFrame, 2).Raw(" s");
    if (!motion_.model.empty())
        page.Raw(" · <a href=\"").Link(motion_.model).Raw("\">3D model (.glb)</a>");
    page.Raw("</p>\n");
    if (!motion_.advice.empty())
        page.Raw("<p class=\"about\">").Raw(motion_.advice).Raw("</p>\n");
}

void CConversionSection::AppendTiles(CMarkup& page) const
{
    const std::vector<KeyFigure> figures = KeyFiguresOf(motion_.measured->sums, motion_.measured->detail);
    std::vector<KeyFigure> plain;
    if (motion_.plain)
        plain = KeyFiguresOf(motion_.plain->sums, motion_.plain->detail);
    page.Raw("<div class=\"tiles\">\n");
    for (size_t i = 0; i < figures.size(); ++i)
    {
        const KeyFigure& figure = figures[i];
        page.Raw("<div class=\"tile ").Raw(VerdictClass(figure.verdict)).Raw("\"><span>");
        page.Raw(figure.label).Raw("</span><strong>");
        AppendFigure(page, figure);
        page.Raw("</strong><em>").Raw(VerdictSign(figure.verdict)).Raw(" ").Raw(VerdictWord(figure.verdict));
        page.Raw("</em>");
        if (!plain.empty())
        {
            page.Raw("<small class=\"plain\">default ");
            AppendFigure(page, plain[i]);
            page.Raw("</small>");
        }
        page.Raw("<small>").Raw(figure.mark).Raw("</small></div>\n");
    }
    page.Raw("</div>\n");
}

void CConversionSection::AppendWorstFrames(CMarkup& page) const
{
    const ConversionMeasures& sums = motion_.measured->sums;
    CFigurePoser source(motion_.sourceClip, sums.bones, &BoneMeasures::source);
    CFigurePoser result(motion_.resultClip, sums.bones, &BoneMeasures::target);
    if (!m_kWorst.empty())
        page.Raw("<h3>Worst frames</h3>\n<div class=\"worst\">\n");
    for (size_t i = 0; i < m_kWorst.size(); ++i)
    {
        const WorstFrame& worst = m_kWorst[i];
        FigurePair pair{source.Pose(worst.frame, worst.fault, worst.source),
                        result.Pose(worst.frame * sums.frameScale, worst.fault, worst.target),
                        result.Across(kRightBones.thigh, kLeftBones.thigh)};
        PlaceFigure(pair.source, motion_.measured->detail.sourceFloor, SourceScale(sums));
        PlaceFigure(pair.result, 0.0, 1.0);
        page.Raw("<article><p><b class=\"number\">").Integer(static_cast<long long>(i) + 1);
        page.Raw("</b> <b>Frame ").Integer(worst.frame).Raw("</b> ");
        AppendFault(page, worst);
        page.Raw("</p>\n");
        AppendFigures(page, pair);
        page.Raw("</article>\n");
    }
    if (!m_kWorst.empty())
        page.Raw("</div>\n");
}

void CConversionSection::AppendCurves(CMarkup& page) const
{
    const ConversionDetail& detail = motion_.measured->detail;
    Chart chart = NewChart("Direction error", "°");
    chart.fromZero = true;
    if (motion_.plain)
        chart.curves.push_back({"mean, default conversion", "other", motion_.plain->detail.meanError});
    chart.curves.push_back({"worst main bone", "most", detail.largestError});
    chart.curves.push_back({"mean of main bones", "result", detail.meanError});
    AppendChart(page, chart, m_kExtent.mostPoints);
    Chart trunk = NewChart("Trunk error", "°");
    trunk.fromZero = true;
    trunk.curves.push_back({"hips to neck", "result", detail.trunkError});
    AppendChart(page, trunk, m_kExtent.mostPoints);
    AppendHipHeight(page);
    for (size_t i = 0; i < detail.feet.size(); ++i)
        AppendKnee(page, detail.feet[i], motion_.measured->sums.feet[i].target);
    for (size_t i = 0; i < detail.feet.size(); ++i)
        AppendSole(page, detail.feet[i], motion_.measured->sums.feet[i].target);
    AppendPaths(page, detail.sourceHips, detail.resultHips, m_kExtent.mostPoints);
}

Chart CConversionSection::NewChart(const std::string& title, std::string_view unit) const
{
    Chart chart;
    chart.title = title;
    chart.unit = unit;
    chart.marks = m_kMarks;
    return chart;
}

void CConversionSection::AppendKnee(CMarkup& page, const FootDetail& foot, const std::string& name) const
{
    Chart chart = NewChart("Knee above " + name, "°, 0 = straight");
    chart.fromZero = true;
    AddBothSides(chart, foot.sourceKnee, foot.resultKnee);
    AppendChart(page, chart, m_kExtent.mostPoints);
}

void CConversionSection::AppendSole(CMarkup& page, const FootDetail& foot, const std::string& name) const
{
    Chart chart = NewChart("Sole of " + name, "mm above the floor");
    chart.fromZero = true;
    AddBothSides(chart, foot.sourceSole, foot.resultSole);
    chart.strips.push_back({"source planted", "source", foot.sourceContacts});
    chart.strips.push_back({"result planted", "result", foot.resultContacts});
    AppendChart(page, chart, m_kExtent.mostPoints);
}

void CConversionSection::AppendHipHeight(CMarkup& page) const
{
    const ConversionDetail& detail = motion_.measured->detail;
    const std::vector<float> source = Heights(detail.sourceHips);
    const std::vector<float> result = Heights(detail.resultHips);
    Chart chart = NewChart("Height of the hips", "mm above the floor");
    AddBothSides(chart, source, result);
    AppendChart(page, chart, m_kExtent.mostPoints);
}

} // namespace gw
