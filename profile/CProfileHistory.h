#pragma once

#include "CMapRowTable.h"
#include "Vec3.h"

#include <cstddef>
#include <deque>
#include <string>

namespace gw {

/// Everything in a profile that a user can change, at one moment.
struct CProfileState
{
    CMapRowTable rows; ///< including their selection
    std::string name;
    std::string path;
    Vec3 rootOffset = kVec3Zero;
    int frameRate = 0;
    bool dirty = false;

    /// Returns whether rows, name and numbers are equal; path, selection and dirty flag are ignored.
    bool IsSameProfile(const CProfileState& other) const;
};

/// The states for undo and redo. Each state is complete, so a step never depends on the current rows.
class CProfileHistory
{
public:
    /// Older states are dropped: a hundred of a full skeleton take a few megabytes.
    static constexpr size_t kStepLimit = 100;

    /// Records the states before and after a command, and clears the redo states. Ignored if the command did
    /// not change the profile.
    void Keep(CProfileState before, const CProfileState& after);
    /// Each moves by one step that changes the present profile; returns false, leaving the state unchanged,
    /// if there is none.
    bool Undo(CProfileState& present) { return Step(m_kUndo, m_kRedo, present); }
    bool Redo(CProfileState& present) { return Step(m_kRedo, m_kUndo, present); }
    /// Call after the present state was saved: all other states now differ from the file and get its name, so
    /// that a later save of an undone state cannot write to another profile's file.
    void ProfileSaved(const std::string& name, const std::string& path);
    /// Call when another profile becomes the current one.
    void Clear();

private:
    using States = std::deque<CProfileState>;

    static bool Step(States& from, States& to, CProfileState& present);

    States m_kUndo; // the next state is last, in both
    States m_kRedo;
};

} // namespace gw
