#include "TKImportStream.h"

#include "CBoneMesh.h"
#include "CKeyframeControl.h"
#include "ChildOutput.h"
#include "ImportedMotion.h"
#include "MotionNode.h"
#include "Paths.h"
#include "TKBVHStream.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace gw {

namespace {

constexpr const char* kProgram = "gaitwright-import";
// The program limits its own memory and computing time; these limits are for one that hangs or floods.
constexpr ChildLimits kLimits{.seconds = 600.0, .outputBytes = size_t{1} << 30};

// A path that begins with a hyphen is not an option.
std::string PathArgument(const std::string& path)
{
    return path.starts_with('-') ? "./" + path : path;
}

struct Outcome
{
    EImport outcome;
    EFailure failure;
};
constexpr Outcome kOutcomes[] = {
    {EImport::Done,       EFailure::None       },
    {EImport::Refused,    EFailure::NotImported},
    {EImport::NoSkeleton, EFailure::NoSkeleton },
    {EImport::NoClip,     EFailure::NoClip     },
    {EImport::TooLarge,   EFailure::TooLarge   },
};

EFailure FailureOf(EChildEnd end)
{
    switch (end)
    {
    case EChildEnd::Finished:
        return EFailure::None;
    case EChildEnd::Missing:
        return EFailure::NoImporter;
    case EChildEnd::TooMuch:
        return EFailure::TooLarge;
    case EChildEnd::Died:
    case EChildEnd::TimedOut:
        break;
    }
    return EFailure::ImportStopped;
}

// The tree's shape, which the message contains only as parents.
std::vector<std::vector<size_t>> ChildrenOf(const std::vector<ImportedJoint>& joints)
{
    std::vector<std::vector<size_t>> children(joints.size());
    for (size_t i = 1; i < joints.size(); ++i)
        children[static_cast<size_t>(joints[i].parent)].push_back(i);
    return children;
}

void AddBoneShape(const std::vector<ImportedJoint>& joints, const std::vector<size_t>& children,
                  const std::string& name, EBoneMeshes meshes, CNode& node)
{
    if (children.empty())
        return;
    double longest = 0.0;
    for (const size_t child : children)
        longest = std::max(longest, Vec3Length(joints[child].offset));
    CBoneMesh& mesh = AttachBone(node, name, children.size(), static_cast<float>(longest), meshes);
    if (children.size() == 1)
        mesh.m_kMatrix = Mat4Compose(BoneTurn(joints[children[0]].offset), kVec3Zero);
}

bool IsFinite(const Vec3& v)
{
    return std::isfinite(v.x) && std::isfinite(v.y) && std::isfinite(v.z);
}

bool HasFiniteKeys(const ImportedJoint& joint)
{
    const auto isFinite = [](const Quat& q) {
        return std::isfinite(q.w) && std::isfinite(q.x) && std::isfinite(q.y) && std::isfinite(q.z);
    };
    return IsFinite(joint.offset) && std::ranges::all_of(joint.positions, IsFinite) &&
           std::ranges::all_of(joint.rotations, isFinite);
}

} // namespace

bool IsImported(std::string_view path)
{
    return std::ranges::any_of(kImportedExtensions,
                               [&](std::string_view extension) { return HasExtension(path, extension); });
}

bool TKImportStream::Load(const std::string& path)
{
    m_kRecord.Clear();
    uint64_t size = 0;
    if (!FileSize(path, size))
        return m_kRecord.Fail(FolderExists(path) ? EFailure::NotRegular : EFailure::NotFound);
    std::vector<std::byte> message;
    return Run(path, message) && Receive(message);
}

bool TKImportStream::Receive(std::span<const std::byte> message)
{
    ImportedMotion motion;
    if (!ReadImported(message, motion))
        return m_kRecord.Fail(EFailure::ImportStopped);
    if (!Check(motion))
        return false;
    imported = {motion.clip, motion.clips, motion.isRateOfFile, motion.unitMeters, motion.wasTurnedUp};
    BuildAnimatedTree(motion);
    return true;
}

bool TKImportStream::Run(const std::string& path, std::vector<std::byte>& message)
{
    std::vector<std::string> arguments;
    if (!importChoice.clip.empty())
        arguments.push_back("--clip=" + importChoice.clip);
    if (importChoice.rate > 0.0)
        arguments.push_back("--rate=" + std::to_string(importChoice.rate));
    arguments.push_back(PathArgument(path));
    const EChildEnd end =
        RunChild(ExecutableFolder() + kProgram, arguments, kLimits, message, [this] { Report(0, 0); });
    return end == EChildEnd::Finished || m_kRecord.Fail(FailureOf(end));
}

bool TKImportStream::Check(const ImportedMotion& motion)
{
    const auto row = std::ranges::find(kOutcomes, motion.outcome, &Outcome::outcome);
    if (row == std::end(kOutcomes))
        return m_kRecord.Fail(EFailure::ImportStopped);
    if (row->failure != EFailure::None)
        return m_kRecord.Fail(row->failure, 0, motion.words);
    if (motion.joints.empty() || motion.frameCount == 0)
        return m_kRecord.Fail(EFailure::NoSkeleton);
    if (motion.joints.size() > kBoneLimit)
        return m_kRecord.Fail(EFailure::TooLarge, 0, motion.joints[kBoneLimit].name);
    const auto frameTime = static_cast<float>(1.0 / motion.rate);
    if (!(frameTime > 0.0f) || !std::isfinite(frameTime) || !std::isfinite(motion.unitMeters))
        return m_kRecord.Fail(EFailure::BadNumber);
    for (const ImportedJoint& joint : motion.joints)
    {
        if (!MayBeName(joint.name))
            return m_kRecord.Fail(EFailure::BadName, 0, joint.name);
        if (!HasFiniteKeys(joint))
            return m_kRecord.Fail(EFailure::NotImported, 0,
                                  "the joint " + joint.name + " has a position that is not a number");
    }
    return true;
}

void TKImportStream::BuildAnimatedTree(ImportedMotion& motion)
{
    const std::vector<std::vector<size_t>> children = ChildrenOf(motion.joints);
    std::vector<CNode*> nodes;
    for (size_t i = 0; i < motion.joints.size(); ++i)
    {
        ImportedJoint& joint = motion.joints[i];
        if (i == 0)
            motionRoot = new CNode;
        nodes.push_back(i == 0 ? motionRoot.Get() : &AttachNode(*nodes[static_cast<size_t>(joint.parent)]));
        CNode& node = *nodes.back();
        node.SetName(joint.name.c_str());
        CKeyframeControl& track =
            AttachTrack(node, static_cast<int>(motion.frameCount), static_cast<float>(1.0 / motion.rate),
                        Mat4Compose(kMat3Identity, joint.offset));
        track.m_kRotationKeys = std::move(joint.rotations);
        track.m_kPositionKeys = std::move(joint.positions);
        track.m_kScaleKeys.assign(motion.frameCount, kVec3One);
        AddBoneShape(motion.joints, children[i], joint.name, boneMeshes, node);
    }
}

} // namespace gw
