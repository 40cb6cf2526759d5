// What the window offers: the bone map that fits best, and remedies for notices.

#include "CNextSteps.h"

#include "CFailureRecord.h"
#include "CMapRowTable.h"
#include "CNode.h"
#include "Captions.h"
#include "Directions.h"
#include "DoubtWords.h"
#include "FindBodyByNames.h"
#include "FindBone.h"
#include "ProfileFit.h"
#include "Text.h"
#include "UpAxis.h"

#include <algorithm>
#include <string_view>

namespace gw {

namespace {

constexpr size_t kLinesShown = 5; // what is wrong, three missing bones, and the number of the others

} // namespace

void CNextSteps::MeasureFits(std::span<const std::string> folders, CNode* source, CNode* target)
{
    m_kFits = {};
    if (source && target)
        m_kFits.Measure(folders, *source, *target);
}

// The rest pose does not always show the axis, so the motion is examined too.
void CNextSteps::FindUp(CNode* root, const SourceTiming& timing)
{
    m_kUpAxis.clear();
    if (!root || !(timing.frequency > 0.0f) || !(timing.lastFrame >= 0.0f))
        return;
    const std::string_view up = AxisName(NearestAxis(
        FindUpAxis(FindBodyByNames(*root), timing.frequency, static_cast<int>(timing.lastFrame) + 1)));
    m_kUpAxis = up == "Y" ? "" : up;
    root->UpdateScene(0.0f, true);
}

Hint CNextSteps::SourceHint(const StepState& state)
{
    return state.source ? Hint() : Hint{"Drop a motion here, or press Ctrl+O", {}};
}

Hint CNextSteps::ResultHint(const StepState& state) const
{
    if (!state.source || state.isConverted)
        return {};
    if (!state.target)
        return {"base.htr is missing, so nothing can be converted", {}};
    if (!state.hasFrames)
        return {"This motion has no frames, so there is nothing to convert", {}};
    Hint hint;
    if (state.mapName.empty())
        hint.text = "Choose a bone map\n";
    else if (const RowMatch fit =
                 ApplyRows(state.rows, CBoneNames(state.source), CBoneNames(state.target), nullptr);
             !fit.IsWhole())
        hint.text = Printable(state.mapName) + " does not fit: " + std::to_string(fit.foundCount) + " of " +
                    std::to_string(fit.rowCount) + " rows match\n";
    else
        return ReadyHint(state);
    OfferMap(hint);
    return hint;
}

// The map that fits best, or a draft. A doubtful map is offered with its reason, and a draft beside it.
void CNextSteps::OfferMap(Hint& hint) const
{
    const ProfileChoice* const best = m_kFits.Best();
    if (!best && m_bUndraftable)
    {
        hint.text += "No map fits this skeleton, and none can be drafted. Choose any map, and edit it.";
        return;
    }
    if (!best)
    {
        hint.text += "No map fits this skeleton.";
        hint.offers = {
            {ERemedy::DraftMap, "Draft one (Ctrl+M)"}
        };
        return;
    }
    const bool doubtful = best->verdict.sureness == ESureness::Doubtful;
    hint.text += doubtful ? "Fits best, but is doubtful: " : "Fits best: ";
    hint.text += Printable(best->profile.name);
    hint.offers = {
        {ERemedy::UseMap, doubtful ? "Use anyway (Ctrl+M)" : "Use (Ctrl+M)"}
    };
    if (!doubtful)
        return;
    for (const std::string& doubt : DoubtWords(best->verdict))
        hint.text += '\n' + doubt;
    hint.offers.push_back({ERemedy::DraftMap, "Draft one"});
}

Hint CNextSteps::ReadyHint(const StepState& state) const
{
    Hint hint{"Convert (Ctrl+Return)", {}};
    if (const std::string options = ChoiceWords(state.choices); !options.empty())
        hint.text += "\nOptions: " + options;
    const std::string reason = state.choices.align ? std::string() : AlignmentReason(state);
    if (!reason.empty())
    {
        hint.text += '\n' + reason;
        hint.offers = {
            {ERemedy::AlignRestPose, "Align the rest pose (Ctrl+M)"}
        };
    }
    return hint;
}

// Returns why the source should be aligned; empty if nothing is known to need it.
std::string CNextSteps::AlignmentReason(const StepState& state) const
{
    if (!m_kUpAxis.empty())
        return "The up axis of this motion is " + m_kUpAxis + ", not Y";
    const auto& warnings = state.readerRecord.Warnings();
    const auto has = [&](EFailure reason) { return std::ranges::count(warnings, reason, &Finding::reason); };
    if (has(EFailure::RestPose))
        return "The rest pose is not a T-pose";
    if (has(EFailure::DoubledOffsets))
        return "Positions repeat the offsets, so bones are twice as long";
    const ProfileChoice* const choice = m_kFits.Find(state.mapName);
    const bool turns =
        choice && std::ranges::count(choice->verdict.doubts, EDoubt::Turned, &ProfileDoubt::kind);
    return turns ? "Some bones may end up rotated" : "";
}

std::vector<Offer> CNextSteps::OffersFor(std::span<const Notice> notices, const StepState& state) const
{
    const auto has = [&](ERemedy remedy) {
        return std::ranges::any_of(notices, [=](const Notice& n) { return RemedyOf(n.code) == remedy; });
    };
    std::vector<Offer> offers;
    const ProfileChoice* const best = m_kFits.Best();
    if (has(ERemedy::UseMap) && best && best->profile.name != state.mapName)
        offers.push_back({ERemedy::UseMap, "Use " + Printable(best->profile.name)});
    else if (has(ERemedy::UseMap) && state.source)
        offers.push_back({ERemedy::DraftMap, "Draft a bone map"});
    if (has(ERemedy::AlignRestPose) && !state.choices.align)
        offers.push_back({ERemedy::AlignRestPose, "Align the rest pose"});
    const auto isOfMended = [this](const Notice& notice) { return notice.path == m_kMendable; };
    if (!m_kMendable.empty() && std::ranges::any_of(notices, isOfMended))
        offers.push_back({ERemedy::OpenMendedCopy, "Open a mended copy"});
    return offers;
}

std::string SummaryOf(std::span<const Notice> notices)
{
    const auto error = std::ranges::find_if_not(notices, &Notice::IsWarning);
    if (error == notices.end())
        return {};
    std::string_view rest = error->words;
    std::string summary;
    size_t shown = 0;
    size_t more = 0;
    for (std::string_view line; NextLine(rest, line);)
    {
        if (shown < kLinesShown)
            summary.append(shown++ > 0 ? "\n" : "").append(line);
        else
            ++more;
    }
    return more == 0 ? summary : summary + "\n  and " + std::to_string(more) + " more";
}

} // namespace gw
