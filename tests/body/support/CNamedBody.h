#pragma once

#include "CMadeSkeleton.h"

#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace gw {

/// How a source of motions names the joints of a body. Lists go upward or outward, separated by blanks, with
/// "-" for a missing joint. In side names, * is replaced by the side's word and + by its letter.
struct Convention
{
    const char* what;
    const char* sides; ///< "Left Right"
    const char* trunk; ///< hip, then the spine
    const char* head;  ///< neck joints, then the head
    const char* arm;   ///< clavicle, upper arm, forearm, hand
    const char* leg;   ///< a joint above the thigh, thigh, shin, foot, toe
};
inline constexpr Convention kHumanIK{"HumanIK",
                                     "Left Right",
                                     "Hips Spine Spine1",
                                     "Neck Head",
                                     "*Shoulder *Arm *ForeArm *Hand",
                                     "- *UpLeg *Leg *Foot *ToeBase"};

/// How a skeleton differs from its convention.
struct BodyChange
{
    const char* what;
    const char* prefix = "";
    enum ELetters
    {
        AsTheyAre,
        Upper,
        Lower,
    } letters = AsTheyAre;
    bool toes = true;
    bool fingers = false;
    /// How the names are wrong; such bodies must not be accepted without a warning.
    enum ENames
    {
        Right,
        SidesSwapped,  ///< left names on the right side
        ArmsExchanged, ///< clavicle and upper arm have swapped names
        ArmsShifted,   ///< no clavicle: the upper arm has its name, and so on outward
    } names = Right;
};

/// A human body in a T-pose facing z, in cm, with the names of a convention.
class CNamedBody
{
public:
    CNamedBody(const Convention& convention, const BodyChange& change);

    CNode& Root() const { return m_kMade.Root(); }
    const CBodyMap& Body() const { return m_kMade.Body(); }
    /// Returns whether a joint with this name may drive a target bone of the host skeleton.
    bool MayDrive(std::string_view target, std::string_view joint) const;

private:
    using Part = std::pair<CNode*, const char*>; // a joint and its target, without the side
    void NameTrunk();
    void NameFingers(CNode& hand, EBodySide side);
    void NameLimbs(EBodySide side);
    void NameLimb(EBodySide side, const std::vector<std::string>& names, const std::vector<Part>& parts);
    void Name(CNode& joint, std::string name, EBodySide side, const std::string& target = {});

    const Convention& convention_;
    BodyChange m_kChange;
    CMadeSkeleton m_kMade;
    std::vector<std::pair<std::string, std::string>> m_kDrives; // joints, and targets that each may drive
};

} // namespace gw
