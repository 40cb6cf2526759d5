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

/// How sure it is that a profile's rows name the joints that they should.
enum class ESureness : uint8_t
{
    Sure,     ///< nothing speaks against it
    Likely,   ///< it serves, with the flaws that its doubts tell
    Doubtful, ///< the body's places speak against it
};

/// What speaks against a profile.
enum class EProfileDoubt : uint8_t
{
    Places,    ///< a body of these joints cannot be; see `places`
    OtherName, ///< by its name the joint has another part in the body, which `other` has here
    SpineCut,  ///< spine joints above the one that drives the upper torso are left out
    Turned,    ///< the bone comes out turned across, about a quarter turn or more
};

/// Whether a doubt is about which joint is which, and not about how well the bones come out.
constexpr bool IsOfRoles(EProfileDoubt kind)
{
    return kind == EProfileDoubt::Places || kind == EProfileDoubt::OtherName;
}

struct ProfileDoubt
{
    EProfileDoubt kind = EProfileDoubt::Places;
    EBodyDoubt places = EBodyDoubt::NotBelow; ///< of Places
    std::string joint;                        ///< name of a joint of the source
    std::string other;                        ///< the same, or empty
};

/// What is told of a profile whose rows all fit.
struct ProfileVerdict
{
    ESureness sureness = ESureness::Sure;
    std::vector<ProfileDoubt> doubts;
    size_t leftOut = 0; ///< spine joints above the one that drives the upper torso
    double turn = 0.0;  ///< mean angle in degrees that the bones come out turned across
};

/// What is looked at of a source for every profile that is judged.
struct SourceBody
{
    explicit SourceBody(CNode& root);

    CBodyMap byNames; ///< as the names of the joints tell
    CJointTree tree;  ///< and how they lie
};

/// Judges the rows that a retargeter was told.
ProfileVerdict JudgeProfile(const CRetargeter& table, const CNodeNames& targets, const SourceBody& source);

} // namespace gw
