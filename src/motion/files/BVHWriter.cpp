// The writing half of TKBVHStream. It has two modes. The default one reproduces files as they have always
// been written, with their losses: the last frame is missing and bone ends follow the mesh. The exact one is
// for readers that need the motion itself.

#include "BoneMeshQueries.h"
#include "CGeometry.h"
#include "CKeyframeControl.h"
#include "CLineWriter.h"
#include "CMotionSampler.h"
#include "Euler.h"
#include "TKBVHFile.h"
#include "TKBVHStream.h"

#include <algorithm>
#include <cmath>
#include <iterator>

namespace gw {

/// The differences between the two modes of writing.
struct BVHWriteRules
{
    int frameCount;
    bool exact;
};

namespace {

constexpr float kFrameLimit = 1 << 24; // larger frame numbers are not exact floats
constexpr std::string_view kIndent = "    ";
constexpr std::string_view kKindNames[] = {"Global", "ROOT", "JOINT", "End"};

/// A node and its block in the hierarchy.
struct Bone
{
    const CNode* node;
    const TKBVHJoint* joint;
};

// Returns the end of the bone mesh's X axis, relative to the node.
Vec3 EndOffset(CNode& node)
{
    const CObject* found = node.FindObject(node.GetName(), &CGeometry::ms_kRTTI, true);
    const Mat4& world = found ? static_cast<const CGeometry*>(found)->m_kWorldMatrix : node.m_kWorldMatrix;
    return TransformCoord(kVec3UnitX, world) - node.m_kWorldMatrix.Translation();
}

// Returns whether a joint's positions differ from its offset in any frame.
bool MovesAgainstParent(const CNode& node)
{
    const CKeyframeControl* track = RecordCast<CKeyframeControl>(node.GetControl());
    const Vec3 rest = track ? track->m_kRestMatrix.Translation() : kVec3Zero;
    return track && std::ranges::any_of(track->m_kPositionKeys.Distinct(),
                                        [&](const Vec3& key) { return key != rest; });
}

// Collects bones from a tree in rest pose, in row order.
void CollectBones(CNode& node, TKBVHJoint& joint, const Vec3& parentPosition, bool exact,
                  std::vector<Bone>& bones)
{
    const Vec3 position = node.m_kWorldMatrix.Translation();
    joint.name = node.NameView();
    joint.offset =
        exact && joint.kind == EJointKind::Joint ? node.m_kMatrix.Translation() : position - parentPosition;
    joint.channels = {5, 4, 3};
    if (joint.kind == EJointKind::Root || (exact && MovesAgainstParent(node)))
        joint.channels.insert(joint.channels.begin(), {0, 1, 2});
    bones.push_back({&node, &joint});
    if (node.HasNoNodeChild())
    {
        TKBVHJoint& end = joint.AddChild(EJointKind::EndSite);
        end.name = "Site";
        end.offset = exact ? NodeBoneEnd(node) : EndOffset(node);
    }
    for (size_t i = 0; i < node.GetChildCount(); ++i)
    {
        if (CNode* child = RecordCast<CNode>(node.ChildAt(i)))
            CollectBones(*child, joint.AddChild(EJointKind::Joint), position, exact, bones);
    }
}

void WriteChannels(CLineWriter& out, const TKBVHJoint& joint)
{
    out.Text("CHANNELS ").Int(static_cast<int32_t>(joint.channels.size()));
    for (const int channel : joint.channels)
        out.Text(" ").Text(kChannelNames[channel]);
    out.EndLine();
}

void WriteJoint(CLineWriter& out, const TKBVHJoint& joint, std::string& indent)
{
    out.Text(indent).Text(kKindNames[static_cast<int>(joint.kind)]).Text(" ").Text(joint.name).EndLine();
    out.Text(indent).Line("{");
    indent += kIndent;
    out.Text(indent).Text("OFFSET ").Number(joint.offset.x).Text(" ");
    out.Number(joint.offset.y).Text(" ").Number(joint.offset.z).EndLine();
    if (!joint.channels.empty())
        WriteChannels(out.Text(indent), joint);
    for (const auto& child : joint.children)
        WriteJoint(out, *child, indent);
    indent.resize(indent.size() - kIndent.size());
    out.Text(indent).Line("}");
}

void WriteRow(CLineWriter& out, const std::vector<Bone>& bones, bool exact)
{
    for (const auto& [node, joint] : bones)
    {
        const Vec3 position = node->m_kMatrix.Translation() - joint->offset;
        const Mat3 rotation = NormalizedRows(node->m_kMatrix);
        const Vec3 degrees = exact ? EulerDegreesZYX(rotation) : Mat3ToEulerDegrees(rotation);
        const float values[] = {position.x, position.y, position.z, degrees.x, degrees.y, degrees.z};
        for (const int channel : joint->channels)
            out.Number(values[channel]).Text(" ");
    }
    out.EndLine();
}

} // namespace

bool TKBVHStream::WriteFile(const std::string& path)
{
    m_kRecord.Clear();
    if (!motionRoot)
        return m_kRecord.Fail(EFailure::NoRoot);
    const float lastFrame = GetLastFrame();
    if (!(std::fabs(lastFrame) <= kFrameLimit))
        return m_kRecord.Fail(EFailure::TooLarge);
    return WriteWith(path, {static_cast<int>(lastFrame), false});
}

bool TKBVHStream::WriteExact(const std::string& path)
{
    m_kRecord.Clear();
    return motionRoot ? WriteWith(path, {GetKeyCount(), true}) : m_kRecord.Fail(EFailure::NoRoot);
}

bool TKBVHStream::WriteWith(const std::string& path, const BVHWriteRules& rules)
{
    const float frequency = GetFrequency();

    SwitchControls(*motionRoot, false);
    motionRoot->UpdateScene(0.0f, true);
    TKBVHJoint root;
    root.kind = EJointKind::Root;
    std::vector<Bone> bones;
    CollectBones(*motionRoot, root, kVec3Zero, rules.exact, bones);
    SwitchControls(*motionRoot, true);

    CMotionSampler sampler(*motionRoot);
    const bool written = WriteLines(path, [&](CLineWriter& out) {
        std::string indent;
        out.Line("HIERARCHY");
        WriteJoint(out, root, indent);
        out.Line("MOTION");
        out.Text("Frames: ").Int(rules.frameCount).EndLine();
        out.Text("Frame Time: ");
        (rules.exact ? out.Shortest(frequency) : out.Number(frequency)).EndLine();
        for (int frame = 0; frame < rules.frameCount; ++frame)
        {
            sampler.PoseTree(TimeOfFrame(frame, frequency));
            WriteRow(out, bones, rules.exact);
        }
        return true;
    });
    motionRoot->UpdateScene(0.0f, true);
    return written;
}

} // namespace gw
