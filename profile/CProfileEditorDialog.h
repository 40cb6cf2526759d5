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

/// Controls of the profile editor beside its fields, with the numbers that they have always had.
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

/// Which buttons of the profile editor take a click.
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
    Count, ///< only count the rows that fit; name and path change all the same
    Load,  ///< also replace the rows and numbers
};

enum class EProfileWrite
{
    Ask,   ///< before a file is overwritten
    Quiet, ///< overwrite without a question
};

enum class EFieldCommit
{
    Check, ///< bring the fields within their limits
    Apply, ///< also store what they hold
};

/// The profile editor without its window: the current profile, and the rules by which it changes. A window
/// shows what the accessors answer and forwards what the user does; scenes and owner are looked at and must
/// outlive their use.
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

    /// The names that a renamed profile must not take, or null; looked at until another list is set.
    void SetNamesInUse(const std::vector<std::string>* names) { m_pkNamesInUse = names; }

    // What a window shows.
    const CMapRowTable& Rows() const { return m_kRows; }
    const CBoneTree& SourceTree() const { return m_kSourceTree; }
    const CBoneTree& TargetTree() const { return m_kTargetTree; }
    /// The text of the field with a control id; empty for other ids.
    const std::string& FieldText(int id) const { return m_kFields.Text(id); }
    const ProfileButtons& Buttons() const { return m_kButtons; }
    bool IsDirty() const { return m_bDirty; }
    bool IsVisible() const { return m_bVisible; }
    const std::string& ProfilePath() const { return m_kProfilePath; }

    // What a window delivers.
    /// A button was clicked; nothing for a disabled one and for ids that are none.
    void ClickButton(int id);
    /// The text of a field changed while it has the focus.
    void EditField(int id, std::string_view text) { m_kFields.Set(id, text); }
    /// A field lost the focus, by Enter and Escape too.
    void LeaveField();
    void SelectSourceItem(int item);
    void SelectTargetItem(int item);
    /// The list's selection changed; nothing follows from it until the click arrives.
    void SelectRow(int row, bool selected) { m_kRows.Select(row, selected); }
    void SelectOnlyRow(int row) { m_kRows.SelectOnly(row); }
    /// A click on a row, or on none with -1, after its selection.
    void ClickRow(int row);
    void DoubleClickRow(int row);
    void Show() { m_bVisible = true; }
    /// Hides the dialog; its state stays the current profile.
    void Close();
    /// Each takes back or repeats one command of the user that changed rows, name or numbers. They go on
    /// through a save, and end at the profile's loading.
    void Undo();
    void Redo();

    // The operations behind.
    /// Reads a profile file. False when it cannot be opened, which changes nothing, and when a row's target
    /// is in the target scene and its source is not in the source scene. The counters may be null.
    bool ReadProfile(std::string path, int* matched, int* total, EProfileRead mode);
    /// Writes the profile to the file of its name, else to a new custom one. Whether a file was written.
    bool WriteProfile(EProfileWrite mode);

    /// Always true. The row at index 0 keeps its rotation.
    bool AddMapRow(std::string_view source, std::string_view target, const RowNumbers& numbers,
                   ERowColumns columns = ERowColumns::All);
    void RemoveMapRow(int row);
    /// Sees to it that the two pelvis bones, which no source drives, have a row.
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
    /// To be called before every change of a row, a number or a name: gives a profile whose file is read-only
    /// a new name, so that a save never lands on it.
    void MarkChanged();

    void AddToMap();
    /// Removes the selected rows. Indices are not corrected after a removal: of several selected rows, each
    /// later removal hits the row behind the selected one.
    void RemoveSelection();
    void RemoveAll();
    /// Runs the offset dialog on the first selected row. False when there is none or the user cancels.
    bool EditBoneOffset();
    /// Makes the two bones of a row the selection of the trees.
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
