// The history stores whole states and not changes. A bone map has about twenty rows, so a state is small, and
// restoring one cannot fail or depend on the order of removals. Two stacks hold the states to undo and to
// redo; a step moves the present state to one stack and replaces it with the top of the other. A step that
// would change nothing visible is skipped, so each undo shows an effect. Each pass of that loop removes a
// state, so it ends.

#include "CProfileHistory.h"

#include <utility>

namespace gw {

bool CProfileState::IsSameProfile(const CProfileState& other) const
{
    return name == other.name && frameRate == other.frameRate && rootOffset == other.rootOffset &&
           rows.HasSameRows(other.rows);
}

void CProfileHistory::Keep(CProfileState before, const CProfileState& after)
{
    if (before.IsSameProfile(after))
        return;
    m_kUndo.push_back(std::move(before));
    if (m_kUndo.size() > kStepLimit)
        m_kUndo.pop_front();
    m_kRedo.clear();
}

// A save makes states that differed only in their name equal; these are skipped.
bool CProfileHistory::Step(States& from, States& to, CProfileState& present)
{
    while (!from.empty() && from.back().IsSameProfile(present))
        from.pop_back();
    if (from.empty())
        return false;
    to.push_back(std::exchange(present, std::move(from.back())));
    from.pop_back();
    return true;
}

void CProfileHistory::ProfileSaved(const std::string& name, const std::string& path)
{
    for (States* states : {&m_kUndo, &m_kRedo})
    {
        for (CProfileState& state : *states)
        {
            state.name = name;
            state.path = path;
            state.dirty = true;
        }
    }
}

void CProfileHistory::Clear()
{
    m_kUndo.clear();
    m_kRedo.clear();
}

} // namespace gw
