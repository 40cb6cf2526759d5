#include "MadeText.h"

#include <cstdio>

namespace gw {
namespace {

std::string Number(double number)
{
    char text[60];
    std::snprintf(text, sizeof(text), "%.6f", number);
    return text;
}

std::string Numbers(const Vec3& v)
{
    return Number(v.x) + ' ' + Number(v.y) + ' ' + Number(v.z);
}

// Returns a block without its last brace.
std::string Block(const std::string& indent, const std::string& head, const Vec3& offset)
{
    return indent + head + '\n' + indent + "{\n" + indent + "\tOFFSET " + Numbers(offset) + '\n';
}

} // namespace

std::string MadeText(const std::vector<TextJoint>& joints, int frameCount, double frameSeconds,
                     const std::function<TextKey(size_t joint, int frame)>& key)
{
    std::string text = "HIERARCHY\n";
    std::vector<int> open; // the last joint and those above it
    for (size_t i = 0; i < joints.size(); ++i)
    {
        const auto& [name, parent, offset, tip, hasPositions] = joints[i];
        text += Block(std::string(open.size(), '\t'), (i == 0 ? "ROOT " : "JOINT ") + name, offset);
        open.push_back(static_cast<int>(i));
        const std::string indent(open.size(), '\t');
        text += indent + (i == 0 || hasPositions ? "CHANNELS 6 Xposition Yposition Zposition" : "CHANNELS 3");
        text += " Zrotation Xrotation Yrotation\n";
        const int next = i + 1 < joints.size() ? joints[i + 1].parent : -1;
        if (next != open.back())
            text += Block(indent, "End Site", tip) + indent + "}\n";
        for (; !open.empty() && open.back() != next; open.pop_back())
            text += std::string(open.size() - 1, '\t') + "}\n";
    }
    text += "MOTION\nFrames: " + std::to_string(frameCount) + "\nFrame Time: " + Number(frameSeconds) + '\n';
    for (int frame = 0; frame < frameCount; ++frame)
    {
        for (size_t i = 0; i < joints.size(); ++i)
        {
            const auto [position, degrees] = key(i, frame);
            text += i == 0                   ? Numbers(position) + ' '
                    : joints[i].hasPositions ? ' ' + Numbers(position) + ' '
                                             : " ";
            text += Numbers({degrees.z, degrees.x, degrees.y});
        }
        text += '\n';
    }
    return text;
}

} // namespace gw
