// The writing half of TKHTRStream.
//
// A file lists all rows of one segment before those of the next. If each node's local matrix depends only on
// its own track, segments are sampled one after another and written immediately, without storing rows. In any
// other tree, all nodes must be posed together for each frame, and the rows are kept until their segment is
// written.

#include "BoneMeshQueries.h"
#include "CHTRRowText.h"
#include "CKeyframeControl.h"
#include "CLineWriter.h"
#include "CMotionSampler.h"
#include "CTrackSampler.h"
#include "Euler.h"
#include "HTRPose.h"
#include "Skeleton.h"
#include "TKHTRFile.h"
#include "TKHTRStream.h"

#include <algorithm>
#include <cmath>
#include <functional>
#include <limits>

namespace gw {

namespace {

constexpr float kFrameLimit = 1 << 24;             // larger frame numbers are not exact in a float
constexpr size_t kRowBytesLimit = size_t{1} << 31; // for stored rows
constexpr size_t kNoNode = std::numeric_limits<size_t>::max();

HTRBase BaseOf(const TKHTRSegment& segment)
{
    return {segment.baseTranslation, segment.baseRotation};
}

void AddSegments(const CNode& node, std::string_view parentName, TKHTRFile& file)
{
    TKHTRSegment& segment = *file.segments.emplace_back(std::make_unique<TKHTRSegment>());
    segment.name = node.NameView();
    segment.parentName = parentName;
    segment.baseTranslation = node.m_kMatrix.Translation();
    segment.baseRotation = Mat3ToEulerDegrees(NormalizedRows(node.m_kMatrix));
    segment.boneLength = NodeBoneLength(node);
    for (size_t i = 0; i < node.GetChildCount(); ++i)
    {
        if (const CNode* child = RecordCast<CNode>(node.ChildAt(i)))
            AddSegments(*child, segment.name, file);
    }
}

// Returns, for each segment, the index of the animated node with its name, or kNoNode. Nodes with the same
// name are matched in order.
std::vector<size_t> NodesOfSegments(const TKHTRFile& file, const std::vector<CNode*>& nodes)
{
    std::unordered_map<std::string_view, std::vector<size_t>> nodesOfName;
    for (size_t i = nodes.size(); i-- > 0;)
        nodesOfName[nodes[i]->NameView()].push_back(i);
    std::vector<size_t> found;
    for (const auto& segment : file.segments)
    {
        std::vector<size_t>& left = nodesOfName[segment->name];
        found.push_back(left.empty() ? kNoNode : left.back());
        if (!left.empty())
            left.pop_back();
    }
    return found;
}

std::vector<float> FrameTimes(int frameCount, float frequency, float frameScale)
{
    std::vector<float> times(static_cast<size_t>(std::max(frameCount, 0)));
    for (size_t frame = 0; frame < times.size(); ++frame)
        times[frame] = TimeOfFrame(static_cast<int>(frame), frequency, frameScale);
    return times;
}

/// The rows of all segments, computed during writing or, if nodes depend on each other, in advance.
class CRows
{
public:
    /// `report` is called from time to time with the number of finished rows and their total.
    CRows(const TKHTRFile& file, CNode& motion, EQuarterTurns quarterTurns, std::vector<float> times,
          std::function<void(size_t, size_t)> report)
        : file_(file), m_eQuarterTurns(quarterTurns), m_kTimes(std::move(times)), m_kSampler(motion),
          m_kNodeOfSegment(NodesOfSegments(file, m_kSampler.Nodes())), report_(std::move(report))
    {
    }

    /// Returns false if storing the rows would take too much memory.
    bool Prepare()
    {
        if (m_kSampler.PosesNodes())
            return true;
        if (m_kTimes.size() > kRowBytesLimit / sizeof(HTRRow) / file_.segments.size())
            return false;
        m_kWaiting.resize(m_kTimes.size() * file_.segments.size());
        for (size_t frame = 0; frame < m_kTimes.size(); ++frame)
        {
            m_kSampler.PoseTree(m_kTimes[frame]);
            for (size_t segment = 0; segment < file_.segments.size(); ++segment)
                m_kWaiting[segment * m_kTimes.size() + frame] = PosedRow(segment);
            Report(frame * file_.segments.size());
        }
        return true;
    }

    void Write(CLineWriter& out, size_t segment)
    {
        const size_t node = m_kNodeOfSegment[segment];
        const CKeyframeControl* track =
            m_kWaiting.empty() && node != kNoNode ? m_kSampler.TrackOf(node) : nullptr;
        if (track && CTrackSampler::CanSample(*track))
            return WriteSampled(out, segment, *track);
        CHTRRowText text;
        for (size_t frame = 0; frame < m_kTimes.size(); ++frame)
        {
            text.Write(out, NumberOf(frame), At(segment, frame));
            ReportWritten(segment, frame);
        }
    }

private:
    static int NumberOf(size_t frame) { return static_cast<int>(frame) + 1; }

    // The usual case. Saving spends nearly all of its time here.
    void WriteSampled(CLineWriter& out, size_t segment, const CKeyframeControl& track) const
    {
        const bool isRoot = !m_kSampler.Nodes()[m_kNodeOfSegment[segment]]->GetParent();
        const HTRBase base = BaseOf(*file_.segments[segment]);
        CTrackSampler sampler(track);
        CHTRRowText text;
        for (size_t frame = 0; frame < m_kTimes.size(); ++frame)
        {
            if (sampler.MoveTo(m_kTimes[frame]))
                text.Write(out, NumberOf(frame), RowOf(sampler.Local(), isRoot, base, m_eQuarterTurns));
            else
                text.Repeat(out, NumberOf(frame));
            ReportWritten(segment, frame);
        }
    }

    void ReportWritten(size_t segment, size_t frame) const
    {
        constexpr size_t kRowsBetween = 256;
        const size_t posed = m_kWaiting.size(); // posing takes about as long as writing
        if (frame % kRowsBetween == 0)
            Report(posed + segment * m_kTimes.size() + frame);
    }

    void Report(size_t done) const
    {
        report_(done, m_kTimes.size() * file_.segments.size() + m_kWaiting.size());
    }

    HTRRow At(size_t segment, size_t frame)
    {
        if (!m_kWaiting.empty())
            return m_kWaiting[segment * m_kTimes.size() + frame];
        if (m_kNodeOfSegment[segment] != kNoNode)
            m_kSampler.PoseNode(m_kNodeOfSegment[segment], m_kTimes[frame]);
        return PosedRow(segment);
    }

    HTRRow PosedRow(size_t segment) const
    {
        const size_t index = m_kNodeOfSegment[segment];
        if (index == kNoNode)
            return {};
        const CNode& node = *m_kSampler.Nodes()[index];
        return RowOf(node.m_kMatrix, !node.GetParent(), BaseOf(*file_.segments[segment]), m_eQuarterTurns);
    }

    const TKHTRFile& file_;
    EQuarterTurns m_eQuarterTurns;
    std::vector<float> m_kTimes;
    CMotionSampler m_kSampler;
    std::vector<size_t> m_kNodeOfSegment;
    std::vector<HTRRow> m_kWaiting; // ordered by segment
    std::function<void(size_t, size_t)> report_;
};

void Write(CLineWriter& out, const TKHTRFile& file, const HTRText& field)
{
    out.Text(file.*field.text);
}

void Write(CLineWriter& out, const TKHTRFile& file, char TKHTRFile::*field)
{
    out.Text({&(file.*field), 1});
}

void Write(CLineWriter& out, const TKHTRFile& file, int TKHTRFile::*field)
{
    out.Int(file.*field);
}

void Write(CLineWriter& out, const TKHTRFile& file, float TKHTRFile::*field)
{
    out.Number(file.*field);
}

void WriteVector(CLineWriter& out, const Vec3& v)
{
    out.Text(" ").Number(v.x).Text(" ").Number(v.y).Text(" ").Number(v.z);
}

void WriteHeader(CLineWriter& out, const TKHTRFile& file)
{
    out.Line("[Header]");
    for (const HTRKey& key : kHTRKeys)
    {
        out.Text(key.name).Text(" ");
        std::visit([&](const auto& field) { Write(out, file, field); }, key.field);
        out.EndLine();
    }
}

void WriteSegments(CLineWriter& out, const TKHTRFile& file)
{
    out.Line("[SegmentNames&Hierarchy]");
    out.Line("#CHILD\tPARENT");
    for (const auto& segment : file.segments)
        out.Text(segment->name).Text(" ").Line(segment->parentName);
    out.Line("[BasePosition]");
    out.Line("#SegmentName Tx, Ty, Tz, Rx, Ry, Rz, BoneLength");
    for (const auto& segment : file.segments)
    {
        out.Text(segment->name);
        WriteVector(out, segment->baseTranslation);
        WriteVector(out, segment->baseRotation);
        out.Text(" ").Number(segment->boneLength).EndLine();
    }
}

void WriteRows(CLineWriter& out, const TKHTRFile& file, CRows& rows)
{
    out.Line("#Beginning of Data. Separated by tabs");
    for (size_t segment = 0; segment < file.segments.size(); ++segment)
    {
        out.Text("[").Text(file.segments[segment]->name).Line("]");
        out.Line("#Fr\tTx\tTy\tTz\tRx\tRy\tRz\tSF");
        rows.Write(out, segment);
    }
}

// Returns a function that writes the whole text. It is valid as long as the arguments are.
std::function<bool(CLineWriter&)> TextOf(const TKHTRFile& file, CRows& rows, CFailureRecord& record)
{
    return [&](CLineWriter& out) {
        if (!rows.Prepare())
            return record.Fail(EFailure::TooLarge);
        WriteHeader(out, file);
        WriteSegments(out, file);
        WriteRows(out, file, rows);
        return true;
    };
}

} // namespace

bool TKHTRStream::FillHeader(TKHTRFile& file, float frameScale)
{
    // Rounded once: the exact product to 32 bits.
    const auto frames =
        static_cast<float>(static_cast<double>(GetKeyCount()) * static_cast<double>(frameScale));
    const double rate = 1.0 / static_cast<double>(GetFrequency());
    if (!(std::fabs(frames) <= kFrameLimit))
        return m_kRecord.Fail(EFailure::TooLarge);
    file.fileType = "htr";
    file.dataType = "HTRS";
    file.fileVersion = fileVersion;
    file.numSegments = static_cast<int>(NodesOf(*motionRoot).size());
    file.numFrames = static_cast<int>(frames);
    file.dataFrameRate = std::fabs(rate) <= std::numeric_limits<int>::max() ? static_cast<int>(rate) : 0;
    file.eulerOrder = "ZYX";
    file.calibrationUnits = "mm";
    file.rotationUnits = "Degrees";
    file.gravityAxis = 'Y';
    file.boneLengthAxis = 'Y';
    file.scaleFactor = 1.0f;
    return true;
}

bool TKHTRStream::Save(const std::string& path, float frameScale)
{
    return SaveTo(path, frameScale, {});
}

bool TKHTRStream::SaveText(const CByteSink& sink, float frameScale, std::string_view head)
{
    return SaveTo(sink, frameScale, head);
}

template <class T>
bool TKHTRStream::SaveTo(const T& destination, float frameScale, std::string_view head)
{
    m_kRecord.Clear();
    if (!restRoot || !motionRoot)
        return m_kRecord.Fail(EFailure::NoRoot);
    TKHTRFile file;
    if (!FillHeader(file, frameScale))
        return false;
    AddSegments(*restRoot, "GLOBAL", file);
    SwitchControls(*motionRoot, true);

    CRows rows(file, *motionRoot, quarterTurns, FrameTimes(file.numFrames, GetFrequency(), frameScale),
               [this](size_t done, size_t total) { Report(done, total); });
    const auto text = TextOf(file, rows, m_kRecord);
    const bool written = WriteLines(destination, [&](CLineWriter& out) { return text(out.Text(head)); });
    motionRoot->UpdateScene(0.0f, true);
    return written;
}

} // namespace gw
