#include "Tables.h"

#include "CMarkup.h"
#include "ConvertedMotion.h"

#include <algorithm>
#include <cmath>
#include <initializer_list>
#include <string_view>

namespace gw {

namespace {

constexpr double kFullBar = 30.0; // degrees for a full-width bar

// Begins a table: text columns, the mean error, the mean error of the default conversion if there is one, and
// the other numbers.
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

// Appends a number after a bar, so that large ones stand out.
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

// Appends the cell of the default conversion; without a figure the cell is empty.
template <class Record>
void PlainCell(CMarkup& page, const Record* record)
{
    if (record)
        NumberCell(page, record->meanError, 3);
    else
        page.Raw("<td></td>");
}

// A row of the tables of feet and hands. The function appends a cell's content.
template <class Record>
struct RecordRow
{
    std::string_view label;
    void (*append)(CMarkup& page, const Record& record);
};

template <auto member, int decimals>
void One(CMarkup& page, const FootMeasures& foot)
{
    page.Number(static_cast<double>(foot.*member), decimals);
}

// Appends a figure, followed by the source's.
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

void HeldSole(CMarkup& page, const FootMeasures& foot)
{
    page.Number(foot.heldSole.value_or(0.0), 2);
}

void LargestHeldSole(CMarkup& page, const FootMeasures& foot)
{
    page.Number(foot.heldSoleLargest.value_or(0.0), 2).Raw(" <small>frame ");
    page.Integer(foot.heldSoleFrame).Raw("</small>");
}

// For a foot that never stands in the source, figures of standing feet are "none".
template <void (*append)(CMarkup&, const FootMeasures&)>
void Standing(CMarkup& page, const FootMeasures& foot)
{
    if (foot.sourceContacts > 0)
        append(page, foot);
    else
        page.Raw("none");
}

void Plants(CMarkup& page, const SlideMeasures& slide)
{
    page.Integer(static_cast<long long>(slide.plants));
}

void MedianSlide(CMarkup& page, const SlideMeasures& slide)
{
    page.Number(slide.median, 2);
}

void LargestSlide(CMarkup& page, const SlideMeasures& slide)
{
    page.Number(slide.largest, 2).Raw(" <small>frame ").Integer(slide.largestFrame).Raw("</small>");
}

// For a joint that is never planted, only the number of plants is a figure; the others are "none".
template <SlideMeasures FootMeasures::*slide, void (*append)(CMarkup&, const SlideMeasures&)>
void Slides(CMarkup& page, const FootMeasures& foot)
{
    if ((foot.*slide).plants > 0 || append == Plants)
        append(page, foot.*slide);
    else
        page.Raw("none");
}

using Foot = FootMeasures;

// Rows are function calls, because the formatter keeps their layout.
constexpr RecordRow<FootMeasures> FootRow(std::string_view label,
                                          void (*append)(CMarkup&, const FootMeasures&))
{
    return {label, append};
}

constexpr RecordRow<FootMeasures> kFootRows[] = {
    FootRow("contacts", Both<&Foot::resultContacts, &Foot::sourceContacts, 0>),
    FootRow("planted frames that count", Both<&Foot::resultStanding, &Foot::sourceStanding, 0>),
    FootRow("contacts F1", F1),
    FootRow("ankle plants", Slides<&Foot::ankleSlide, Plants>),
    FootRow("added ankle slide, median mm", Slides<&Foot::ankleSlide, MedianSlide>),
    FootRow("added ankle slide, worst mm", Slides<&Foot::ankleSlide, LargestSlide>),
    FootRow("toe plants", Slides<&Foot::toeSlide, Plants>),
    FootRow("added toe slide, median mm", Slides<&Foot::toeSlide, MedianSlide>),
    FootRow("added toe slide, worst mm", Slides<&Foot::toeSlide, LargestSlide>),
    FootRow("held sole, 95 % mm", Standing<HeldSole>),
    FootRow("held sole, worst mm", Standing<LargestHeldSole>),
    FootRow("turn, mean °", One<&Foot::turnError, 2>),
    FootRow("turn while planted, mean °", Standing<One<&Foot::turnWhileStanding, 2>>),
    FootRow("turn, most °", One<&Foot::turnLargest, 2>),
    FootRow("sole tilt, mean °", Standing<Both<&Foot::soleTiltMean, &Foot::sourceSoleTiltMean, 2>>),
    FootRow("sole tilt, max °", Standing<One<&Foot::soleTiltLargest, 2>>),
    FootRow("knee pops", One<&Foot::kneePops, 0>),
    FootRow("knee pop beyond the source, max °", AtFrame<&Foot::kneePopLargest, &Foot::kneePopFrame, 2>),
};

void Gap(CMarkup& page, const HandMeasures& hand)
{
    if (!hand.gap)
        page.Raw("none");
    else
        page.Number(*hand.gap, 2).Raw(" <small>").Raw(hand.gapPart).Raw("</small>");
}

void LargestGap(CMarkup& page, const HandMeasures& hand)
{
    if (!hand.gap)
        page.Raw("none");
    else
        page.Number(hand.gapLargest, 2).Raw(" <small>frame ").Integer(hand.gapFrame).Raw("</small>");
}

void Depth(CMarkup& page, const HandMeasures& hand)
{
    page.Number(hand.depth, 2).Raw(" <small>frame ").Integer(hand.depthFrame).Raw("</small>");
}

void Touches(CMarkup& page, const HandMeasures& hand)
{
    page.Integer(static_cast<long long>(hand.touchFrames));
}

constexpr RecordRow<HandMeasures> kHandRows[] = {
    {"frames that touch", Touches   },
    {"gap, 95 % mm",      Gap       },
    {"gap, worst mm",     LargestGap},
    {"below floor, mm",   Depth     },
};

// Appends a table with one row per figure and one column per foot or hand; nothing if there are none.
template <class Record, size_t count>
void AppendRecordTable(CMarkup& page, std::string_view title, const std::vector<Record>& records,
                       const RecordRow<Record> (&rows)[count])
{
    if (records.empty())
        return;
    page.Raw("<div class=\"wide\"><table><thead><tr><th class=\"word\">").Raw(title).Raw("</th>");
    for (const Record& record : records)
        page.Raw("<th>").Name(record.target).Raw(" <small>").Name(record.source).Raw("</small></th>");
    page.Raw("</tr></thead><tbody>\n");
    for (const RecordRow<Record>& row : rows)
    {
        page.Raw("<tr><td class=\"word\">").Raw(row.label).Raw("</td>");
        for (const Record& record : records)
        {
            page.Raw("<td>");
            row.append(page, record);
            page.Raw("</td>");
        }
        page.Raw("</tr>\n");
    }
    EndTable(page);
}

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
    BeginTable(page, {"bone", "source"}, {"max °", "at frame"}, plain != nullptr);
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
        page.Raw("</tr>\n");
    }
    page.Raw("<tr class=\"sum\"><td class=\"word\">all</td><td></td>");
    BarCell(page, measured.sums.meanError);
    if (plain)
        NumberCell(page, plain->sums.meanError, 3);
    NumberCell(page, measured.sums.largestError, 3);
    page.Raw("<td></td>");
    page.Raw("</tr>\n");
    EndTable(page);
}

void AppendFeetAndHands(CMarkup& page, const MeasuredConversion& measured)
{
    AppendRecordTable(page, "feet", measured.sums.feet, kFootRows);
    AppendRecordTable(page, "hands", measured.sums.hands, kHandRows);
}

} // namespace gw
