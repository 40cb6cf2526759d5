#pragma once

#include "CMadeText.h"
#include "CMotionFile.h"

#include <map>
#include <span>
#include <string>
#include <string_view>
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
std::span<const Convention> Conventions();

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

/// A human body in a T-pose facing z, in cm, read from a motion file of two frames.
class CNamedBody
{
public:
    CNamedBody(const Convention& convention, const BodyChange& change);

    CNode& Root() const { return *m_kMotion.motionRoot; }
    /// Returns whether a joint with this name may drive a target bone of the host skeleton.
    bool MayDrive(const std::string& target, std::string_view joint) const;

private:
    int Add(int parent, const std::string& name, std::string_view targets, float x, float y, float z);
    void AddTrunk();
    void AddHead(int chest);
    void AddArm(int chest, float side);
    void AddHand(int hand, float side);
    void AddLeg(float side);
    std::string NameFor(std::string name, float side) const;

    const Convention& convention_;
    BodyChange m_kChange;
    std::vector<TextJoint> m_kJoints;
    /// the targets that a joint may drive, separated by blanks
    std::map<std::string, std::string> m_kTargets;
    CMotionFile m_kMotion;
};

} // namespace gw
