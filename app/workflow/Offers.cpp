// What the window offers: the bone map that fits best, and remedies for notices.

#include "CCntComboExControl.h"
#include "CContentWindow.h"
#include "CGaitConvertContent.h"
#include "CProfileEditorDialog.h"
#include "CSafeFile.h"
#include "DoubtWords.h"
#include "FindBodyByNames.h"
#include "FindBone.h"
#include "FindingWords.h"
#include "NewProfilePath.h"
#include "Paths.h"
#include "StringTable.h"
#include "SystemError.h"
#include "Text.h"
#include "UpAxis.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr size_t kMissingShown = 3; // of the bones that a map names and the skeleton lacks

// Returns the name of an axis that is not +Y: "Z", "-Z". A tilted one has the name of the closest axis.
std::string AxisName(const Vec3& up)
{
    const double size[] = {std::fabs(up.x), std::fabs(up.y), std::fabs(up.z)};
    const size_t axis = static_cast<size_t>(std::ranges::max_element(size) - size);
    const float value = axis == 0 ? up.x : axis == 1 ? up.y : up.z;
    std::string name(value < 0.0f ? "-" : "");
    name += "XYZ"[axis];
    return name == "Y" ? "" : name;
}

CFailureRecord PoseWarnings(const CFailureRecord& record)
{
    CFailureRecord warnings;
    for (const Finding& warning : record.Warnings())
    {
        if (warning.reason == EFailure::RestPose || warning.reason == EFailure::DoubledOffsets)
            warnings.Warn(warning.reason, warning.where, warning.name);
    }
    return warnings;
}

} // namespace

// The rest pose does not always show the axis, so the motion is examined too.
void CGaitConvertContent::FindUp()
{
    m_kUpAxis.clear();
    CNode* const root = SourceRoot();
    const SourceTiming timing = Timing();
    if (!root || !(timing.frequency > 0.0f) || !(timing.lastFrame >= 0.0f))
        return;
    m_kUpAxis = AxisName(
        FindUpAxis(FindBodyByNames(*root), timing.frequency, static_cast<int>(timing.lastFrame) + 1));
    root->UpdateScene(0.0f, true);
}

// Alignment corrects what these notices are about.
void CGaitConvertContent::NotifyOfPose()
{
    if (!m_bSourceIsContainer)
        Notify(m_kSourcePath, PoseWarnings(m_kSourceMotion.Record()));
    NotifyOfUpAxis();
}

void CGaitConvertContent::NotifyOfUpAxis()
{
    if (!m_kUpAxis.empty() && !m_kChoices.align)
        window_.Notify(MakeNotice(m_kSourcePath, "not-y-up",
                                  "the motion's up axis is " + m_kUpAxis +
                                      ", so the result will lie or stand on its head (align the rest pose)",
                                  ESeverity::Warning));
}

void CGaitConvertContent::MeasureFits()
{
    CNode* const target = m_kBaseMotion.motionRoot.Get();
    m_kFits = {};
    if (SourceRoot() && target)
    {
        const std::string folders[] = {ExeFile({}), ProfileFile({})};
        m_kFits.Measure(folders, *SourceRoot(), *target);
    }
    SortProfileList();
}

// Maps that fit come first; the others keep their order.
void CGaitConvertContent::SortProfileList()
{
    struct Item
    {
        std::string name;
        int userData;
        bool selected;
    };
    CCntComboExControl& list = *m_pkProfileCombo;
    std::vector<Item> items;
    for (int index = 0; const std::string* text = list.GetItemText(index); ++index)
        items.push_back({*text, list.GetItemUserData(index), index == list.GetCurSel()});
    std::ranges::stable_sort(items, {}, [this](const Item& item) { return m_kFits.RankOf(item.name); });
    list.DeleteItem(-1);
    for (const Item& item : items)
        list.AddItem(item.name, item.userData);
    for (int index = 0; const Item& item : items)
    {
        list.SetItemWords(index, m_kFits.WordsOf(item.name), m_kFits.TipOf(item.name));
        if (item.selected)
            list.SetCurSel(index);
        ++index;
    }
}

// Returns the selected name, because the profile's is that of the last file it counted.
std::string CGaitConvertContent::MapName() const
{
    const std::string* const selected = m_pkProfileCombo->GetItemText(m_pkProfileCombo->GetCurSel());
    return selected ? *selected : SplitPath(m_kProfilePath).stem;
}

void CGaitConvertContent::UseBestMap()
{
    const ProfileChoice* const best = m_kFits.Best();
    if (!best)
        return;
    const std::string name = best->adapted ? SaveAdapted(*best) : best->profile.name;
    if (!name.empty())
        SelectProfileByName(name);
    UpdateControls();
}

// A map that was adapted to the source's prefix exists only in memory. Returns the name under which it was
// saved with the user's own; empty if that failed.
std::string CGaitConvertContent::SaveAdapted(const ProfileChoice& choice)
{
    ProfileRows adapted = choice.profile;
    adapted.name = FreeName(adapted.name);
    const std::string path = NewProfilePath(*this);
    if (!SaveNewMap(path, TextOf(adapted)))
        return {};
    RefreshProfileList();
    MeasureFits();
    return adapted.name;
}

bool CGaitConvertContent::SaveNewMap(const std::string& path, const std::string& text)
{
    CSafeFile file;
    if (file.Open(path) && file.Write(text) && file.Commit())
        return true;
    window_.Notify(MakeNotice(path, {.reason = EFailure::WriteError, .systemError = TakeSystemError()}));
    window_.ShowMessageBox(kOwnMessage, "The bone map cannot be written.", EButtons::OK);
    return false;
}

void CGaitConvertContent::RunRemedy(ERemedy remedy)
{
    switch (remedy)
    {
    case ERemedy::UseMap:
        UseBestMap();
        if (m_bConversionFailed)
            ConvertMotion();
        break;
    case ERemedy::DraftMap:
        DraftProfile();
        break;
    case ERemedy::AlignRestPose: {
        ConversionChoices choices = m_kChoices;
        choices.align = true;
        SetChoices(choices);
        if (m_bConverted || m_bConversionFailed)
            ConvertMotion();
        break;
    }
    case ERemedy::OpenMendedCopy:
        OpenMendedCopy();
        break;
    case ERemedy::None:
        break;
    }
}

void CGaitConvertContent::TakeOffer()
{
    const Hint hint = ResultHint();
    if (!hint.offers.empty())
        RunRemedy(hint.offers.front().remedy);
}

std::vector<Offer> CGaitConvertContent::OffersFor(std::span<const Notice> notices) const
{
    const auto has = [&](ERemedy remedy) {
        return std::ranges::any_of(notices, [=](const Notice& n) { return RemedyOf(n.code) == remedy; });
    };
    std::vector<Offer> offers;
    const ProfileChoice* const best = m_kFits.Best();
    if (has(ERemedy::UseMap) && best && best->profile.name != MapName())
        offers.push_back({ERemedy::UseMap, "Use " + Printable(best->profile.name)});
    else if (has(ERemedy::UseMap) && SourceRoot())
        offers.push_back({ERemedy::DraftMap, "Draft a bone map"});
    if (has(ERemedy::AlignRestPose) && !m_kChoices.align)
        offers.push_back({ERemedy::AlignRestPose, "Align the rest pose"});
    const auto isOfMended = [this](const Notice& notice) { return notice.path == m_kMendable; };
    if (!m_kMendable.empty() && std::ranges::any_of(notices, isOfMended))
        offers.push_back({ERemedy::OpenMendedCopy, "Open a mended copy"});
    return offers;
}

std::string CGaitConvertContent::SummaryOf(std::span<const Notice> notices) const
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
        if (shown <= kMissingShown)
            summary.append(shown++ > 0 ? "\n" : "").append(line);
        else
            ++more;
    }
    return more == 0 ? summary : summary + "\n  and " + std::to_string(more) + " more";
}

} // namespace gw
