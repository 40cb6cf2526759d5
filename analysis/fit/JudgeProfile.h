#pragma once

#include "CBodyMap.h"
#include "CJointTree.h"
#include "CRestWorlds.h"
#include "CheckBody.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace gw {

class CNodeNames;
class CRetargeter;

/// How certain it is that a profile's rows name the right joints.
enum class ESureness : uint8_t
{
    Sure,     ///< nothing contradicts it
    Likely,   ///< usable, with the flaws listed as doubts
    Doubtful, ///< the joints' positions contradict it
};

/// What speaks against a profile, and the joints concerned.
struct ProfileDoubt
{
    EDoubt kind = EDoubt::NotBelow;
    std::string joint; ///< name of a joint of the source
    std::string other; ///< of OtherName, what that name stands for here; of SpineCut, the last joint left out
};

/// The verdict on a profile whose rows all fit.
struct ProfileVerdict
{
    ESureness sureness = ESureness::Sure;
    std::vector<ProfileDoubt> doubts;
    size_t leftOut = 0; ///< number of spine joints above the one that drives the upper torso
    double turn = 0.0;  ///< mean misrotation of the bones in degrees
};

/// The analysis of a source, shared by all judged profiles.
struct SourceBody
{
    explicit SourceBody(CNode& root);

    /// What CheckBody returns. Most maps of one rig differ only in their rotations, so the last answer is
    /// kept.
    const std::vector<BodyDoubt>& Check(const CBodyMap& body);

    CBodyMap byNames;   ///< found by joint names
    CJointTree tree;    ///< positions and lengths
    CRestWorlds worlds; ///< of the source and the target
    CBodyMap checked;
    std::vector<BodyDoubt> doubts; ///< of the body that was checked last
};

/// Judges the rows of a retargeter's table.
ProfileVerdict JudgeProfile(const CRetargeter& table, const CNodeNames& targets, SourceBody& source);

} // namespace gw
