// Undo and redo in the profile editor: saving the current profile as a state, and restoring it.

#include "CProfileEditorDialog.h"

namespace gw {

void CProfileEditorDialog::Undo()
{
    CProfileState state = State();
    if (m_kHistory.Undo(state))
        Restore(state);
}

void CProfileEditorDialog::Redo()
{
    CProfileState state = State();
    if (m_kHistory.Redo(state))
        Restore(state);
}

CProfileState CProfileEditorDialog::State() const
{
    return {m_kRows, m_kProfileName, m_kProfilePath, m_kRootOffset, m_iFrameRate, m_bDirty};
}

void CProfileEditorDialog::Restore(const CProfileState& state)
{
    MarkAllRows(false);
    m_kRows = state.rows;
    MarkAllRows(true);
    m_kProfileName = state.name;
    m_kProfilePath = state.path;
    m_kRootOffset = state.rootOffset;
    m_iFrameRate = state.frameRate;
    m_bDirty = state.dirty;
    ShowFields();
    owner_.ProfileSetChanged();
    UpdateButtons();
}

// A row marks its bones only if both exist, as when it is loaded.
void CProfileEditorDialog::MarkAllRows(bool mapped)
{
    for (int row = 0; row < m_kRows.RowCount(); ++row)
    {
        const std::string& source = m_kRows.Text(row, kSourceColumn);
        const std::string& target = m_kRows.Text(row, kTargetColumn);
        if (FindSourceItem(source) != CBoneTree::kNone && FindTargetItem(target) != CBoneTree::kNone)
            MarkRowBones(source, target, mapped);
    }
}

} // namespace gw
