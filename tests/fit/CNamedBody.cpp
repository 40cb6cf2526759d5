#include "CNamedBody.h"

#include "TempFolder.h"
#include "Text.h"

#include <algorithm>
#include <gtest/gtest.h>

namespace gw {
namespace {

constexpr const char* kFingers[] = {"Thumb", "Index", "Middle"};

std::vector<std::string> Words(std::string_view text)
{
    std::vector<std::string> words;
    for (std::string_view word = NextToken(text); !word.empty(); word = NextToken(text))
        words.emplace_back(word);
    return words;
}

} // namespace

CNamedBody::CNamedBody(const Convention& convention, const BodyChange& change)
    : convention_(convention), m_kChange(change)
{
    AddTrunk();
    const CTempFolder folder;
    const auto key = [](size_t joint, int) {
        return TextKey{{0.0f, joint == 0 ? 95.0f : 0.0f, 0.0f}, kVec3Zero};
    };
    WriteBytes(folder.Path("body.bvh"), CMadeText(m_kJoints).Write(2, 1.0 / 30.0, key));
    EXPECT_TRUE(m_kMotion.Load(folder.Path("body.bvh"))) << convention.what << ", " << change.what;
}

bool CNamedBody::MayDrive(const std::string& target, std::string_view joint) const
{
    const auto targets = m_kTargets.find(std::string(joint));
    return targets != m_kTargets.end() && std::ranges::count(Words(targets->second), target) == 1;
}

// Returns the name of a side's joint; `side` is 1 for the body's left, -1 for its right, 0 for the trunk.
std::string CNamedBody::NameFor(std::string name, float side) const
{
    const bool isLeft = (side > 0.0f) != (m_kChange.names == BodyChange::SidesSwapped);
    const std::string word = Words(convention_.sides)[isLeft ? 0 : 1];
    if (const size_t star = name.find_first_of("*+"); star != name.npos)
        name = name.substr(0, star) + (name[star] == '*' ? word : isLeft ? "L" : "R") + name.substr(star + 1);
    name = m_kChange.prefix + name;
    if (m_kChange.letters == BodyChange::AsTheyAre)
        return name;
    return m_kChange.letters == BodyChange::Upper ? UpperCase(name) : LowerCase(name);
}

int CNamedBody::Add(int parent, const std::string& name, std::string_view targets, float x, float y, float z)
{
    // A shin's end is the ankle, and the foot is in front of it; all other bones continue straight.
    const Vec3 tip = y < -30.0f ? Vec3{0.0f, -7.0f, 13.0f} : Vec3{x / 2.0f, y, z};
    m_kJoints.push_back({name, parent, {x, y, z}, tip});
    m_kTargets[name] = targets;
    return static_cast<int>(m_kJoints.size()) - 1;
}

void CNamedBody::AddTrunk()
{
    std::vector<std::string> trunk = Words(convention_.trunk);
    int top = Add(-1, NameFor(trunk[0], 0.0f), "LowerTorso", 0.0f, 95.0f, 0.0f);
    const float step = 30.0f / static_cast<float>(trunk.size() - 1);
    AddLeg(1.0f);
    AddLeg(-1.0f);
    for (size_t i = 1; i < trunk.size(); ++i)
        top = Add(top, NameFor(trunk[i], 0.0f), i + 1 == trunk.size() ? "UpperTorso" : "Waist", 0.0f, step,
                  0.0f);
    AddArm(top, 1.0f);
    AddArm(top, -1.0f);
    AddHead(top);
}

void CNamedBody::AddHead(int chest)
{
    std::vector<std::string> names = Words(convention_.head);
    int top = chest;
    for (size_t i = 0; i + 1 < names.size(); ++i)
        top = Add(top, NameFor(names[i], 0.0f), "Neck", 0.0f, i == 0 ? 20.0f : 5.0f, 0.0f);
    Add(top, NameFor(names.back(), 0.0f), "Head", 0.0f, 9.0f, 0.0f);
}

void CNamedBody::AddArm(int chest, float side)
{
    constexpr const char* kBones[] = {"Collar", "UpperArm", "Forearm", "Hand"};
    constexpr float kOut[] = {4.0f, 14.0f, 28.0f, 26.0f};
    std::vector<std::string> names = Words(convention_.arm);
    if (m_kChange.names == BodyChange::ArmsExchanged)
        std::swap(names[0], names[1]);
    const bool shifted = m_kChange.names == BodyChange::ArmsShifted;
    if (shifted) // the joint in the clavicle's place is missing
        names.insert(names.begin(), "-");
    const std::string letter = side > 0.0f ? "L" : "R";
    int joint = chest;
    float out = 0.0f;
    for (size_t i = 0; i < names.size(); ++i)
    {
        out += i < std::size(kOut) ? kOut[i] : 9.0f;
        if (names[i] == "-")
            continue;
        const std::string target = i < std::size(kBones) ? letter + kBones[i] : "";
        // The collar drives the torso of the stock profile that works for any number of chest joints.
        const std::string also = i == 0 && side > 0.0f ? " UpperTorso" : "";
        joint = Add(joint, NameFor(names[i], side), target + also, side * out, joint == chest ? 14.0f : 0.0f,
                    0.0f);
        out = 0.0f;
    }
    AddHand(joint, side);
}

void CNamedBody::AddHand(int hand, float side)
{
    float z = 3.0f;
    for (const char* finger : kFingers)
    {
        if (m_kChange.fingers)
            Add(hand, NameFor(std::string("*Hand") + finger + '1', side), "", side * 8.0f, 0.0f, z);
        z -= 3.0f;
    }
}

void CNamedBody::AddLeg(float side)
{
    constexpr const char* kBones[] = {"", "Thigh", "Calf", "Foot", ""};
    constexpr float kDown[] = {0.0f, -4.0f, -42.0f, -42.0f, -7.0f};
    const std::vector<std::string> names = Words(convention_.leg);
    const std::string letter = side > 0.0f ? "L" : "R";
    int joint = 0;
    for (size_t i = 0; i < names.size() - (m_kChange.toes ? 0 : 1); ++i)
    {
        if (names[i] != "-")
            joint = Add(joint, NameFor(names[i], side), *kBones[i] ? letter + kBones[i] : "",
                        i == 1 ? side * 9.0f : 0.0f, kDown[i], i == 4 ? 13.0f : 0.0f);
    }
}

} // namespace gw
