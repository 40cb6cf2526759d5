// The format does not store its length: keywords, numbers and names follow each other as the header promises.
// So every field is read with its expected length, and the first one that is missing or wrong ends reading
// with an exception.

#include "TKCHBStream.h"

#include "CBoneMesh.h"
#include "CHTrack.h"
#include "CKeyframeControl.h"
#include "ERROBJ.h"
#include "MotionNode.h"
#include "Text.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstring>
#include <iterator>

namespace gw {

namespace {

constexpr int kErrorCode = 2;
constexpr int kNewestVersion = 721;
constexpr float kFrequency = 0.06f;
constexpr size_t kNameBytes = 256;
constexpr std::string_view kFrameKeyword = "Frame";
constexpr int kReportFrames = 64; // between two reports of progress
constexpr size_t kPoseBytes = sizeof(Mat3) + sizeof(Vec3);

} // namespace

bool TKCHBStream::Load(const std::string& path)
{
    m_kRecord.Clear();
    m_uiPosition = 0;
    m_iLine = 0;
    const EFailure failure = path.empty() ? EFailure::NotFound : m_kFile.Open(path);
    if (failure != EFailure::None)
        return m_kRecord.Fail(failure);
    TKCHFile file;
    return ReadFile(file) && BuildAnimatedTree(file);
}

bool TKCHBStream::WriteFile(const std::string&)
{
    return m_kRecord.Fail(EFailure::UnknownFormat);
}

bool TKCHBStream::ReadFile(TKCHFile& file)
{
    ReadHeader(file);
    ReadLengths(file);
    ReadHierarchy(file);
    ReadMotion(file);
    return file.FirstRoot() || m_kRecord.Fail(EFailure::NoRoot, m_uiPosition, "Global");
}

void TKCHBStream::ReadHeader(TKCHFile& file)
{
    ReadKeyword("[HEADER]");
    ReadKeyword("VersionNumber");
    file.versionNumber = ReadInt();
    if (file.versionNumber > kNewestVersion)
        Raise(EFailure::BadVersion, std::to_string(file.versionNumber), __builtin_LINE());
    ReadKeyword("DataFrameRate");
    file.dataFrameRate = ReadInt();
    ReadKeyword("BeginFrame");
    file.beginFrame = ReadInt();
    ReadKeyword("EndFrame");
    file.endFrame = ReadInt();
    ReadKeyword("NumSegments");
    file.numSegments = ReadInt();
    if (file.numSegments > kSegmentLimit)
        Raise(EFailure::TooLarge, "NumSegments", __builtin_LINE());
    file.numSegments = std::max(file.numSegments, 0);
    file.CountFrames();
    const auto nodeCount = static_cast<size_t>(file.numSegments);
    if (file.beginFrame < 0 || !KeyTimesFit(file.frameCount, nodeCount, m_kFile.Bytes().size()))
        Raise(EFailure::BadCount, "EndFrame", __builtin_LINE());
}

void TKCHBStream::ReadLengths(TKCHFile& file)
{
    ReadKeyword("[LENGTH]");
    for (int i = 0; i < file.numSegments; ++i)
    {
        const std::string_view name = ReadName();
        float length;
        ReadFloats({&length, 1});
        file.lengths.emplace_back(name, length);
    }
}

void TKCHBStream::ReadHierarchy(TKCHFile& file)
{
    ReadKeyword("[HIERARCHY]");
    file.MakeRoot();
    m_kWork.assign(static_cast<size_t>(file.numSegments), {});
    for (TKCHSegment& work : m_kWork)
    {
        const std::string_view name = ReadName();
        file.AddSegment(name, ReadName());
        work.name = name;
    }
    file.LinkSegments(m_kRecord, m_uiPosition);
}

// Frames are numbered from beginFrame on but read up to frameCount, so the last beginFrame frames stay
// unread. It has always been so.
void TKCHBStream::ReadMotion(TKCHFile& file)
{
    ReadKeyword("[MOTION]");
    const size_t frameBytes = kFrameKeyword.size() + sizeof(int32_t) + m_kWork.size() * kPoseBytes;
    const size_t held = (m_kFile.Bytes().size() - m_uiPosition) / frameBytes;
    const auto asked = static_cast<size_t>(std::max(file.frameCount - file.beginFrame, 0));
    for (TKCHSegment& work : m_kWork)
    {
        work.matrices.reserve(std::min(asked, held));
        work.positions.reserve(std::min(asked, held));
    }
    for (int number = file.beginFrame; number < file.frameCount; ++number)
    {
        ReadFrame(number);
        if (number % kReportFrames == 0)
            Report(m_uiPosition, m_kFile.Bytes().size());
    }
    TakeFrames(file);
}

void TKCHBStream::ReadFrame(int number)
{
    ReadKeyword(kFrameKeyword);
    if (ReadInt() != number)
        Raise(EFailure::MissingSection, "Frame " + std::to_string(number), __builtin_LINE(), LineText());
    for (TKCHSegment& work : m_kWork)
    {
        ReadFloats(work.matrices.emplace_back().m);
        Vec3& position = work.positions.emplace_back();
        for (float* const component : {&position.x, &position.y, &position.z})
            ReadFloats({component, 1});
    }
}

// The first key is the frame at index beginFrame of those that were read. If there are too few, the last one
// is repeated, as a track does for missing keys.
void TKCHBStream::TakeFrames(TKCHFile& file)
{
    for (TKCHSegment& work : m_kWork)
    {
        TKCHSegment* const segment = file.FindSegment(work.name);
        if (!segment || !segment->matrices.empty() || work.matrices.empty())
            continue;
        const auto first = std::min<ptrdiff_t>(file.beginFrame, std::ssize(work.matrices) - 1);
        segment->matrices.assign(work.matrices.begin() + first, work.matrices.end());
        segment->positions.assign(work.positions.begin() + first, work.positions.end());
        work = {};
    }
}

bool TKCHBStream::BuildAnimatedTree(TKCHFile& file)
{
    motionRoot = new CNode;
    const float endTime = static_cast<float>(file.endFrame) - static_cast<float>(file.beginFrame);
    BuildNodes(*file.FirstRoot(), *motionRoot, [&](TKCHSegment& segment, CNode& node) {
        AttachCHTrack(node, file, segment, kFrequency).m_fEndTime = endTime;
        AddBoneShape(file, segment, node);
    });
    return true;
}

void TKCHBStream::AddBoneShape(const TKCHFile&, const TKCHSegment& segment, CNode& node)
{
    AttachBone(node, segment.name, segment.children.size(), segment.length, boneMeshes);
}

void TKCHBStream::ReadKeyword(std::string_view keyword, Line line)
{
    ++m_iLine;
    const size_t start = m_uiPosition;
    if (EqualNoCase(TakeBytes(keyword.size(), line), keyword))
        return;
    m_uiPosition = start;
    Raise(start == 0 ? EFailure::BadHeader : EFailure::MissingSection, std::string(keyword), line,
          LineText());
}

int TKCHBStream::ReadInt(Line line)
{
    int32_t value;
    std::memcpy(&value, TakeBytes(sizeof value, line).data(), sizeof value);
    return value;
}

void TKCHBStream::ReadFloats(std::span<float> values, Line line)
{
    std::memcpy(values.data(), TakeBytes(values.size_bytes(), line).data(), values.size_bytes());
    if (!std::ranges::all_of(values, [](float value) { return std::isfinite(value); }))
        Raise(EFailure::BadNumber, {}, line);
}

std::string_view TKCHBStream::ReadName(Line line)
{
    const std::string_view field = TakeBytes(kNameBytes, line);
    const std::string_view name = field.substr(0, field.find('\0'));
    if (name.size() > kNameLimit)
        Raise(EFailure::BadName, Quote(name), line);
    return name;
}

std::string_view TKCHBStream::TakeBytes(size_t count, Line line)
{
    const std::string_view rest = m_kFile.Text().substr(m_uiPosition);
    if (count > rest.size())
        Raise(EFailure::Truncated, {}, line);
    m_uiPosition += count;
    return rest.substr(0, count);
}

std::string TKCHBStream::LineText() const
{
    return "At Line: " + std::to_string(m_iLine);
}

void TKCHBStream::Raise(EFailure reason, const std::string& name, Line line, const std::string& what)
{
    m_kRecord.Fail(reason, m_uiPosition, name);
    ERROBJ error{kErrorCode, {}, {}};
    std::snprintf(error.where, sizeof error.where, "%s Line:%d", "TKCHBStream", line);
    std::snprintf(error.what, sizeof error.what, "%s", what.c_str());
    throw error;
}

} // namespace gw
