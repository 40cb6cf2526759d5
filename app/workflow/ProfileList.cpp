// The list of profiles: its contents, and the effect of selecting an entry.

#include "CCntComboExControl.h"
#include "CContentWindow.h"
#include "CGaitConvertContent.h"
#include "CPlatform.h"
#include "CProfileEditorDialog.h"
#include "Paths.h"
#include "ProfileFile.h"
#include "StringTable.h"
#include "Text.h"

#include <algorithm>

namespace gw {

namespace {

constexpr std::string_view kProfileExtension = ".prf";
constexpr const char* kPoserFile = "PoserBVH.prf";
constexpr const char* kMaxFile = "MaxBVH.prf";
constexpr int kCustom = 0; // user data of an entry
constexpr int kStock = 1;
constexpr int kSelectionChanged = 9; // notification of the list

// Returns the profile with a display name in a folder, or empty.
std::string FindInFolder(const std::string& folder, const std::string& name)
{
    for (const std::string& file : FilesInFolder(folder, kProfileExtension))
    {
        if (EqualNoCase(ReadProfileName(folder + file), name))
            return folder + file;
    }
    return {};
}

// Returns the first entry with a name, or -1.
int FindItem(const CCntComboExControl& list, const std::string& name)
{
    for (int index = 0; const std::string* text = list.GetItemText(index); ++index)
    {
        if (EqualNoCase(*text, name))
            return index;
    }
    return -1;
}

} // namespace

std::string CGaitConvertContent::FindProfilePath(const std::string& name)
{
    const std::string stock = FindInFolder(ExeFile({}), name);
    return stock.empty() ? FindInFolder(ProfileFile({}), name) : stock;
}

void CGaitConvertContent::RefreshProfileList()
{
    m_pkProfileCombo->DeleteItem(-1);
    KeepStockNames();
    const std::string stock = ExeFile({});
    for (const std::string& file : FilesInFolder(stock, kProfileExtension))
        AddProfile(stock + file, kStock);
    const std::string custom = ProfileFile({});
    for (const std::string& file : FilesInFolder(custom, kProfileExtension))
        AddProfile(custom + file, kCustom);
    SortProfileList();
}

void CGaitConvertContent::KeepStockNames()
{
    m_kPoserProfileName = ReadProfileName(ExeFile(kPoserFile));
    m_kMaxProfileName = ReadProfileName(ExeFile(kMaxFile));
}

void CGaitConvertContent::AddProfile(const std::string& path, int userData)
{
    const std::string name = ReadProfileName(path);
    m_pkProfileCombo->AddItem(name, userData);
    m_kProfileNames.push_back(name);
}

bool CGaitConvertContent::IsListed(const std::string& name) const
{
    return std::ranges::any_of(m_kProfileNames,
                               [&](const std::string& listed) { return EqualNoCase(listed, name); });
}

// The index advances after a deletion too, so the entry that moved into its place is skipped.
void CGaitConvertContent::PruneProfileList()
{
    CCntComboExControl& list = *m_pkProfileCombo;
    for (int index = 0; const std::string* text = list.GetItemText(index); ++index)
    {
        if (!IsListed(*text) && index != list.GetCurSel() && FindProfilePath(*text).empty())
            list.DeleteItem(index);
    }
}

// Loading refills the list, so every text is copied and looked up again.
void CGaitConvertContent::SelectProfileByName(const std::string& name)
{
    CCntComboExControl& list = *m_pkProfileCombo;
    for (int index = 0; const std::string* text = list.GetItemText(index); ++index)
    {
        if (!EqualNoCase(*text, name))
            continue;
        list.SetCurSel(index);
        UseProfileFile(FindProfilePath(name));
    }
}

void CGaitConvertContent::UseProfileFile(const std::string& path)
{
    m_kProfilePath = path;
    if (m_pkProfile && !m_kProfilePath.empty())
        m_pkProfile->LoadProfile(path);
}

void CGaitConvertContent::OnCntCommand(int code)
{
    if (code == kSelectionChanged)
        ChooseProfile();
}

void CGaitConvertContent::ChooseProfile()
{
    CCntComboExControl& list = *m_pkProfileCombo;
    const int chosen = list.GetCurSel();
    PruneProfileList();
    // The index is from before the pruning: if an entry before the selected one was removed, this is the next
    // entry's text.
    const std::string* const text = list.GetItemText(chosen);
    UseProfileFile(text ? FindProfilePath(*text) : std::string());
    UpdateControls();
}

bool CGaitConvertContent::ProfileFits(const std::string& path)
{
    int matched = 0;
    int total = 0;
    if (m_pkProfile)
        m_pkProfile->CountMatches(path, &matched, &total);
    return matched >= 1 && matched == total;
}

void CGaitConvertContent::PickStockProfile()
{
    if (ProfileFits(ExeFile(kPoserFile)))
    {
        SelectProfileByName(m_kPoserProfileName);
        return;
    }
    if (!ProfileFits(ExeFile(kMaxFile)))
        return;
    // A user's choice survives an open, unless it is the other stock profile.
    const CCntComboExControl& list = *m_pkProfileCombo;
    const std::string* const selected = list.GetItemText(list.GetCurSel());
    if (!selected || EqualNoCase(*selected, m_kPoserProfileName))
        SelectProfileByName(m_kMaxProfileName);
}

// The profile path still names the deleted file until the next selection.
void CGaitConvertContent::DeleteSelectedProfile()
{
    CCntComboExControl& list = *m_pkProfileCombo;
    const int index = list.GetCurSel();
    if (ShowMessage(kRemoveProfileMessage, EButtons::OKCancel) == EAnswer::OK && list.GetItemText(index))
    {
        const std::string name = *list.GetItemText(index);
        DeleteFile(FindProfilePath(name));
        list.DeleteItem(index);
        const auto listed =
            std::ranges::find_if(m_kProfileNames, [&](const std::string& n) { return EqualNoCase(n, name); });
        if (listed != m_kProfileNames.end())
            m_kProfileNames.erase(listed);
        LoadSelectedProfile();
    }
    UpdateControls();
}

void CGaitConvertContent::LoadSelectedProfile()
{
    CCntComboExControl& list = *m_pkProfileCombo;
    list.SetCurSel(list.GetCurSel());
    const std::string* const text = list.GetItemText(list.GetCurSel());
    const std::string path = text ? FindProfilePath(*text) : std::string();
    if (!path.empty() && m_pkProfile)
        m_pkProfile->LoadProfile(path);
}

void CGaitConvertContent::ProfileStateChanged()
{
    UpdateControls();
    window_.RefreshProfileEditor();
}

void CGaitConvertContent::ProfileSetChanged()
{
    if (!m_pkProfile)
        return;
    RefreshProfileList();
    if (m_pkProfileDialog->IsDirty())
        MeasureFits(); // a file may have been written
    CCntComboExControl& list = *m_pkProfileCombo;
    std::string name;
    m_pkProfile->GetProfileName(name);
    if (FindItem(list, name) < 0)
        list.AddItem(name, kCustom);
    list.SetCurSel(FindItem(list, name));
    UpdateControls();
    window_.RefreshProfileEditor();
}

bool CGaitConvertContent::RunBoneOffset(CBoneOffsetDialog& dialog)
{
    return window_.RunBoneOffset(dialog);
}

} // namespace gw
