// The profile editor's rules. Every user command is wrapped in a CUserCommand, which records one step of undo
// if the profile has changed at the end. Some rules look odd (row 0 keeps its rotation, removals do not
// correct indices); bone maps made with earlier versions depend on them.

#include "CProfileEditorDialog.h"

#include "ApplyRow.h"
#include "CBoneOffsetDialog.h"
#include "CRetargeter.h"
#include "CSafeFile.h"
#include "FindBone.h"
#include "HostBones.h"
#include "NewProfilePath.h"
#include "Paths.h"
#include "ProfileNames.h"
#include "Text.h"

#include <algorithm>

namespace gw {

namespace {

enum EEditorMessage : int
{
    kNameInvalid = 158,
    kSaved = 159,
    kSaveFailed = 160,
    kAskSaveChanges = 161,
    kAskOverwrite = 163,
};

bool IsPelvis(std::string_view bone)
{
    return std::ranges::any_of(kPelvisBones,
                               [=](std::string_view pelvis) { return EqualNoCase(bone, pelvis); });
}

bool ReplaceFile(const std::string& path, std::string_view text)
{
    CSafeFile file;
    return file.Open(path) && file.Write(text) && file.Commit();
}

void StoreCounts(int found, int rowCount, int* matched, int* total)
{
    if (matched)
        *matched = found;
    if (total)
        *total = rowCount;
}

bool SelectedText(const CBoneTree& tree, std::string& name)
{
    name = tree.SelectedText();
    return tree.Selected() != CBoneTree::kNone;
}

} // namespace

// Everything that happens during its lifetime is one step of undo.
class CProfileEditorDialog::CUserCommand
{
public:
    explicit CUserCommand(CProfileEditorDialog& editor) : editor_(editor), m_kBefore(editor.State()) {}
    ~CUserCommand() { editor_.m_kHistory.Keep(std::move(m_kBefore), editor_.State()); }
    CUserCommand(const CUserCommand&) = delete;
    CUserCommand& operator=(const CUserCommand&) = delete;

private:
    CProfileEditorDialog& editor_;
    CProfileState m_kBefore;
};

CProfileEditorDialog::CProfileEditorDialog(CProfileOwner& owner) : owner_(owner)
{
    m_kProfileName = "Untitled";
    ShowFields();
}

bool CProfileEditorDialog::SetSourceScene(CNode* root)
{
    const bool stored = CBoneMapProfile::SetSourceScene(root);
    if (stored)
        RebuildSourceTree();
    return stored;
}

bool CProfileEditorDialog::SetTargetScene(CNode* root)
{
    const bool stored = CBoneMapProfile::SetTargetScene(root);
    if (stored)
        RebuildTargetTree();
    return stored;
}

bool CProfileEditorDialog::GetSelectedSourceBone(std::string& name) const
{
    return SelectedText(m_kSourceTree, name);
}

bool CProfileEditorDialog::GetSelectedTargetBone(std::string& name) const
{
    return SelectedText(m_kTargetTree, name);
}

bool CProfileEditorDialog::LoadProfile(const std::string& path)
{
    const bool fits = ReadProfile(path, nullptr, nullptr, EProfileRead::Load);
    UpdateButtons();
    return fits;
}

bool CProfileEditorDialog::CountMatches(const std::string& path, int* matched, int* total)
{
    return ReadProfile(path, matched, total, EProfileRead::Count);
}

bool CProfileEditorDialog::HasRootMapping() const
{
    return m_kRows.FindTarget(kRootBone) != CMapRowTable::kNone;
}

void CProfileEditorDialog::PromptSaveChanges()
{
    if (m_bDirty && owner_.ShowMessage(kAskSaveChanges, EButtons::YesNo) == EAnswer::Yes)
        WriteProfile(EProfileWrite::Quiet);
    m_bDirty = false;
}

bool CProfileEditorDialog::ApplyProfile(CRetargeter* retargeter, int* matched, int* total)
{
    if (!m_pkSourceScene || !m_pkResultScene)
        return false;
    CommitFields(EFieldCommit::Check);
    UpdateButtons();
    if (retargeter)
    {
        retargeter->ClearMaps();
        retargeter->SetScenes(m_pkSourceScene, m_pkResultScene);
    }
    const RowMatch match = ApplyRows(
        m_kRows, CBoneNames(m_pkSourceScene), CBoneNames(m_pkResultScene), retargeter, [this](int row) {
            MarkRowBones(m_kRows.Text(row, kSourceColumn), m_kRows.Text(row, kTargetColumn), true);
        });
    if (retargeter)
        retargeter->LoadShares(owner_.ExeFile(kShareFile));
    StoreCounts(match.foundCount, match.rowCount, matched, total);
    return match.foundCount == match.rowCount;
}

// By value, because the path may be the member that reading changes.
bool CProfileEditorDialog::ReadProfile(std::string path, int* matched, int* total, EProfileRead mode)
{
    const bool load = mode == EProfileRead::Load;
    if (load)
        PromptSaveChanges();
    std::string text;
    if (!ReadProfileText(path, text))
        return false;
    CProfileReader reader(text);
    m_kProfileName = reader.Name();
    m_kProfilePath = path;
    if (load)
    {
        m_bDirty = false;
        MarkAllRows(false);
        m_kRows.Clear();
        m_kHistory.Clear();
    }
    const bool fits = ReadLines(reader, matched, total, mode);
    if (load)
    {
        ShowFields();
        ForcePelvisRows();
        owner_.ProfileSetChanged();
    }
    m_kProfilePath = std::move(path);
    return fits;
}

// Returns false if a row's target exists but its source does not.
bool CProfileEditorDialog::ReadLines(CProfileReader& reader, int* matched, int* total, EProfileRead mode)
{
    const CBoneNames sources(m_pkSourceScene);
    const CBoneNames targets(m_pkTargetScene);
    int found = 0;
    int rowCount = 0;
    bool fits = true;
    ProfileLine line;
    while (reader.Next(line))
    {
        if (mode == EProfileRead::Load)
            LoadLine(line);
        if (line.kind != EProfileLine::Mapping)
            continue;
        const bool hasSource = sources.Find(line.source) != nullptr;
        const bool hasTarget = targets.Find(line.target) != nullptr;
        if (hasSource && hasTarget && mode == EProfileRead::Load)
            MarkRowBones(line.source, line.target, true);
        found += hasSource && hasTarget ? 1 : 0;
        fits = fits && (hasSource || !hasTarget);
        ++rowCount;
    }
    StoreCounts(found, rowCount, matched, total);
    return fits;
}

void CProfileEditorDialog::LoadLine(const ProfileLine& line)
{
    switch (line.kind)
    {
    case EProfileLine::Position:
        m_kRootOffset = line.position;
        break;
    case EProfileLine::FrameRate:
        m_iFrameRate = line.frameRate;
        break;
    case EProfileLine::Fixed:
    case EProfileLine::Mapping:
        AddMapRow(line.source, line.target, line.Numbers());
        break;
    }
}

bool CProfileEditorDialog::WriteProfile(EProfileWrite mode)
{
    std::string path = owner_.FindProfilePath(m_kProfileName);
    if (path.empty())
        path = NewProfilePath(owner_);
    else if (mode == EProfileWrite::Ask &&
             owner_.ShowMessage(kAskOverwrite, EButtons::OKCancel) != EAnswer::OK)
        return false;
    m_kProfileName.resize(CutTrailing(m_kProfileName).size());
    const bool written = ReplaceFile(path, ProfileText(m_kProfileName, m_iFrameRate, m_kRootOffset, m_kRows));
    owner_.ShowMessage(written ? kSaved : kSaveFailed, EButtons::OK);
    if (written)
    {
        m_kHistory.ProfileSaved(m_kProfileName, path);
        owner_.ProfileSetChanged();
    }
    m_bDirty = false;
    m_kProfilePath = std::move(path);
    UpdateButtons();
    return written;
}

bool CProfileEditorDialog::AddMapRow(std::string_view source, std::string_view target,
                                     const RowNumbers& numbers, ERowColumns columns)
{
    m_kRows.AddRow(source, target, numbers, columns);
    return true;
}

void CProfileEditorDialog::MarkRowBones(std::string_view source, std::string_view target, bool mapped)
{
    MarkSourceBone(FindSourceItem(source), mapped);
    MarkTargetBone(FindTargetItem(target), mapped);
}

void CProfileEditorDialog::RemoveMapRow(int row)
{
    const std::string source = m_kRows.Text(row, kSourceColumn);
    const std::string target = m_kRows.Text(row, kTargetColumn);
    m_kRows.RemoveRow(row);
    MarkRowBones(source, target, false);
    UpdateButtons();
}

void CProfileEditorDialog::AddToMap()
{
    if (m_kSourceTree.Selected() == CBoneTree::kNone || m_kTargetTree.Selected() == CBoneTree::kNone)
        return;
    MarkChanged();
    MarkSourceBone(m_kSourceTree.Selected(), true);
    MarkTargetBone(m_kTargetTree.Selected(), true);
    AddMapRow(m_kSourceTree.SelectedText(), m_kTargetTree.SelectedText(), {});
    ForcePelvisRows();
    UpdateButtons();
}

void CProfileEditorDialog::RemoveSelection()
{
    int row = m_kRows.NextSelected(CMapRowTable::kNone);
    while (row != CMapRowTable::kNone)
    {
        const int next = m_kRows.NextSelected(row); // determined before the removal, and not corrected by it
        RemoveMapRow(row);
        MarkChanged();
        UpdateButtons();
        row = next;
    }
}

void CProfileEditorDialog::RemoveAll()
{
    while (m_kRows.RowCount() > 0)
        RemoveMapRow(0);
    m_bDirty = false;
    UpdateButtons();
}

bool CProfileEditorDialog::EditBoneOffset()
{
    const int row = m_kRows.NextSelected(CMapRowTable::kNone);
    if (row == CMapRowTable::kNone)
        return false;
    CBoneOffsetDialog dialog(m_kRows.Numbers(row), m_kRows.Text(row, kSourceColumn),
                             m_kRows.Text(row, kTargetColumn));
    if (!owner_.RunBoneOffset(dialog) || row >= m_kRows.RowCount())
        return false;
    if (m_kRows.Numbers(row) == dialog.Numbers())
        return true;
    MarkChanged();
    UpdateButtons();
    const std::string source = m_kRows.Text(row, kSourceColumn);
    const std::string target = m_kRows.Text(row, kTargetColumn);
    return AddMapRow(source, target, dialog.Numbers());
}

void CProfileEditorDialog::SelectRowBones(int row)
{
    m_kSourceTree.Select(FindSourceItem(m_kRows.Text(row, kSourceColumn)));
    m_kTargetTree.Select(FindTargetItem(m_kRows.Text(row, kTargetColumn)));
}

void CProfileEditorDialog::ShowFields()
{
    m_kFields.Show(m_kProfileName, m_kRootOffset, m_iFrameRate);
}

void CProfileEditorDialog::CommitFields(EFieldCommit mode)
{
    CommitNumbers(mode);
    CommitName(mode);
}

void CProfileEditorDialog::CommitNumbers(EFieldCommit mode)
{
    const Vec3 rootOffset = m_kFields.ReadRootOffset(owner_);
    const int frameRate = m_kFields.ReadFrameRate(owner_);
    if (mode != EFieldCommit::Apply || (rootOffset == m_kRootOffset && frameRate == m_iFrameRate))
        return;
    m_kRootOffset = rootOffset;
    m_iFrameRate = frameRate;
    MarkChanged();
}

void CProfileEditorDialog::CommitName(EFieldCommit mode)
{
    const std::string name = m_kFields.ReadName();
    // A file can contain a longer name than the field returns; leaving the field must not rename the profile.
    const std::string_view present = CutTrailing(FirstCharacters(m_kProfileName, kProfileNameLimit));
    if (mode != EFieldCommit::Apply || EqualNoCase(name, present))
        return;
    if (name.empty() || IsNameInUse(name, m_pkNamesInUse))
    {
        owner_.ShowMessage(kNameInvalid, EButtons::OK);
        m_kFields.Set(kNameField, m_kProfileName);
        m_bDirty = false; // even if earlier changes were pending
        return;
    }
    m_kProfileName = name;
    SetDirty();
}

void CProfileEditorDialog::SetDirty()
{
    m_bDirty = true;
    owner_.ProfileSetChanged();
}

void CProfileEditorDialog::MarkChanged()
{
    if (m_bDirty)
        return;
    if (IsReadOnly(m_kProfilePath))
        m_kProfileName = NextFreeName(m_kProfileName, m_pkNamesInUse);
    ShowFields();
    SetDirty();
}

void CProfileEditorDialog::UpdateButtons()
{
    owner_.ProfileStateChanged();
    const int selected = m_kRows.SelectedCount();
    const int source = m_kSourceTree.Selected();
    const int target = m_kTargetTree.Selected();
    const bool bothSelected = source != CBoneTree::kNone && target != CBoneTree::kNone;

    m_kButtons.addToMap = bothSelected && !IsPelvis(m_kTargetTree.SelectedText()) &&
                          !m_kSourceTree.IsMapped(source) && !m_kTargetTree.IsMapped(target);
    m_kButtons.remove = !m_kRows.IsFixedSelected() && selected != 0;
    m_kButtons.removeAll = m_kRows.RowCount() != 0;
    m_kButtons.saveProfile = m_bDirty && m_kRows.RowCount() != 0;
    m_kButtons.boneOffset = selected == 1;
}

void CProfileEditorDialog::ClickButton(int id)
{
    const CUserCommand command(*this);
    if (id == kAddToMapButton && m_kButtons.addToMap)
        AddToMap();
    else if (id == kRemoveButton && m_kButtons.remove)
        RemoveSelection();
    else if (id == kRemoveAllButton && m_kButtons.removeAll)
        RemoveAll();
    else if (id == kSaveProfileButton && m_kButtons.saveProfile)
        WriteProfile(EProfileWrite::Ask);
    else if (id == kBoneOffsetButton && m_kButtons.boneOffset && EditBoneOffset())
        UpdateButtons();
}

void CProfileEditorDialog::LeaveField()
{
    const CUserCommand command(*this);
    CommitFields(EFieldCommit::Apply);
    UpdateButtons();
}

void CProfileEditorDialog::SelectSourceItem(int item)
{
    m_kSourceTree.Select(item);
    UpdateButtons();
}

void CProfileEditorDialog::SelectTargetItem(int item)
{
    m_kTargetTree.Select(item);
    UpdateButtons();
}

void CProfileEditorDialog::ClickRow(int row)
{
    SelectRowBones(row);
    UpdateButtons();
}

void CProfileEditorDialog::DoubleClickRow(int row)
{
    const CUserCommand command(*this);
    SelectRowBones(row);
    EditBoneOffset();
    UpdateButtons();
}

void CProfileEditorDialog::Close()
{
    m_bVisible = false;
    UpdateButtons();
}

} // namespace gw
