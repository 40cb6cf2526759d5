// Motions: reading, facts, poses, and writing as they are.

#include "MotionContent.h"

#include "CKeyframeControl.h"
#include "CMendedSource.h"
#include "CPoseSampler.h"
#include "CPrivateFile.h"
#include "CSourceFile.h"
#include "Failures.h"
#include "FindingWords.h"
#include "Paths.h"
#include "Skeleton.h"
#include "SystemError.h"
#include "Text.h"
#include "TranscodeFile.h"
#include "Writing.h"

#include <algorithm>
#include <cmath>
#include <unordered_map>

namespace gaitwright {

namespace {

constexpr size_t kMatrixSize = 16;
constexpr size_t kPositionSize = 3;

// A container can claim any end without holding a key for it.
constexpr size_t kAnyFrameCount = size_t{1} << 20;

// Restores a tree's pose, because conversions start from it.
class CPoseKeeper
{
public:
    explicit CPoseKeeper(const std::vector<gw::CNode*>& nodes) : m_kNodes(nodes)
    {
        m_kMatrices.reserve(nodes.size());
        for (const gw::CNode* node : nodes)
            m_kMatrices.emplace_back(node->m_kMatrix, node->m_kWorldMatrix);
    }
    CPoseKeeper(const CPoseKeeper&) = delete;
    CPoseKeeper& operator=(const CPoseKeeper&) = delete;
    ~CPoseKeeper()
    {
        for (size_t i = 0; i < m_kNodes.size(); ++i)
            std::tie(m_kNodes[i]->m_kMatrix, m_kNodes[i]->m_kWorldMatrix) = m_kMatrices[i];
    }

private:
    const std::vector<gw::CNode*>& m_kNodes;
    std::vector<std::pair<gw::Mat4, gw::Mat4>> m_kMatrices;
};

void Append(std::vector<float>& numbers, const gw::Mat4& matrix)
{
    numbers.insert(numbers.end(), std::begin(matrix.m), std::end(matrix.m));
}

std::vector<float> RestOf(const std::vector<gw::CNode*>& nodes)
{
    std::vector<float> rest;
    rest.reserve(nodes.size() * kMatrixSize);
    for (const gw::CNode* node : nodes)
        Append(rest, gw::RestWorld(*node));
    return rest;
}

std::vector<float> PosesOf(const Access::MotionContent& motion)
{
    const float frequency = gw::IsFrameTime(motion.frequency) ? motion.frequency : 1.0f;
    const CPoseKeeper keeper(motion.nodes);
    std::vector<float> poses;
    poses.reserve(motion.frameCount * motion.nodes.size() * kMatrixSize);
    for (size_t frame = 0; frame < motion.frameCount; ++frame)
    {
        const float time = static_cast<float>(frame) / frequency;
        for (gw::CNode* node : motion.nodes)
        {
            node->CSpatial::UpdateTransform(time);
            Append(poses, node->m_kWorldMatrix);
        }
    }
    return poses;
}

std::vector<float> PositionsOf(std::span<const float> poses)
{
    std::vector<float> positions;
    positions.reserve(poses.size() / kMatrixSize * kPositionSize);
    for (; !poses.empty(); poses = poses.subspan(kMatrixSize))
    {
        const auto row = poses.subspan(kMatrixSize - 4, kPositionSize);
        positions.insert(positions.end(), row.begin(), row.end());
    }
    return positions;
}

void FillPoses(Access::MotionContent& motion)
{
    if (motion.poses.empty() && motion.frameCount > 0)
        motion.poses = PosesOf(motion);
}

gw::Notice MendedNotice(const std::string& path, const gw::CMendedSource& mended)
{
    return gw::MakeNotice(path, "mended", "repaired: " + mended.Words(), gw::ESeverity::Warning);
}

// Replaces the name of a temporary file, which its user does not know.
void Rename(std::string& text, const std::string& from, const std::string& to)
{
    if (text == from)
        text = to;
}

Outcome<Motion> LoadFile(const std::string& file, const std::string& path, const LoadOptions& options)
{
    if (!(options.rate >= 0.0f) || !std::isfinite(options.rate))
        return FailureOf("bad-number", "the rate must be a positive number, or 0 for that of the file");
    gw::CSourceFile source;
    if (!source.Open(file, gw::EPackage::Unpacked))
    {
        Failure failure = FailureOf(source.Failure());
        Rename(failure.path, file, path);
        return failure;
    }
    gw::CMendedSource mended;
    if (options.mend && !mended.Mend(source.Path()))
        return FailureOf("no-mended-copy",
                         "a repaired copy cannot be written to the folder for temporary files" +
                             gw::TakeSystemErrorWords());
    const std::string& read = mended.IsMended() ? mended.Path() : source.Path();
    auto content = std::make_shared<Access::MotionContent>();
    content->path = path;
    content->format = gw::LowerCase(gw::SplitPath(read).extension);
    content->format.erase(0, 1); // the dot, if there is one
    content->source = std::make_shared<gw::CSourceMotion>();
    content->source->Select(options.clip, options.rate);
    content->source->SkipPictures();
    const bool isLoaded = content->source->Load(read);
    const gw::CFailureRecord& record = content->source->Record();
    if (!isLoaded)
        return FailureOf(path, record);
    for (const gw::Finding& warning : record.Warnings())
        content->warnings.push_back(FailureOf(gw::MakeNotice(path, warning)));
    if (mended.IsMended())
        content->warnings.push_back(FailureOf(MendedNotice(path, mended)));
    const Outcome<void> described = content->Describe();
    if (!described)
        return described.Error();
    return Access::Make(std::move(content));
}

bool IsOfHTR(const Access::MotionContent& motion)
{
    return !motion.source->IsScene() && motion.source->Motion().restRoot;
}

Outcome<void> WriteMotion(Access::MotionContent& motion, const std::string& path, const SaveOptions& options)
{
    const bool isHTR = gw::HasExtension(path, ".htr");
    if (!gw::HasExtension(path, ".bvh") && !gw::HasExtension(path, ".glb") && !(isHTR && IsOfHTR(motion)))
        return FailureOf("unknown-format", "a motion can be written as .bvh or .glb, and as .htr if it was "
                                           "read from such a file or converted");
    if (motion.source->IsScene())
        return FailureOf("unknown-format", "a container can only be converted");
    if (!(options.frameScale > 0.0f) || !std::isfinite(options.frameScale) ||
        (options.frameScale != 1.0f && !isHTR))
        return FailureOf("bad-number", "the frame scale must be a positive number, and 1 except for .htr");
    const std::lock_guard lock(motion.mutex);
    gw::CMotionFile file(motion.source->Motion());
    const char* const refusal = gw::HasExtension(path, ".bvh") ? gw::WhyNoBVH(file) : nullptr;
    if (refusal)
        return FailureOf("no-bvh", refusal);
    gw::CFailureRecord record;
    if (!gw::WriteTranscoded(file, path, options.frameScale, record))
        return FailureOf(path, record);
    return {};
}

} // namespace

Outcome<void> Motion::Content::Describe()
{
    gw::CNode& root = *source->Root();
    nodes = gw::NodesOf(root);
    std::unordered_map<const gw::CNode*, int32_t> numbers;
    const gw::CKeyframeControl* const track = gw::ConversionTrack(&root);
    for (const gw::CNode* node : nodes)
    {
        const auto parent = numbers.find(node->GetParentNode());
        parents.push_back(parent == numbers.end() ? -1 : parent->second);
        numbers.emplace(node, static_cast<int32_t>(numbers.size()));
        names.emplace_back(node->NameView());
    }
    const size_t keys = track ? std::max(track->m_kKeyTimes.size(), track->m_kRotationTimes.size()) : 0;
    const double frames = track ? std::floor(static_cast<double>(track->m_fEndTime)) + 1.0 : 0.0;
    if (!(frames <= static_cast<double>(std::max(keys, kAnyFrameCount))))
        return FailureOf(gw::MakeNotice(path, {gw::EFailure::TooLarge}));
    frameCount = static_cast<size_t>(std::max(frames, 0.0));
    frequency = track ? track->m_fFrequency : 0.0f;
    frameSeconds = gw::IsFrameTime(frequency) ? static_cast<double>(frequency) : 0.0;
    if (source->IsScene())
        return {};
    clips = source->Motion().imported.clips;
    clip = source->Motion().imported.clip;
    unitMeters = source->Motion().imported.unitMeters;
    return {};
}

Outcome<Motion> Load(const std::string& path, const LoadOptions& options) noexcept
{
    return Guarded([&] { return LoadFile(path, path, options); });
}

Outcome<Motion> LoadBytes(std::span<const std::byte> bytes, std::string_view format,
                          const LoadOptions& options) noexcept
{
    return Guarded([&]() -> Outcome<Motion> {
        gw::CPrivateFile file; // readers map files
        if (!file.CreateTemporary(ExtensionOf(format)) ||
            !file.Write({reinterpret_cast<const char*>(bytes.data()), bytes.size()}))
            return FailureOf("no-temporary-file", "a temporary file cannot be written" +
                                                      gw::TakeSystemErrorWords() +
                                                      " (TMPDIR can name another folder)");
        return LoadFile(file.Path(), {}, options);
    });
}

Motion::Motion(std::shared_ptr<Content> content) noexcept : m_spContent(std::move(content)) {}
Motion::Motion(const Motion& other) noexcept = default;
Motion& Motion::operator=(const Motion& other) noexcept = default;
Motion::~Motion() = default;

const std::string& Motion::Path() const noexcept
{
    return m_spContent->path;
}

const std::string& Motion::Format() const noexcept
{
    return m_spContent->format;
}

std::span<const Failure> Motion::Warnings() const noexcept
{
    return m_spContent->warnings;
}

std::span<const std::string> Motion::Clips() const noexcept
{
    return m_spContent->clips;
}

const std::string& Motion::Clip() const noexcept
{
    return m_spContent->clip;
}

size_t Motion::FrameCount() const noexcept
{
    return m_spContent->frameCount;
}

double Motion::FrameSeconds() const noexcept
{
    return m_spContent->frameSeconds;
}

double Motion::UnitMeters() const noexcept
{
    return m_spContent->unitMeters;
}

size_t Motion::BoneCount() const noexcept
{
    return m_spContent->nodes.size();
}

std::span<const std::string> Motion::BoneNames() const noexcept
{
    return m_spContent->names;
}

std::span<const int32_t> Motion::Parents() const noexcept
{
    return m_spContent->parents;
}

Outcome<std::span<const float>> Motion::RestPose() const noexcept
{
    return Guarded([&]() -> Outcome<std::span<const float>> {
        const std::lock_guard lock(m_spContent->mutex);
        if (m_spContent->rest.empty())
            m_spContent->rest = RestOf(m_spContent->nodes);
        return std::span<const float>(m_spContent->rest);
    });
}

Outcome<std::span<const float>> Motion::Poses() const noexcept
{
    return Guarded([&]() -> Outcome<std::span<const float>> {
        const std::lock_guard lock(m_spContent->mutex);
        FillPoses(*m_spContent);
        return std::span<const float>(m_spContent->poses);
    });
}

Outcome<std::span<const float>> Motion::Positions() const noexcept
{
    return Guarded([&]() -> Outcome<std::span<const float>> {
        const std::lock_guard lock(m_spContent->mutex);
        FillPoses(*m_spContent);
        if (m_spContent->positions.empty())
            m_spContent->positions = PositionsOf(m_spContent->poses);
        return std::span<const float>(m_spContent->positions);
    });
}

Outcome<void> Motion::Save(const std::string& path, const SaveOptions& options) const noexcept
{
    return Guarded([&] {
        return WriteFile(path, options.existing,
                         [&](const std::string& to) { return WriteMotion(*m_spContent, to, options); });
    });
}

Outcome<std::vector<std::byte>> Motion::Bytes(std::string_view format,
                                              const SaveOptions& options) const noexcept
{
    return Guarded([&] {
        return BytesOf(ExtensionOf(format),
                       [&](const std::string& to) { return WriteMotion(*m_spContent, to, options); });
    });
}

} // namespace gaitwright
