#include "CMadeText.h"

#include <cstdio>

namespace gw {

void CMadeText::Line(size_t depth, const std::string& words)
{
    m_kText += std::string(depth, '\t') + words + '\n';
}

std::string CMadeText::Number(double number) const
{
    char text[40];
    std::snprintf(text, sizeof(text), m_bScientific ? "%.7e" : "%.6f", number);
    return text;
}

std::string CMadeText::Numbers(const Vec3& v) const
{
    return Number(v.x) + ' ' + Number(v.y) + ' ' + Number(v.z);
}

void CMadeText::AddJoint(size_t joint, size_t depth)
{
    TextJoint& self = m_kJoints[joint];
    const bool isRoot = self.parent < 0;
    self.hasPositions = self.hasPositions || isRoot;
    m_kOrder.push_back(joint);
    Line(depth, (isRoot ? "ROOT " : "JOINT ") + self.name);
    Line(depth, "{");
    Line(depth + 1, "OFFSET " + Numbers(self.offset));
    Line(depth + 1, self.hasPositions
                        ? "CHANNELS 6 Xposition Yposition Zposition Zrotation Xrotation Yrotation"
                        : "CHANNELS 3 Zrotation Xrotation Yrotation");
    const size_t before = m_kOrder.size();
    for (size_t child = joint + 1; child < m_kJoints.size(); ++child)
    {
        if (m_kJoints[child].parent == static_cast<int>(joint))
            AddJoint(child, depth + 1);
    }
    if (m_kOrder.size() == before)
    {
        Line(depth + 1, "End Site");
        Line(depth + 1, "{");
        Line(depth + 2, "OFFSET " + Numbers(self.tip));
        Line(depth + 1, "}");
    }
    Line(depth, "}");
}

std::string CMadeText::Write(int frameCount, double frameSeconds,
                             const std::function<TextKey(size_t joint, int frame)>& key)
{
    Line(0, "HIERARCHY");
    AddJoint(0, 0);
    Line(0, "MOTION");
    Line(0, "Frames: " + std::to_string(frameCount));
    Line(0, "Frame Time: " + Number(frameSeconds));
    for (int frame = 0; frame < frameCount; ++frame)
    {
        std::string row;
        for (const size_t joint : m_kOrder)
        {
            const auto [position, degrees] = key(joint, frame);
            row += row.empty() ? "" : " ";
            if (m_kJoints[joint].hasPositions)
                row += Numbers(position) + ' ';
            row += Numbers({degrees.z, degrees.x, degrees.y});
        }
        Line(0, row);
    }
    return m_kText;
}

} // namespace gw
