// Reads BVH files into a tree. Two steps need explanation.
//
// Bone meshes point along +Y, but a BVH joint's child can be anywhere, so each mesh is rotated to the child
// by BoneTurn: first about Z, then about Y. The two angles are computed independently from the offset's
// projections, which is exact only if the offset lies in one of those planes. Other programs read these
// frames, so the formula stays as it is.
//
// A joint without channels takes no byte in a row but still gets a key time per frame. A short file could
// therefore claim billions of key times, and the product of frames and joints is limited by kKeyTimesLimit
// before anything is allocated.

#include "TKBVHStream.h"

#include "Angles.h"
#include "CBVHHierarchyReader.h"
#include "CBVHRowReader.h"
#include "CBoneMesh.h"
#include "CKeyframeControl.h"
#include "MotionNode.h"
#include "Numbers.h"
#include "TKBVHFile.h"
#include "Text.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// 256 MB of key times. The file holds a row for every frame, but a joint without channels takes no bytes in a
// row and still gets a time for each.
constexpr size_t kKeyTimesLimit = size_t{1} << 26;
constexpr float kNoLength = 9.9999997e-07f; // the float of 1e-06; a shorter offset has no direction

float SignedBy(float sign, double angle)
{
    return static_cast<float>(sign < 0.0f ? -angle : angle);
}

float LongestOffset(const TKBVHJoint& joint)
{
    double longest = 0.0;
    for (const auto& child : joint.children)
        longest = std::max(longest, Vec3Length(child->offset));
    return static_cast<float>(longest);
}

// Returns the first end site below a joint, or zero.
Vec3 EndOf(const TKBVHJoint& joint)
{
    const auto end =
        std::ranges::find_if(joint.children, [](const auto& child) { return !child->MakesNode(); });
    return end == joint.children.end() ? kVec3Zero : (*end)->offset;
}

} // namespace

Mat3 BoneTurn(const Vec3& offset)
{
    float aboutZ = 0.0f;
    float aboutY = 0.0f;
    if (Vec3Length(offset) >= kNoLength)
    {
        const Vec3 p = Vec3Normalized({offset.x, offset.y, 0.0f});
        const Vec3 q = Vec3Normalized({offset.x, 0.0f, offset.z});
        if (p != kVec3Zero)
            aboutZ = SignedBy(p.y, SafeAcos(p.x));
        if (q != kVec3Zero)
            aboutY = SignedBy(q.z, kHalfPi64 - SafeAcos(std::fabs(q.z)));
    }
    const Mat3 b = Mat3FromAxisAngle(kVec3UnitZ, aboutZ) * Mat3FromAxisAngle(kVec3UnitY, -aboutY);
    return Mat3FromAxisAngle(kVec3UnitZ, -kHalfPi) * b;
}

bool TKBVHStream::Load(const std::string& path)
{
    m_kRecord.Clear();
    if (!ReadLines(path))
        return false;
    TKBVHFile file;
    for (std::string_view rest; lines.Next(rest);)
    {
        const std::string_view keyword = NextToken(rest);
        if (keyword == "HIERARCHY" && !CBVHHierarchyReader(lines, file, m_kRecord).Read())
            return false;
        if (keyword == "MOTION" && !ReadMotion(file))
            return false;
    }
    return BuildAnimatedTree(file);
}

bool TKBVHStream::ReadMotion(TKBVHFile& file)
{
    TKBVHJoint* const root = file.FirstRoot();
    if (!root)
        return m_kRecord.Fail(EFailure::NoRoot, lines.LineNumber(), "ROOT");
    std::string_view number;
    if (!ReadNumber("Frames:", number))
        return false;
    file.frameCount = ParseInt(number);
    const size_t countLine = lines.LineNumber();
    if (!ReadFrameTime(file))
        return false;
    const auto frameCount = static_cast<size_t>(std::max(file.frameCount, 0));
    file.rowsAsked += std::max(file.frameCount, 1); // planning takes as long as a row
    CBVHRowReader rows(*root, m_kRecord);
    if (!rows.RowsFit(frameCount, lines.BytesLeft()))
        return m_kRecord.Fail(EFailure::TooFewRows, countLine, "Frames:");
    if (!KeyTimesFit(file.rowsAsked, file.nodeCount, lines.ByteCount(), kKeyTimesLimit))
        return m_kRecord.Fail(EFailure::TooLarge, countLine, "Frames:");
    if (!rows.ReadRows(lines, frameCount))
        return m_kRecord.Fail(EFailure::TooFewRows, countLine, "Frames:");
    return true;
}

// Reads the next line, which must start with these words and must not be preceded by a blank line.
bool TKBVHStream::ReadKeyword(std::string_view words, std::string_view& rest)
{
    const std::string name(words);
    if (!lines.Next(rest))
        return m_kRecord.Fail(EFailure::MissingSection, lines.LineNumber(), name);
    std::string_view copy = rest;
    if (NextToken(copy).empty())
        return m_kRecord.Fail(EFailure::BlankLine, lines.LineNumber(), name);
    for (std::string_view word = NextToken(words); !word.empty(); word = NextToken(words))
    {
        if (NextToken(rest) != word)
            return m_kRecord.Fail(EFailure::UnexpectedLine, lines.LineNumber(), name);
    }
    return true;
}

// Reads the finite number after these words on the next line.
bool TKBVHStream::ReadNumber(std::string_view words, std::string_view& number)
{
    std::string_view rest;
    if (!ReadKeyword(words, rest))
        return false;
    number = NextToken(rest);
    if (number.empty())
        return m_kRecord.Fail(EFailure::MissingTokens, lines.LineNumber(), std::string(words));
    const std::string quote = Quote(number);
    ENumber kind;
    ParseDouble(number, kind);
    if (kind == ENumber::None || kind == ENumber::Unusual)
        return m_kRecord.Fail(EFailure::BadNumber, lines.LineNumber(), quote);
    if (kind == ENumber::Stuck)
        m_kRecord.Warn(EFailure::StuckNumber, lines.LineNumber(), quote);
    return true;
}

bool TKBVHStream::ReadFrameTime(TKBVHFile& file)
{
    std::string_view number;
    if (!ReadNumber("Frame Time:", number))
        return false;
    file.frameTime = static_cast<float>(ParseDouble(number));
    if (file.frameTime > 0.0f && std::isfinite(file.frameTime))
        return true;
    return m_kRecord.Fail(EFailure::BadNumber, lines.LineNumber(), Quote(number));
}

bool TKBVHStream::BuildAnimatedTree(const TKBVHFile& file)
{
    TKBVHJoint* const root = file.FirstRoot();
    if (!root)
        return m_kRecord.Fail(EFailure::MissingSection, lines.LineNumber(), "HIERARCHY");
    motionRoot = new CNode;
    BuildNodes(*root, *motionRoot, [&](TKBVHJoint& joint, CNode& node) { FillNode(file, joint, node); });
    return true;
}

void TKBVHStream::FillNode(const TKBVHFile& file, TKBVHJoint& joint, CNode& node)
{
    node.SetName(joint.name.c_str());
    CKeyframeControl& track =
        AttachTrack(node, file.frameCount, file.frameTime, Mat4Compose(kMat3Identity, joint.offset));
    track.m_kRotationKeys = std::move(joint.rotationKeys);
    track.m_kPositionKeys = std::move(joint.positionKeys);
    track.m_kScaleKeys.assign(track.m_kRotationKeys.size(), kVec3One);
    AddBoneShape(file, joint, node);
}

void TKBVHStream::AddBoneShape(const TKBVHFile&, const TKBVHJoint& joint, CNode& node)
{
    if (joint.children.empty())
        return;
    CBoneMesh& mesh = AttachBone(node, joint.name, joint.children.size(), LongestOffset(joint), boneMeshes);
    mesh.m_kEnd = EndOf(joint);
    if (joint.children.size() == 1)
        mesh.m_kMatrix = Mat4Compose(BoneTurn(joint.children[0]->offset), kVec3Zero);
}

} // namespace gw
