// Builds the rest tree and the animated tree from the records of an HTR file. A row's rotation is composed
// axis by axis onto the base pose in an inner loop (RotatedBase), since a file has one per segment and frame.
// Each segment's rows are freed as soon as its keys exist.

#include "TKHTRStream.h"

#include "Angles.h"
#include "AxisRotation.h"
#include "CBoneMesh.h"
#include "CHTRReader.h"
#include "CKeyframeControl.h"
#include "Euler.h"
#include "MotionNode.h"
#include "TKHTRFile.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// Returns the axes of a rotation order (0 X, 1 Y, 2 Z) in the order of its letters, in which their rotations
// are multiplied from the left. Empty for an unknown order, which drops the rotation.
std::vector<size_t> AxesOf(std::string_view order)
{
    if (!std::ranges::is_permutation(order, std::string_view("XYZ")))
        return {};
    std::vector<size_t> axes;
    for (const char letter : order)
        axes.push_back(static_cast<size_t>(letter - 'X'));
    return axes;
}

// Returns EulerToMat3(order, degrees) · base, for the inner loop.
Mat3 RotatedBase(const std::vector<size_t>& axes, const Vec3& degrees, const Mat3& base)
{
    const float angles[] = {degrees.x, degrees.y, degrees.z};
    CAxisRotation m(base);
    for (const size_t axis : axes)
        m.RotateRows(axis, angles[axis] * kDegreesToRadians);
    return m.Matrix();
}

Mat4 BaseMatrix(const TKHTRFile& file, const TKHTRSegment& segment)
{
    return Mat4Compose(EulerToMat3(file.eulerOrder, segment.baseRotation), segment.baseTranslation);
}

void AppendKeys(CKeyframeControl& track, const TKHTRSegment& segment, const std::vector<size_t>& axes,
                const Mat3& base)
{
    const size_t count = segment.translations.size();
    track.m_kRotationKeys.reserve(count);
    track.m_kPositionKeys.reserve(count);
    track.m_kScaleKeys.reserve(count);
    for (size_t i = 0; i < count; ++i)
    {
        track.m_kRotationKeys.push_back(QuatFromMat3(RotatedBase(axes, segment.rotations[i], base)));
        track.m_kPositionKeys.push_back(segment.baseTranslation + segment.translations[i]);
        track.m_kScaleKeys.push_back(kVec3One * segment.scales[i]);
    }
}

} // namespace

bool TKHTRStream::Load(const std::string& path)
{
    m_kRecord.Clear();
    if (!ReadLines(path))
        return false;
    TKHTRFile file;
    if (!CHTRReader(lines, file, m_kRecord).Read())
        return false;
    fileVersion = file.fileVersion;
    return BuildRestTree(file) && BuildAnimatedTree(file);
}

bool TKHTRStream::BuildRestTree(const TKHTRFile& file)
{
    TKHTRSegment* const root = file.FirstRoot();
    if (!root)
        return false;
    restRoot = new CNode;
    BuildNodes(*root, *restRoot,
               [&](TKHTRSegment& segment, CNode& node) { FillRestNode(file, segment, node); });
    return true;
}

void TKHTRStream::FillRestNode(const TKHTRFile& file, const TKHTRSegment& segment, CNode& node)
{
    node.SetName(segment.name.c_str());
    node.m_kMatrix = BaseMatrix(file, segment);
    AddBoneShape(file, segment, node);
}

bool TKHTRStream::BuildAnimatedTree(const TKHTRFile& file)
{
    TKHTRSegment* const root = file.FirstRoot();
    if (!root)
        return false;
    motionRoot = new CNode;
    BuildNodes(*root, *motionRoot,
               [&](TKHTRSegment& segment, CNode& node) { FillAnimatedNode(file, segment, node); });
    return true;
}

void TKHTRStream::FillAnimatedNode(const TKHTRFile& file, TKHTRSegment& segment, CNode& node)
{
    node.SetName(segment.name.c_str());
    const float frequency = 1.0f / static_cast<float>(file.dataFrameRate);
    CKeyframeControl& track = AttachTrack(node, file.numFrames, frequency, BaseMatrix(file, segment));
    AppendKeys(track, segment, AxesOf(file.eulerOrder), EulerToMat3(file.eulerOrder, segment.baseRotation));
    // Rows are no longer needed, and their memory makes room for a large file's keys.
    segment.translations = {};
    segment.rotations = {};
    segment.scales = {};
    AddBoneShape(file, segment, node);
}

void TKHTRStream::AddBoneShape(const TKHTRFile& file, const TKHTRSegment& segment, CNode& node)
{
    const bool isAtRest = !node.GetControl();
    const EBoneMeshes meshes =
        isAtRest && boneMeshes == EBoneMeshes::DrawnInMotion ? EBoneMeshes::Empty : boneMeshes;
    CBoneMesh& mesh = AttachBone(node, segment.name, segment.children.size(), segment.boneLength, meshes);
    mesh.m_kMatrix = Mat4Compose(UpAxisMatrix(file.boneLengthAxis), kVec3Zero);
}

} // namespace gw
