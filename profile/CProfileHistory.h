#pragma once

#include "CMapRowTable.h"
#include "Vec3.h"

#include <cstddef>
#include <deque>
#include <string>

namespace gw {

/// All that a user can change in a profile, as it stood at one moment.
struct CProfileState
{
    CMapRowTable rows; ///< with their selection
    std::string name;
    std::string path;
    Vec3 rootOffset = kVec3Zero;
    int frameRate = 0;
    bool dirty = false;

    /// Whether rows, name and numbers are the same; path, selection and dirty flag have no say.
    bool IsSameProfile(const CProfileState& other) const;
};

/// The states that undo and redo go through. Every state stands for itself, so that a step never depends on
/// what the rows looked like when it is taken.
class CProfileHistory
{
public:
    /// Older states are forgotten: a hundred of a full skeleton take a few megabytes.
    static constexpr size_t kStepLimit = 100;

    /// A command led from one state to another. What was undone before can no longer be redone then. Nothing
    /// for a command that left the profile as it was.
    void Keep(CProfileState before, const CProfileState& after);
    /// Each goes one step that changes the present profile; false, and the state left alone, where none is
    /// left.
    bool Undo(CProfileState& present) { return Step(m_kUndo, m_kRedo, present); }
    bool Redo(CProfileState& present) { return Step(m_kRedo, m_kUndo, present); }
    /// The present state was written to a file: every other one differs from that file now, and takes its
    /// name, so that no undone name leads a later save to another profile's file.
    void ProfileSaved(const std::string& name, const std::string& path);
    /// Another profile is the present one.
    void Clear();

private:
    using States = std::deque<CProfileState>;

    static bool Step(States& from, States& to, CProfileState& present);

    States m_kUndo; // the state to go to next stands last, in both
    States m_kRedo;
};

} // namespace gw
