#include "MadeWalk.h"

#include "Angles.h"
#include "MadeText.h"

#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>
#include <span>
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
    const char* parent;
    Vec3 offset;  // cm
    double turn;  // in degrees about X at the end of a swing
    double onset; // fraction of the stride
};

constexpr JointRow kJoints[] = {
    {"Reference", "", {0, 0, 0}, 0, 0},
    {"Hips", "Reference", {0, 0, 0}, 0, 0},
    {"LeftUpLeg", "Hips", {9, -2, 0}, kSwing, 0},
    {"LeftLeg", "LeftUpLeg", {0, -41, 0}, 0, 0},
    {"LeftFoot", "LeftLeg", {0, -41, 0}, 0, 0},
    {"LeftToeBase", "LeftFoot", {0, -5, 14}, 0, 0},
    {"RightUpLeg", "Hips", {-9, -2, 0}, kSwing, 0.5},
    {"RightLeg", "RightUpLeg", {0, -41, 0}, 0, 0},
    {"RightFoot", "RightLeg", {0, -41, 0}, 0, 0},
    {"RightToeBase", "RightFoot", {0, -5, 14}, 0, 0},
    {"Spine", "Hips", {0, 10, 0}, 2, 0},
    {"Spine1", "Spine", {0, 20, 0}, 2, 0.3},
    {"LeftShoulder", "Spine1", {4, 18, 0}, 1, 0.1},
    {"LeftArm", "LeftShoulder", {13, 0, 0}, 9, 0.5},
    {"LeftForeArm", "LeftArm", {27, 0, 0}, 3, 0.6},
    {"LeftHand", "LeftForeArm", {25, 0, 0}, 2, 0.7},
    {"RightShoulder", "Spine1", {-4, 18, 0}, 1, 0.6},
    {"RightArm", "RightShoulder", {-13, 0, 0}, 9, 0},
    {"RightForeArm", "RightArm", {-27, 0, 0}, 3, 0.1},
    {"RightHand", "RightForeArm", {-25, 0, 0}, 2, 0.2},
    {"Neck", "Spine1", {0, 22, 0}, 1, 0.4},
    {"Head", "Neck", {0, 10, 1}, 1, 0.8},
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
    for (const JointRow& joint : std::span(kJoints).subspan(style.rootBelow ? 0 : 1))
    {
        if (style.toes || !std::string_view(joint.name).ends_with("ToeBase"))
            joints.push_back(joint);
    }
    if (style.hipOffset)
        joints.front().offset.y = kHipHeight;
    return joints;
}

// Returns where a part of a text begins, counted from 0; the end of the text behind its last part.
size_t BeginOf(std::string_view text, char separator, size_t part)
{
    size_t at = 0;
    for (; part > 0 && at < text.size(); --part)
        at = std::min(text.find(separator, at), text.size() - 1) + 1;
    return at;
}

std::string PartOf(std::string_view text, char separator, size_t part)
{
    const size_t begin = BeginOf(text, separator, part);
    return std::string(text.substr(begin, text.find(separator, begin) - begin));
}

std::string WithPart(std::string_view text, char separator, size_t part, std::string_view instead)
{
    const size_t length = PartOf(text, separator, part).size();
    return std::string(text).replace(BeginOf(text, separator, part), length, instead);
}

} // namespace

std::string MadeWalk(const WalkStyle& style)
{
    const auto written = [&](const Vec3& v) { return (style.zUp ? Vec3{v.x, -v.z, v.y} : v) * style.unit; };
    const std::vector<JointRow> rows = JointsOf(style);
    std::vector<TextJoint> joints;
    for (const JointRow& row : rows)
    {
        const auto above = std::ranges::find(rows, std::string_view(row.parent), &JointRow::name);
        const bool isHip = row.name == std::string_view("Hips");
        joints.push_back({row.name, above == rows.end() ? -1 : static_cast<int>(above - rows.begin()),
                          written(row.offset), written({0.0f, 6.0f, 0.0f}),
                          isHip || style.sixChannels || style.repeatsOffsets});
    }
    const auto key = [&](size_t joint, int frame) {
        const JointRow& row = rows[joint];
        const double seconds = frame / style.rate;
        const bool isHip = row.name == std::string_view("Hips");
        const Vec3 position = isHip ? HipAt(seconds) : style.repeatsOffsets ? row.offset : kVec3Zero;
        const double turn = row.turn * Wave(seconds / kStrideSeconds + row.onset);
        return TextKey{written(position), {static_cast<float>(turn), 0.0f, 0.0f}};
    };
    return MadeText(joints, style.frames, 1.0 / style.declaredRate, key);
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
    return PartOf(text, '\n', number - 1);
}

std::string WithLine(std::string_view text, size_t number, std::string_view line)
{
    return WithPart(text, '\n', number - 1, line);
}

double ValueOf(std::string_view text, int frame, size_t column)
{
    return std::stod(PartOf(LineOf(text, LineOfFrame(text, frame)), ' ', column));
}

std::string WithValues(std::string text, int frame, size_t column, const std::vector<const char*>& values)
{
    for (const char* value : values)
    {
        const size_t line = LineOfFrame(text, frame++);
        text = WithLine(text, line, WithPart(LineOf(text, line), ' ', column, value));
    }
    return text;
}

} // namespace gw
