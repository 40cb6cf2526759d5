#pragma once

#include "CMapRowTable.h"
#include "FindBody.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CNode;

/// What a row of a suggested profile does.
enum class ESuggestedRow : uint8_t
{
    Turned,   ///< a source bone drives the target's, through offset and axes
    Neutral,  ///< the same without any: thighs and shins
    Fixed,    ///< no source drives it, as the rules have it
    NoSource, ///< the skeleton has no such joint, and no row stands in the profile
    NoName,   ///< there is a joint, and a profile cannot name it: see SuggestedRow::source
};

enum class ERowSureness : uint8_t
{
    Sure,   ///< name and shape agree
    Likely, ///< one of them tells, and the other does not contradict
    Unsure, ///< look at it
};

/// A row that was thought of, with what is known about it.
struct SuggestedRow
{
    std::string target;
    CNode* source = nullptr;
    BodyPlace place; ///< what the source is in its body
    ESuggestedRow kind = ESuggestedRow::Turned;
    RowNumbers numbers;
    EBodyEvidence evidence = EBodyEvidence::None;
    ERowSureness sureness = ERowSureness::Sure;
    std::vector<EBodyDoubt> doubts; ///< that concern the joint
    bool nudged =
        false; ///< turned a little about itself, to keep a bone below from where it cannot be followed
    /// Between the directions of both bones in the source's rest pose, degrees; nothing where one has none.
    std::optional<double> restError;

    bool IsMapping() const { return kind <= ESuggestedRow::Neutral; }
};

/// A profile for a skeleton, and how it came about.
struct SuggestedProfile
{
    std::vector<SuggestedRow> rows; ///< in the order of the target's bones, with those that came to nothing
    std::vector<BodyPlace> missing; ///< of the thirteen joints: none in a profile that drives the whole body
    bool sidesAreSure = true;       ///< names or poses show which side is the left one
    bool restIsStance = true;       ///< a body could stand as it does at rest
    bool turnsFromRest = true;      ///< else the turns about the bones come from a frame of the motion

    /// The rows that stand in the profile.
    CMapRowTable Table() const;
};

/// Makes a profile for a skeleton from its body (FindBody) and the rest poses of both skeletons. Each offset
/// makes a target bone point as the source's bone does in every pose in which the source's bone is rigid, the
/// rest pose of the source at the least, and turns it about itself as little as can be against the target's
/// rest pose. The trees are posed meanwhile and left as they were.
SuggestedProfile SuggestProfile(CNode& sourceRoot, CNode& targetRoot);

/// A display name for a profile that was made for a file: its name without folder and extension, with blanks
/// for underscores; `stem` may be of any length.
std::string SuggestedName(std::string_view stem);

} // namespace gw
