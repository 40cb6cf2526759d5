#include "Tables.h"

#include "CMarkup.h"
#include "ConvertedMotion.h"

#include <algorithm>
#include <cmath>
#include <initializer_list>
#include <string_view>

namespace gw {

namespace {

constexpr double kFullBar = 30.0; // degrees at which a bar fills its cell

// Columns of words, the mean error, that of the plain rules where there is one, and the other numbers.
void BeginTable(CMarkup& page, std::initializer_list<std::string_view> words,
                std::initializer_list<std::string_view> numbers, bool hasPlain)
{
    page.Raw("<div class=\"wide\"><table><thead><tr>");
    for (const std::string_view word : words)
        page.Raw("<th class=\"word\">").Raw(word).Raw("</th>");
    page.Raw(hasPlain ? "<th>mean °</th><th>default °</th>" : "<th>mean °</th>");
    for (const std::string_view number : numbers)
        page.Raw("<th>").Raw(number).Raw("</th>");
    page.Raw("</tr></thead><tbody>\n");
}

void EndTable(CMarkup& page)
{
    page.Raw("</tbody></table></div>\n");
}

void NameCell(CMarkup& page, std::string_view name)
{
    page.Raw("<td class=\"word\">").Name(name).Raw("</td>");
}

void NumberCell(CMarkup& page, double value, int decimals)
{
    page.Raw("<td>").Number(value, decimals).Raw("</td>");
}

// A number with a bar before it, so that the eye finds the large ones.
void BarCell(CMarkup& page, double degrees)
{
    const double share = std::isfinite(degrees) ? std::clamp(degrees / kFullBar, 0.0, 1.0) : 1.0;
    page.Raw("<td class=\"bar\"><i style=\"--share:").Number(share, 2).Raw("\"></i>");
    page.Number(degrees, 3).Raw("</td>");
}

void FrameCell(CMarkup& page, int frame)
{
    page.Raw("<td>").Integer(frame).Raw("</td>");
}

const BoneMeasures* BoneOf(const MeasuredConversion& measured, const std::string& target)
{
    const auto bone = std::ranges::find(measured.sums.bones, target, &BoneMeasures::target);
    return bone == measured.sums.bones.end() ? nullptr : &*bone;
}

const PartMeasures* PartOf(const MeasuredConversion& measured, std::string_view name)
{
    const auto part = std::ranges::find(measured.detail.parts, name, &PartMeasures::name);
    return part == measured.detail.parts.end() ? nullptr : &*part;
}

// The column of the plain rules keeps its place where these have no such figure.
template <class Record>
void PlainCell(CMarkup& page, const Record* record)
{
    if (record)
        NumberCell(page, record->meanError, 3);
    else
        page.Raw("<td></td>");
}

// Rows of the table of feet. A cell is what its function appends.
struct FootRow
{
    std::string_view label;
    void (*append)(CMarkup& page, const FootMeasures& foot);
};

template <auto member, int decimals>
void One(CMarkup& page, const FootMeasures& foot)
{
    page.Number(static_cast<double>(foot.*member), decimals);
}

// A figure and that of the source behind it.
template <auto member, auto sourceMember, int decimals>
void Both(CMarkup& page, const FootMeasures& foot)
{
    page.Number(static_cast<double>(foot.*member), decimals).Raw(" <small>source ");
    page.Number(static_cast<double>(foot.*sourceMember), decimals).Raw("</small>");
}

template <auto member, auto frame, int decimals>
void AtFrame(CMarkup& page, const FootMeasures& foot)
{
    page.Number(static_cast<double>(foot.*member), decimals).Raw(" <small>frame ");
    page.Integer(foot.*frame).Raw("</small>");
}

void F1(CMarkup& page, const FootMeasures& foot)
{
    if (foot.contactF1)
        page.Number(*foot.contactF1, 3);
    else
        page.Raw("none");
}

using Foot = FootMeasures;

// Rows are calls, which the formatter leaves as they are read.
constexpr FootRow Row(std::string_view label, void (*append)(CMarkup&, const FootMeasures&))
{
    return {label, append};
}

constexpr FootRow kFootRows[] = {
    Row("contacts", Both<&Foot::resultContacts, &Foot::sourceContacts, 0>),
    Row("planted frames", Both<&Foot::resultStanding, &Foot::sourceStanding, 0>),
    Row("contacts F1", F1),
    Row("added slide, mean mm", One<&Foot::addedSlideMean, 2>),
    Row("added slide, max mm", AtFrame<&Foot::addedSlideLargest, &Foot::addedSlideFrame, 2>),
    Row("turn, mean °", One<&Foot::turnError, 2>),
    Row("turn while planted, mean °", One<&Foot::turnWhileStanding, 2>),
    Row("turn, most °", One<&Foot::turnLargest, 2>),
    Row("sole tilt, mean °", Both<&Foot::soleTiltMean, &Foot::sourceSoleTiltMean, 2>),
    Row("sole tilt, max °", One<&Foot::soleTiltLargest, 2>),
    Row("knee pops", One<&Foot::kneePops, 0>),
    Row("knee pop beyond the source, max °", AtFrame<&Foot::kneePopLargest, &Foot::kneePopFrame, 2>),
    Row("knee change, max °", Both<&Foot::kneeChangeLargest, &Foot::sourceKneeChangeLargest, 2>),
};

} // namespace

void AppendPartTable(CMarkup& page, const MeasuredConversion& measured, const MeasuredConversion* plain)
{
    BeginTable(page, {"part"}, {"max °", "at frame", "bone"}, plain != nullptr);
    for (const PartMeasures& part : measured.detail.parts)
    {
        if (part.boneCount == 0)
            continue;
        page.Raw("<tr>");
        NameCell(page, part.name);
        BarCell(page, part.meanError);
        if (plain)
            PlainCell(page, PartOf(*plain, part.name));
        NumberCell(page, part.largestError, 3);
        FrameCell(page, part.largestFrame);
        NameCell(page, part.largestBone);
        page.Raw("</tr>\n");
    }
    EndTable(page);
}

void AppendBoneTable(CMarkup& page, const MeasuredConversion& measured, const MeasuredConversion* plain)
{
    BeginTable(page, {"bone", "source"}, {"max °", "at frame", "jitter", "source jitter"}, plain != nullptr);
    for (const BoneMeasures& bone : measured.sums.bones)
    {
        if (!bone.measured)
            continue;
        page.Raw("<tr>");
        NameCell(page, bone.target);
        NameCell(page, bone.source);
        BarCell(page, bone.meanError);
        if (plain)
            PlainCell(page, BoneOf(*plain, bone.target));
        NumberCell(page, bone.largestError, 3);
        FrameCell(page, bone.largestFrame);
        NumberCell(page, bone.resultJitter, 5);
        NumberCell(page, bone.sourceJitter, 5);
        page.Raw("</tr>\n");
    }
    page.Raw("<tr class=\"sum\"><td class=\"word\">all</td><td></td>");
    BarCell(page, measured.sums.meanError);
    if (plain)
        NumberCell(page, plain->sums.meanError, 3);
    NumberCell(page, measured.sums.largestError, 3);
    page.Raw("<td></td>");
    NumberCell(page, measured.sums.resultJitter, 5);
    NumberCell(page, measured.sums.sourceJitter, 5);
    page.Raw("</tr>\n");
    EndTable(page);
}

void AppendFootTable(CMarkup& page, const MeasuredConversion& measured)
{
    const std::vector<FootMeasures>& feet = measured.sums.feet;
    if (feet.empty())
        return;
    page.Raw("<div class=\"wide\"><table><thead><tr><th class=\"word\">feet</th>");
    for (const FootMeasures& foot : feet)
        page.Raw("<th>").Name(foot.target).Raw(" <small>").Name(foot.source).Raw("</small></th>");
    page.Raw("</tr></thead><tbody>\n");
    for (const FootRow& row : kFootRows)
    {
        page.Raw("<tr><td class=\"word\">").Raw(row.label).Raw("</td>");
        for (const FootMeasures& foot : feet)
        {
            page.Raw("<td>");
            row.append(page, foot);
            page.Raw("</td>");
        }
        page.Raw("</tr>\n");
    }
    EndTable(page);
}

} // namespace gw
