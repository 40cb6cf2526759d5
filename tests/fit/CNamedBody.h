#pragma once

#include "CMadeText.h"
#include "CMotionFile.h"

#include <map>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// What a source of motions calls the joints of a body. Lists go upward or outward, with blanks in between
/// and
/// "-" for a joint that is not there. In names of a side, * stands for the side's word, + for its letter.
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

/// How a skeleton differs from what its convention says.
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
    /// How the names lie: what is wrong must not be taken in silence.
    enum ENames
    {
        Right,
        SidesSwapped,  ///< left names on the right side
        ArmsExchanged, ///< clavicle and upper arm have each other's name
        ArmsShifted,   ///< no clavicle, and its name on the upper arm; so on outward
    } names = Right;
};

/// A human body in a T-pose that looks along z, in cm, read from a motion file of two frames.
class CNamedBody
{
public:
    CNamedBody(const Convention& convention, const BodyChange& change);

    CNode& Root() const { return *m_kMotion.motionRoot; }
    /// Whether a target bone of the host skeleton may be driven by a joint of this name.
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
    std::map<std::string, std::string> m_kTargets; ///< the targets that a joint may drive, in words
    CMotionFile m_kMotion;
};

} // namespace gw
