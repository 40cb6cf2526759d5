#include "CNamedBody.h"

#include "BodyTree.h"
#include "Text.h"

#include <algorithm>

namespace gw {
namespace {

std::vector<std::string> Words(std::string_view text)
{
    std::vector<std::string> words;
    for (std::string_view word = NextToken(text); !word.empty(); word = NextToken(text))
        words.emplace_back(word);
    return words;
}

std::string RecipeFor(const Convention& convention, const BodyChange& change)
{
    std::string recipe = "exact spine" + std::to_string(Words(convention.trunk).size() - 1) + " neck" +
                         std::to_string(Words(convention.head).size() - 1);
    if (change.names == BodyChange::ArmsShifted)
        recipe += " noclavicle handend";
    if (*convention.arm == '-')
        recipe += " noclavicle";
    if (*convention.leg != '-')
        recipe += " hipjoints";
    if (!change.toes || Words(convention.leg).back() == "-")
        recipe += " notoes";
    return recipe + (change.fingers ? " fingers" : "");
}

} // namespace

CNamedBody::CNamedBody(const Convention& convention, const BodyChange& change)
    : convention_(convention), m_kChange(change), m_kMade(RecipeFor(convention, change), 1)
{
    NameTrunk();
    for (const EBodySide side : kBodySides)
        NameLimbs(side);
}

bool CNamedBody::MayDrive(std::string_view target, std::string_view joint) const
{
    return std::ranges::any_of(
        m_kDrives, [=](const auto& drive) { return drive.first == joint && drive.second == target; });
}

void CNamedBody::Name(CNode& joint, std::string name, EBodySide side, const std::string& target)
{
    const bool isLeft = (side == EBodySide::Left) != (m_kChange.names == BodyChange::SidesSwapped);
    if (const size_t star = name.find_first_of("*+"); star != name.npos)
    {
        const std::string word = Words(convention_.sides)[isLeft ? 0 : 1];
        name.replace(star, 1, name[star] == '*' ? word : isLeft ? "L" : "R");
    }
    name = m_kChange.prefix + name;
    if (m_kChange.letters != BodyChange::AsTheyAre)
        name = m_kChange.letters == BodyChange::Upper ? UpperCase(name) : LowerCase(name);
    joint.SetName(name.c_str());
    m_kDrives.emplace_back(name, target);
}

// Names joints that stand for targets; "-" names none.
void CNamedBody::NameLimb(EBodySide side, const std::vector<std::string>& names,
                          const std::vector<Part>& parts)
{
    const std::string letter = side == EBodySide::Left ? "L" : "R";
    for (size_t i = 0; i < parts.size(); ++i)
    {
        const auto& [joint, target] = parts[i];
        if (joint && names[i] != "-")
            Name(*joint, names[i], side, *target ? letter + target : "");
    }
}

void CNamedBody::NameTrunk()
{
    const CBodyMap& body = m_kMade.Body();
    const std::vector<std::string> trunk = Words(convention_.trunk);
    const std::vector<std::string> head = Words(convention_.head);
    Name(*body.hip, trunk[0], EBodySide::Left, "LowerTorso");
    for (size_t i = 1; i < trunk.size(); ++i)
        Name(*body.spine[i - 1], trunk[i], EBodySide::Left, i + 1 == trunk.size() ? "UpperTorso" : "Waist");
    for (size_t i = 0; i + 1 < head.size(); ++i)
        Name(*body.neck[i], head[i], EBodySide::Left, "Neck");
    Name(*body.head, head.back(), EBodySide::Left, "Head");
}

void CNamedBody::NameLimbs(EBodySide side)
{
    const BodyLeg& leg = m_kMade.Body().Leg(side);
    NameLimb(side, Words(convention_.leg),
             {{leg.thigh->GetParentNode(), ""},
              {leg.thigh, "Thigh"},
              {leg.shin, "Calf"},
              {leg.foot, "Foot"},
              {leg.toe, ""}});
    const BodyArm& arm = m_kMade.Body().Arm(side);
    std::vector<std::string> names = Words(convention_.arm);
    if (m_kChange.names == BodyChange::ArmsExchanged)
        std::swap(names[0], names[1]);
    if (m_kChange.names == BodyChange::ArmsShifted)
        names.insert(names.begin(), "-");
    names.emplace_back("-");
    NameLimb(side, names,
             {{arm.clavicle, "Collar"},
              {arm.upperArm, "UpperArm"},
              {arm.forearm, "Forearm"},
              {arm.hand, "Hand"},
              {FirstChild(*arm.hand), ""}});
    // The collar drives the torso of the stock profile that works for any number of chest joints.
    if (arm.clavicle && side == EBodySide::Left)
        m_kDrives.emplace_back(arm.clavicle->GetName(), "UpperTorso");
    if (m_kChange.fingers)
        NameFingers(*arm.hand, side);
}

void CNamedBody::NameFingers(CNode& hand, EBodySide side)
{
    constexpr const char* kFingers[] = {"Thumb", "Index", "Middle", "Ring", "Pinky"};
    const char* const* finger = kFingers;
    for (CNode* joint : ChildNodes(hand))
    {
        int number = 1;
        for (; joint; joint = FirstChild(*joint))
            Name(*joint, std::string("*Hand") + *finger + std::to_string(number++), side);
        ++finger;
    }
}

} // namespace gw
