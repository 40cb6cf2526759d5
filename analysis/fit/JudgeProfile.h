#pragma once

#include "CBodyMap.h"
#include "CJointTree.h"
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

/// A doubt about a profile.
enum class EProfileDoubt : uint8_t
{
    Places,    ///< these joints cannot form a body; see `places`
    OtherName, ///< the joint's name says that it is a different part, which is `other` here
    SpineCut,  ///< leaves out spine joints above the one that drives the upper torso
    Turned,    ///< the bone is rotated by about a quarter turn or more
};

/// Returns whether a doubt concerns the joints' roles, not the rotation of bones.
constexpr bool IsOfRoles(EProfileDoubt kind)
{
    return kind == EProfileDoubt::Places || kind == EProfileDoubt::OtherName;
}

struct ProfileDoubt
{
    EProfileDoubt kind = EProfileDoubt::Places;
    EBodyDoubt places = EBodyDoubt::NotBelow; ///< if kind is Places
    std::string joint;                        ///< a source joint's name
    std::string other;                        ///< another one's name, or empty
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

    /// What CheckBody returns. Most maps of one rig differ only in their rotations, so the last answer is kept.
    const std::vector<BodyDoubt>& Check(const CBodyMap& body);

    CBodyMap byNames; ///< found by joint names
    CJointTree tree;  ///< positions and lengths
    CBodyMap checked;
    std::vector<BodyDoubt> doubts; ///< of the body that was checked last
};

/// Judges the rows of a retargeter's table.
ProfileVerdict JudgeProfile(const CRetargeter& table, const CNodeNames& targets, SourceBody& source);

} // namespace gw
