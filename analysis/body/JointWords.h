#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

namespace gw {

/// What a name can say of a joint, before the other names tell what it means in their company: a "shoulder"
/// is a clavicle beside an upper arm and an upper arm beside a clavicle.
enum class EJointWord : uint8_t
{
    None,
    // In the middle of the body.
    Hip,
    HipBase, ///< the foot of the spine, where nothing is called hip
    Spine,
    Neck,
    Head,
    HeadEnd,
    // On a side.
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

/// A joint's name as it is understood.
struct JointName
{
    EJointWord word = EJointWord::None;
    ENameSide side = ENameSide::None;
    int number = -1;     ///< -1 for none
    bool helper = false; ///< marked as a joint that only helps another one of the same name
};

/// Reads a name that has no namespace any more: words in any case, run together or with anything but letters
/// and digits between them, a side at the front, at the back or in between as a word or a letter, one number.
/// A name with a word that belongs to no joint of a body (twist, end, thumb, prop) says nothing.
JointName ReadJointName(std::string_view name);

} // namespace gw
