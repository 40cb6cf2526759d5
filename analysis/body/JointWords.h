#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

namespace gw {

/// What a single name can mean, before the other names decide: a "shoulder" is a clavicle if there is an
/// upper arm, and an upper arm if there is a clavicle.
enum class EJointWord : uint8_t
{
    None,
    // Of the trunk.
    Hip,
    HipBase, ///< the base of the spine, if nothing is called hip
    Spine,
    Neck,
    Head,
    HeadEnd,
    // Of one side.
    Clavicle,
    Shoulder,
    UpperArm,
    Arm,
    Forearm,
    Wrist,
    Hand,
    SideHip,
    Thigh,
    Leg,
    Shin,
    Ankle,
    Foot,
    Toe,
};
inline constexpr size_t kJointWordCount = static_cast<size_t>(EJointWord::Toe) + 1;

enum class ENameSide : uint8_t
{
    None,
    Left,
    Right,
};

/// An interpreted joint name.
struct JointName
{
    EJointWord word = EJointWord::None;
    ENameSide side = ENameSide::None;
    int number = -1;     ///< -1 without a number
    bool helper = false; ///< a helper of another joint with the same name
};

/// Interprets a name without namespace: words in any case, joined or separated by anything but letters and
/// digits; a side at the front, at the end or in between, as a word or a letter; one number. A name with a
/// word that is not part of a body joint (twist, end, thumb, prop) has no meaning.
JointName ReadJointName(std::string_view name);

} // namespace gw
