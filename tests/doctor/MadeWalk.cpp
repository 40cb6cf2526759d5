#include "MadeWalk.h"

#include "Angles.h"
#include "Vec3.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <gtest/gtest.h>
#include <vector>

namespace gw {

namespace {

constexpr double kStrideSeconds = 1.1;
constexpr double kSwing = 25.0; // degrees of a thigh to each side
constexpr double kLeg = 82.0;
constexpr float kHipHeight = 90.0f;

struct JointRow
{
    const char* name;
    int depth;
    Vec3 offset;  // cm
    double turn;  // degrees about X at the end of a swing
    double onset; // of the stride
};

constexpr JointRow kJoints[] = {
    {"Hips",          0, {0.0f, 0.0f, 0.0f},   0.0,    0.0},
    {"LeftUpLeg",     1, {9.0f, -2.0f, 0.0f},  kSwing, 0.0},
    {"LeftLeg",       2, {0.0f, -41.0f, 0.0f}, 0.0,    0.0},
    {"LeftFoot",      3, {0.0f, -41.0f, 0.0f}, 0.0,    0.0},
    {"LeftToeBase",   4, {0.0f, -5.0f, 14.0f}, 0.0,    0.0},
    {"RightUpLeg",    1, {-9.0f, -2.0f, 0.0f}, kSwing, 0.5},
    {"RightLeg",      2, {0.0f, -41.0f, 0.0f}, 0.0,    0.0},
    {"RightFoot",     3, {0.0f, -41.0f, 0.0f}, 0.0,    0.0},
    {"RightToeBase",  4, {0.0f, -5.0f, 14.0f}, 0.0,    0.0},
    {"Spine",         1, {0.0f, 10.0f, 0.0f},  2.0,    0.0},
    {"Spine1",        2, {0.0f, 20.0f, 0.0f},  2.0,    0.3},
    {"LeftShoulder",  3, {4.0f, 18.0f, 0.0f},  1.0,    0.1},
    {"LeftArm",       4, {13.0f, 0.0f, 0.0f},  9.0,    0.5},
    {"LeftForeArm",   5, {27.0f, 0.0f, 0.0f},  3.0,    0.6},
    {"LeftHand",      6, {25.0f, 0.0f, 0.0f},  2.0,    0.7},
    {"RightShoulder", 3, {-4.0f, 18.0f, 0.0f}, 1.0,    0.6},
    {"RightArm",      4, {-13.0f, 0.0f, 0.0f}, 9.0,    0.0},
    {"RightForeArm",  5, {-27.0f, 0.0f, 0.0f}, 3.0,    0.1},
    {"RightHand",     6, {-25.0f, 0.0f, 0.0f}, 2.0,    0.2},
    {"Neck",          3, {0.0f, 22.0f, 0.0f},  1.0,    0.4},
    {"Head",          4, {0.0f, 10.0f, 1.0f},  1.0,    0.8},
};
constexpr Vec3 kEnd{0.0f, 6.0f, 0.0f};

class CWalkText
{
public:
    explicit CWalkText(const WalkStyle& style) : style_(style)
    {
        if (style.rootBelow)
            m_kJoints.push_back({"Reference", -1, kVec3Zero, 0.0, 0.0});
        for (const JointRow& joint : kJoints)
        {
            if (style.toes || !std::string_view(joint.name).ends_with("ToeBase"))
                m_kJoints.push_back(joint);
        }
        if (style.hipOffset)
            m_kJoints.front().offset.y = kHipHeight;
    }

    std::string Run()
    {
        Line(0, "HIERARCHY");
        for (size_t i = 0; i < m_kJoints.size(); ++i)
            AppendJoint(i);
        Line(0, "MOTION");
        Line(0, "Frames: " + std::to_string(style_.frames));
        Line(0, "Frame Time: " + Number(1.0 / style_.declaredRate));
        for (int frame = 0; frame < style_.frames; ++frame)
            AppendRow(frame / style_.rate);
        return m_kText;
    }

private:
    int DepthOf(size_t joint) const { return m_kJoints[joint].depth + (style_.rootBelow ? 1 : 0); }
    bool HasPositions(size_t joint) const
    {
        return DepthOf(joint) <= (style_.rootBelow ? 1 : 0) || style_.sixChannels || style_.repeatsOffsets;
    }

    void Line(int depth, const std::string& words)
    {
        m_kText += std::string(static_cast<size_t>(depth), '\t') + words + '\n';
    }
    std::string Number(double number) const
    {
        char text[40];
        std::snprintf(text, sizeof(text), style_.scientific ? "%.7e" : "%.6f", number);
        return text;
    }
    std::string Numbers(const Vec3& v) const
    {
        const Vec3 up = (style_.zUp ? Vec3{v.x, -v.z, v.y} : v) * style_.unit;
        return Number(up.x) + ' ' + Number(up.y) + ' ' + Number(up.z);
    }

    void AppendJoint(size_t joint)
    {
        const int depth = DepthOf(joint);
        Line(depth, (joint == 0 ? "ROOT " : "JOINT ") + std::string(m_kJoints[joint].name));
        Line(depth, "{");
        Line(depth + 1, "OFFSET " + Numbers(m_kJoints[joint].offset));
        Line(depth + 1, HasPositions(joint)
                            ? "CHANNELS 6 Xposition Yposition Zposition Zrotation Xrotation Yrotation"
                            : "CHANNELS 3 Zrotation Xrotation Yrotation");
        const int next = joint + 1 < m_kJoints.size() ? DepthOf(joint + 1) : 0;
        if (next <= depth)
            AppendEnd(depth + 1);
        for (int open = depth; open >= next && (open > 0 || joint + 1 == m_kJoints.size()); --open)
            Line(open, "}");
    }
    void AppendEnd(int depth)
    {
        Line(depth, "End Site");
        Line(depth, "{");
        Line(depth + 1, "OFFSET " + Numbers(kEnd));
        Line(depth, "}");
    }

    // A leg swings evenly, so that the foot on the ground stands while the hip goes on.
    static double Wave(double strides) { return std::asin(std::sin(2.0 * kPi64 * strides)) / kHalfPi64; }
    Vec3 HipAt(double seconds) const
    {
        const double step = 2.0 * kLeg * std::sin(kSwing * kDegreesToRadians64);
        return {0.0f, kHipHeight, static_cast<float>(2.0 * step * seconds / kStrideSeconds)};
    }
    void AppendRow(double seconds)
    {
        std::string row;
        for (size_t joint = 0; joint < m_kJoints.size(); ++joint)
        {
            const bool hip = m_kJoints[joint].name == std::string_view("Hips");
            const Vec3 position = hip                     ? HipAt(seconds)
                                  : style_.repeatsOffsets ? m_kJoints[joint].offset
                                                          : kVec3Zero;
            if (HasPositions(joint))
                row += Numbers(position) + ' ';
            const double turn =
                m_kJoints[joint].turn * Wave(seconds / kStrideSeconds + m_kJoints[joint].onset);
            row += Number(0.0) + ' ' + Number(turn) + ' ' + Number(0.0) + ' ';
        }
        row.pop_back();
        Line(0, row);
    }

    const WalkStyle& style_;
    std::vector<JointRow> m_kJoints;
    std::string m_kText;
};

// Where a line begins; the end of the text for one behind it.
size_t BeginOf(std::string_view text, size_t number)
{
    size_t at = 0;
    for (; number > 1 && at < text.size(); --number)
        at = std::min(text.find('\n', at), text.size() - 1) + 1;
    return at;
}

size_t BeginOfValue(std::string_view row, size_t column)
{
    size_t begin = 0;
    for (; column > 0; --column)
        begin = row.find(' ', begin) + 1;
    return begin;
}

} // namespace

std::string MadeWalk(const WalkStyle& style)
{
    return CWalkText(style).Run();
}

std::string Replaced(std::string text, std::string_view part, std::string_view instead,
                     std::string_view behind)
{
    const size_t at = text.find(part, behind.empty() ? 0 : text.find(behind));
    if (at == text.npos)
        ADD_FAILURE() << "no \"" << part << '"';
    else
        text.replace(at, part.size(), instead);
    return text;
}

std::string AllReplaced(std::string text, std::string_view part, std::string_view instead)
{
    for (size_t at = text.find(part); at != text.npos; at = text.find(part, at + instead.size()))
        text.replace(at, part.size(), instead);
    return text;
}

size_t LineOfFrame(std::string_view text, int frame)
{
    const std::string_view head = text.substr(0, text.find("Frame Time:"));
    return static_cast<size_t>(std::ranges::count(head, '\n')) + 2 + static_cast<size_t>(frame);
}

std::string LineOf(std::string_view text, size_t number)
{
    const size_t begin = BeginOf(text, number);
    return std::string(text.substr(begin, text.find('\n', begin) - begin));
}

std::string WithLine(std::string_view text, size_t number, std::string_view line)
{
    const size_t begin = BeginOf(text, number);
    return std::string(text).replace(begin, LineOf(text, number).size(), line);
}

std::string WithValue(std::string_view row, size_t column, std::string_view value)
{
    const size_t begin = BeginOfValue(row, column);
    return std::string(row).replace(begin, row.find(' ', begin) - begin, value);
}

double ValueOf(std::string_view text, int frame, size_t column)
{
    const std::string row = LineOf(text, LineOfFrame(text, frame));
    return std::stod(row.substr(BeginOfValue(row, column)));
}

} // namespace gw
