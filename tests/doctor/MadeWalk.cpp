#include "MadeWalk.h"

#include "Angles.h"
#include "CMadeText.h"

#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>
#include <vector>

namespace gw {
namespace {

constexpr double kStrideSeconds = 1.1;
constexpr double kSwing = 25.0; // in degrees, of a thigh to each side
constexpr double kLeg = 82.0;
constexpr float kHipHeight = 90.0f;

struct JointRow
{
    const char* name;
    int depth;
    Vec3 offset;  // cm
    double turn;  // in degrees about X at the end of a swing
    double onset; // fraction of the stride
};

constexpr JointRow kJoints[] = {
    {"Hips", 0, {0.0f, 0.0f, 0.0f}, 0.0, 0.0},           {"LeftUpLeg", 1, {9.0f, -2.0f, 0.0f}, kSwing, 0.0},
    {"LeftLeg", 2, {0.0f, -41.0f, 0.0f}, 0.0, 0.0},      {"LeftFoot", 3, {0.0f, -41.0f, 0.0f}, 0.0, 0.0},
    {"LeftToeBase", 4, {0.0f, -5.0f, 14.0f}, 0.0, 0.0},  {"RightUpLeg", 1, {-9.0f, -2.0f, 0.0f}, kSwing, 0.5},
    {"RightLeg", 2, {0.0f, -41.0f, 0.0f}, 0.0, 0.0},     {"RightFoot", 3, {0.0f, -41.0f, 0.0f}, 0.0, 0.0},
    {"RightToeBase", 4, {0.0f, -5.0f, 14.0f}, 0.0, 0.0}, {"Spine", 1, {0.0f, 10.0f, 0.0f}, 2.0, 0.0},
    {"Spine1", 2, {0.0f, 20.0f, 0.0f}, 2.0, 0.3},        {"LeftShoulder", 3, {4.0f, 18.0f, 0.0f}, 1.0, 0.1},
    {"LeftArm", 4, {13.0f, 0.0f, 0.0f}, 9.0, 0.5},       {"LeftForeArm", 5, {27.0f, 0.0f, 0.0f}, 3.0, 0.6},
    {"LeftHand", 6, {25.0f, 0.0f, 0.0f}, 2.0, 0.7},      {"RightShoulder", 3, {-4.0f, 18.0f, 0.0f}, 1.0, 0.6},
    {"RightArm", 4, {-13.0f, 0.0f, 0.0f}, 9.0, 0.0},     {"RightForeArm", 5, {-27.0f, 0.0f, 0.0f}, 3.0, 0.1},
    {"RightHand", 6, {-25.0f, 0.0f, 0.0f}, 2.0, 0.2},    {"Neck", 3, {0.0f, 22.0f, 0.0f}, 1.0, 0.4},
    {"Head", 4, {0.0f, 10.0f, 1.0f}, 1.0, 0.8},
};

// A leg swings at constant speed, so that the foot on the ground stands while the hip moves on.
double Wave(double strides)
{
    return std::asin(std::sin(2.0 * kPi64 * strides)) / kHalfPi64;
}

Vec3 HipAt(double seconds)
{
    const double step = 2.0 * kLeg * std::sin(kSwing * kDegreesToRadians64);
    return {0.0f, kHipHeight, static_cast<float>(2.0 * step * seconds / kStrideSeconds)};
}

std::vector<JointRow> JointsOf(const WalkStyle& style)
{
    std::vector<JointRow> joints;
    if (style.rootBelow)
        joints.push_back({"Reference", -1, kVec3Zero, 0.0, 0.0});
    for (const JointRow& joint : kJoints)
    {
        if (style.toes || !std::string_view(joint.name).ends_with("ToeBase"))
            joints.push_back(joint);
    }
    if (style.hipOffset)
        joints.front().offset.y = kHipHeight;
    return joints;
}

// Returns where a line starts; the end of the text for a line after the last one.
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
    const auto written = [&](const Vec3& v) { return (style.zUp ? Vec3{v.x, -v.z, v.y} : v) * style.unit; };
    const std::vector<JointRow> rows = JointsOf(style);
    std::vector<TextJoint> joints;
    for (const JointRow& row : rows)
    {
        // The closest earlier joint that is one level higher.
        const auto isAbove = [&](const JointRow& other) { return other.depth == row.depth - 1; };
        const auto above =
            std::find_if(rows.rend() - static_cast<ptrdiff_t>(joints.size()), rows.rend(), isAbove);
        joints.push_back({row.name, static_cast<int>(rows.rend() - above) - 1, written(row.offset),
                          written({0.0f, 6.0f, 0.0f}),
                          row.depth == 0 || style.sixChannels || style.repeatsOffsets});
    }
    const auto key = [&](size_t joint, int frame) {
        const JointRow& row = rows[joint];
        const double seconds = frame / style.rate;
        const bool isHip = row.name == std::string_view("Hips");
        const Vec3 position = isHip ? HipAt(seconds) : style.repeatsOffsets ? row.offset : kVec3Zero;
        const double turn = row.turn * Wave(seconds / kStrideSeconds + row.onset);
        return TextKey{written(position), {static_cast<float>(turn), 0.0f, 0.0f}};
    };
    CMadeText text(std::move(joints));
    text.m_bScientific = style.scientific;
    return text.Write(style.frames, 1.0 / style.declaredRate, key);
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
