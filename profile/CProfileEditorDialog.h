#pragma once

#include "CBoneMapProfile.h"
#include "CBoneTree.h"
#include "CMapRowTable.h"
#include "CProfileFields.h"
#include "CProfileHistory.h"
#include "CProfileOwner.h"

#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CProfileReader;
struct ProfileLine;

/// Control ids of the profile editor, apart from its fields; the numbers never change.
enum EProfileControl : int
{
    kAddToMapButton = 5,
    kRemoveButton = 6,
    kRemoveAllButton = 7,
    kSaveProfileButton = 8,
    kBoneOffsetButton = 9,
    kSourceTree = 1002,
    kTargetTree = 1003,
    kMapRowList = 1008,
};

/// Which buttons of the profile editor are enabled.
struct ProfileButtons
{
    bool addToMap = false;
    bool remove = false;
    bool removeAll = false;
    bool saveProfile = false;
    bool boneOffset = false;
};

enum class EProfileRead
{
    Count, ///< only count the rows that fit; name and path change anyway
    Load,  ///< also replace rows and numbers
};

enum class EProfileWrite
{
    Ask,   ///< ask before a file is overwritten
    Quiet, ///< overwrite without asking
};

enum class EFieldCommit
{
    Check, ///< clamp the fields to their limits
    Apply, ///< also store their values
};

/// The profile editor without its window: the current profile, and the rules by which it changes. A window
/// displays the accessors' values and forwards user actions. Scenes and owner must outlive their use.
class CProfileEditorDialog : public CBoneMapProfile
{
public:
    static constexpr int kMappedSourceImage = 1;
    static constexpr int kMappedTargetImage = 4;

    explicit CProfileEditorDialog(CProfileOwner& owner);

    bool SetSourceScene(CNode* root) override;
    bool SetTargetScene(CNode* root) override;
    bool GetSelectedSourceBone(std::string& name) const override;
    bool GetSelectedTargetBone(std::string& name) const override;
    bool LoadProfile(const std::string& path) override;
    bool CountMatches(const std::string& path, int* matched, int* total) override;
    bool ApplyProfile(CRetargeter* retargeter, int* matched, int* total) override;
    bool HasRootMapping() const override;
    void PromptSaveChanges() override;

    /// Sets the names that a renamed profile must not use, or null. The list must stay valid until another
    /// one is set.
    void SetNamesInUse(const std::vector<std::string>* names) { m_pkNamesInUse = names; }

    // State for a window to show.
    const CMapRowTable& Rows() const { return m_kRows; }
    const CBoneTree& SourceTree() const { return m_kSourceTree; }
    const CBoneTree& TargetTree() const { return m_kTargetTree; }
    /// Returns the text of a field; empty for other ids.
    const std::string& FieldText(int id) const { return m_kFields.Text(id); }
    const ProfileButtons& Buttons() const { return m_kButtons; }
    bool IsDirty() const { return m_bDirty; }
    bool IsVisible() const { return m_bVisible; }
    const std::string& ProfilePath() const { return m_kProfilePath; }

    // Events from a window.
    /// Handles a button click; ignores disabled buttons and unknown ids.
    void ClickButton(int id);
    /// Handles a text change in the field that has the focus.
    void EditField(int id, std::string_view text) { m_kFields.Set(id, text); }
    /// Handles a field losing the focus, also by Enter or Escape.
    void LeaveField();
    void SelectSourceItem(int item);
    void SelectTargetItem(int item);
    /// Handles a change of the list's selection; it has no effect until the click arrives.
    void SelectRow(int row, bool selected) { m_kRows.Select(row, selected); }
    void SelectOnlyRow(int row) { m_kRows.SelectOnly(row); }
    /// Handles a click on a row, or on none with -1, after its selection.
    void ClickRow(int row);
    void DoubleClickRow(int row);
    void Show() { m_bVisible = true; }
    /// Hides the dialog; its state remains the current profile.
    void Close();
    /// Undo or redo one user command that changed rows, name or numbers. The history survives a save and is
    /// cleared when a profile is loaded.
    void Undo();
    void Redo();

    // Operations.
    /// Reads a profile file. Returns false, changing nothing, if it cannot be opened; also returns false if a
    /// row's target exists but its source does not. The counters may be null.
    bool ReadProfile(std::string path, int* matched, int* total, EProfileRead mode);
    /// Writes the profile to its file, or to a new custom one. Returns whether a file was written.
    bool WriteProfile(EProfileWrite mode);

    /// Always returns true. Row 0 keeps its rotation.
    bool AddMapRow(std::string_view source, std::string_view target, const RowNumbers& numbers,
                   ERowColumns columns = ERowColumns::All);
    void RemoveMapRow(int row);
    /// Adds fixed rows for the two pelvis bones, which no source drives, unless they exist.
    void ForcePelvisRows() { m_kRows.AddPelvisRows(); }
    void RebuildSourceTree() { m_kSourceTree.Rebuild(m_pkSourceScene); }
    void RebuildTargetTree() { m_kTargetTree.Rebuild(m_pkTargetScene); }
    void MarkSourceBone(int item, bool mapped) { m_kSourceTree.Mark(item, mapped); }
    void MarkTargetBone(int item, bool mapped) { m_kTargetTree.Mark(item, mapped); }
    int FindSourceItem(std::string_view name) const { return m_kSourceTree.Find(name); }
    int FindTargetItem(std::string_view name) const { return m_kTargetTree.Find(name); }

    void CommitFields(EFieldCommit mode);
    void ShowFields();
    void UpdateButtons();
    /// Call before every change of a row, number or name: gives a profile whose file is read-only a new name,
    /// so that a save never overwrites it.
    void MarkChanged();

    void AddToMap();
    /// Removes the selected rows. Indices are not corrected after a removal: with several selected rows, each
    /// later removal affects the row after the selected one.
    void RemoveSelection();
    void RemoveAll();
    /// Runs the offset dialog for the first selected row. Returns false if there is none or the user cancels.
    bool EditBoneOffset();
    /// Selects the two bones of a row in the trees.
    void SelectRowBones(int row);

private:
    class CUserCommand;

    bool ReadLines(CProfileReader& reader, int* matched, int* total, EProfileRead mode);
    void LoadLine(const ProfileLine& line);
    void MarkRowBones(std::string_view source, std::string_view target, bool mapped);
    void CommitNumbers(EFieldCommit mode);
    void CommitName(EFieldCommit mode);
    void SetDirty();
    CProfileState State() const;
    void Restore(const CProfileState& state);
    void MarkAllRows(bool mapped);

    CProfileOwner& owner_;
    const std::vector<std::string>* m_pkNamesInUse = nullptr;
    CMapRowTable m_kRows;
    CBoneTree m_kSourceTree{kMappedSourceImage};
    CBoneTree m_kTargetTree{kMappedTargetImage};
    CProfileFields m_kFields;
    ProfileButtons m_kButtons;
    CProfileHistory m_kHistory;
    bool m_bDirty = false;
    bool m_bVisible = false;
};

} // namespace gw
