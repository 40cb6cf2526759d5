// What the window says about the state: captions over the views, and hints in empty views.

#include "CContentWindow.h"
#include "CGaitConvertContent.h"
#include "CProfileEditorDialog.h"
#include "DoubtWords.h"
#include "FindBone.h"
#include "Paths.h"
#include "Text.h"

#include <algorithm>

namespace gw {

namespace {

std::string FileName(const std::string& path)
{
    return path.substr(SplitPath(path).folder.size());
}

} // namespace

// The map that fits best, or a draft. A doubtful map is offered with its reason, and a draft beside it.
void CGaitConvertContent::OfferMap(Hint& hint) const
{
    const ProfileChoice* const best = m_kFits.Best();
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

Hint CGaitConvertContent::SourceHint() const
{
    return SourceRoot() ? Hint() : Hint{"Drop a motion here, or press Ctrl+O", {}};
}

Hint CGaitConvertContent::ResultHint() const
{
    CNode* const source = SourceRoot();
    CNode* const target = m_kBaseMotion.motionRoot.Get();
    if (!source || m_kOrigin)
        return {};
    if (!target)
        return {"base.htr is missing, so nothing can be converted", {}};
    if (!m_bSourceIsContainer && m_kSourceMotion.GetKeyCount() == 0)
        return {"This motion has no frames, so there is nothing to convert", {}};
    Hint hint;
    if (m_kProfilePath.empty())
        hint.text = "Choose a bone map\n";
    else if (const RowMatch fit =
                 ApplyRows(m_pkProfileDialog->Rows(), CBoneNames(source), CBoneNames(target), nullptr);
             !fit.IsWhole())
        hint.text = Printable(MapName()) + " does not fit: " + std::to_string(fit.foundCount) + " of " +
                    std::to_string(fit.rowCount) + " rows match\n";
    else
        return ReadyHint();
    OfferMap(hint);
    return hint;
}

Hint CGaitConvertContent::ReadyHint() const
{
    Hint hint{"Convert (Ctrl+Return)", {}};
    if (const std::string options = ChoiceWords(m_kChoices); !options.empty())
        hint.text += "\nOptions: " + options;
    const std::string reason = m_kChoices.align ? std::string() : AlignmentReason();
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
std::string CGaitConvertContent::AlignmentReason() const
{
    if (!m_kUpAxis.empty())
        return "The up axis of this motion is " + m_kUpAxis + ", not Y";
    const auto& warnings = m_kSourceMotion.Record().Warnings();
    const auto has = [&](EFailure reason) { return std::ranges::count(warnings, reason, &Finding::reason); };
    if (!m_bSourceIsContainer && has(EFailure::RestPose))
        return "The rest pose is not a T-pose";
    if (!m_bSourceIsContainer && has(EFailure::DoubledOffsets))
        return "Positions repeat the offsets, so bones are twice as long";
    const ProfileChoice* const choice = m_kFits.Find(MapName());
    const bool turns =
        choice && std::ranges::count(choice->verdict.doubts, EDoubt::Turned, &ProfileDoubt::kind);
    return turns ? "Some bones may end up rotated" : "";
}

void CGaitConvertContent::ShowCaptions()
{
    const std::string source =
        SourceRoot() ? MotionCaption(Printable(FileName(m_kSourcePath)), Timing(), kClockMilliseconds)
                     : "Source";
    window_.SetChildText("source", source);
    window_.SetChildText("#sourceNote", m_kUpAxis.empty() ? "" : "Up axis: " + m_kUpAxis);
    std::string result = "Result";
    std::string made;
    if (m_kOrigin)
    {
        const std::string name =
            m_kResultFile.empty() ? "Result, not saved" : Printable(FileName(m_kResultFile));
        result = MotionCaption(name, TimingOf(m_kResultMotion), kClockMilliseconds);
        made = OriginCaption(*m_kOrigin) + (HasChangedSince() ? "; settings have changed since" : "");
    }
    window_.SetChildText("result", result);
    window_.SetChildText("#resultNote", made);
    window_.ShowHint("#cnt1", SourceHint());
    window_.ShowHint("#cnt2", ResultHint());
}

bool CGaitConvertContent::HasChangedSince() const
{
    return !(m_kChoices == m_kOrigin->choices) || !m_pkProfileDialog->Rows().HasSameRows(m_kOrigin->rows);
}

} // namespace gw
