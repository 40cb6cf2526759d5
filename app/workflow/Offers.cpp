// The list of bone maps sorted by fit, and the remedies that the window offers.

#include "CCntComboExControl.h"
#include "CContentWindow.h"
#include "CGaitConvertContent.h"
#include "CProfileEditorDialog.h"
#include "CSafeFile.h"
#include "FindingWords.h"
#include "NewProfilePath.h"
#include "Paths.h"
#include "StringTable.h"
#include "SystemError.h"

#include <algorithm>

namespace gw {

namespace {

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

// Alignment corrects what these notices are about.
void CGaitConvertContent::NotifyOfPose()
{
    if (!m_bSourceIsContainer)
        Notify(m_kSourcePath, PoseWarnings(m_kSourceMotion.Record()));
    NotifyOfUpAxis();
}

void CGaitConvertContent::NotifyOfUpAxis()
{
    const std::string& up = m_kNextSteps.UpAxis();
    if (!up.empty() && !m_kChoices.align)
        window_.Notify(MakeNotice(m_kSourcePath, "not-y-up",
                                  "the motion's up axis is " + up +
                                      ", so the result will lie or stand on its head (align the rest pose)",
                                  ESeverity::Warning));
}

void CGaitConvertContent::MeasureFits()
{
    const std::string folders[] = {ExeFile({}), ProfileFile({})};
    m_kNextSteps.MeasureFits(folders, SourceRoot(), m_kBaseMotion.motionRoot.Get());
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
    const CMapFits& fits = m_kNextSteps.Fits();
    std::ranges::stable_sort(items, {}, [&](const Item& item) { return fits.RankOf(item.name); });
    list.DeleteItem(-1);
    for (const Item& item : items)
        list.AddItem(item.name, item.userData);
    for (int index = 0; const Item& item : items)
    {
        list.SetItemWords(index, fits.WordsOf(item.name), fits.TipOf(item.name));
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
    const ProfileChoice* const best = m_kNextSteps.Fits().Best();
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
    const Hint hint = m_kNextSteps.ResultHint(State());
    if (!hint.offers.empty())
        RunRemedy(hint.offers.front().remedy);
}

std::vector<Offer> CGaitConvertContent::OffersFor(std::span<const Notice> notices) const
{
    return m_kNextSteps.OffersFor(notices, State());
}

StepState CGaitConvertContent::State() const
{
    static const CFailureRecord kNothing; // a container's reader warns of nothing that alignment mends
    return {.source = SourceRoot(),
            .target = m_kBaseMotion.motionRoot.Get(),
            .hasFrames = m_bSourceIsContainer || m_kSourceMotion.GetKeyCount() > 0,
            .readerRecord = m_bSourceIsContainer ? kNothing : m_kSourceMotion.Record(),
            .mapName = m_kProfilePath.empty() ? std::string() : MapName(),
            .rows = m_pkProfileDialog->Rows(),
            .choices = m_kChoices,
            .isConverted = m_kOrigin.has_value()};
}

} // namespace gw
