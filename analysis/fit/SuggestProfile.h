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

/// The kind of a suggested row.
enum class ESuggestedRow : uint8_t
{
    Turned,   ///< a source bone drives the target's through offset and axes
    Neutral,  ///< same without offset and axes: thighs and shins
    Fixed,    ///< not driven by a source, by definition of the format
    NoSource, ///< the skeleton has no such joint; not written to the profile
    NoName,   ///< the joint exists, but a profile cannot hold its name: see SuggestedRow::source
};

enum class ERowSureness : uint8_t
{
    Sure,   ///< name and shape agree
    Likely, ///< supported by one and not contradicted by the other
    Unsure, ///< check this row
};

/// A considered row, with the evidence for it.
struct SuggestedRow
{
    std::string target;
    CNode* source = nullptr;
    BodyPlace place; ///< the source's role in its body
    ESuggestedRow kind = ESuggestedRow::Turned;
    RowNumbers numbers;
    EBodyEvidence evidence = EBodyEvidence::None;
    ERowSureness sureness = ERowSureness::Sure;
    std::vector<EDoubt> doubts; ///< concerning this joint
    bool nudged = false;        ///< twist slightly off, to keep a bone below away from a pole
    /// Angle in degrees between both bones' directions in the source's rest pose; nothing if one has no
    /// direction.
    std::optional<double> restError;

    bool IsMapping() const { return kind <= ESuggestedRow::Neutral; }
};

/// A profile for a skeleton, with its evidence.
struct SuggestedProfile
{
    /// in the order of the target's bones, including rows that are not written
    std::vector<SuggestedRow> rows;
    /// of the thirteen required joints; empty for a profile that drives the whole body
    std::vector<BodyPlace> missing;
    bool sidesAreSure = true;  ///< names or poses show which side is left
    bool restIsStance = true;  ///< the rest pose is a standing pose
    bool turnsFromRest = true; ///< otherwise, twists come from a frame of the motion

    /// Returns the rows that are written to the profile.
    CMapRowTable Table() const;
};

/// Creates a profile for a skeleton from its body (FindBody) and the rest poses of both skeletons. Each
/// offset makes the target bone point like the source bone, in the source's rest pose at least and in every
/// pose in which the bone is rigid, with the smallest possible twist relative to the target's rest pose. The
/// trees are posed during the call and restored.
SuggestedProfile SuggestProfile(CNode& sourceRoot, CNode& targetRoot);

/// Returns a display name for a profile made for a file: the file name without folder and extension, with
/// blanks for underscores. `stem` can have any length.
std::string SuggestedName(std::string_view stem);

} // namespace gw
