// Selects the stream for a motion file by its extension and takes its trees if it succeeds. Here, the
// streams' exceptions end: callers only see a bool and the record.

#include "CMotionFile.h"

#include "CKeyframeControl.h"
#include "CLineWriter.h"
#include "CSafeFile.h"
#include "ERROBJ.h"
#include "Paths.h"
#include "RestPose.h"
#include "TKBVHStream.h"
#include "TKCHAStream.h"
#include "TKCHBStream.h"
#include "TKHTRStream.h"
#include "TKImportStream.h"

#include <algorithm>
#include <iterator>
#include <memory>
#include <new>
#include <string_view>
#include <utility>
#include <vector>

namespace gw {

namespace {

struct StreamRow
{
    std::string_view extension;
    std::unique_ptr<CMotionFile> (*make)();
    bool hasRestTree;
};

template <class T>
std::unique_ptr<CMotionFile> Make()
{
    return std::make_unique<T>();
}

constexpr StreamRow kStreams[] = {
    {".htr", Make<TKHTRStream>, true },
    {".bvh", Make<TKBVHStream>, false},
    {".cha", Make<TKCHAStream>, false},
    {".chb", Make<TKCHBStream>, false},
};

constexpr StreamRow kImport = {{}, Make<TKImportStream>, false};

const StreamRow* FindStream(const std::string& path)
{
    if (IsImported(path))
        return &kImport;
    const auto fits = [&](const StreamRow& row) { return HasExtension(path, row.extension); };
    const auto found = std::ranges::find_if(kStreams, fits);
    return found == std::end(kStreams) ? nullptr : found;
}

// Returns the result of a stream's operation and turns exceptions into failures. ERROBJ comes with a reason
// in the record. Memory use is bounded by the size of the file or the trees, but a machine may still have
// less.
template <class F>
bool AnswerOf(CFailureRecord& record, F operation)
{
    try
    {
        return operation();
    } catch (const ERROBJ&)
    {
        return false;
    } catch (const std::bad_alloc&)
    {
        return record.Fail(EFailure::OutOfMemory);
    }
}

// The first control of a class in a tree, or null.
template <class T>
T* FirstControl(const Ref<CNode>& root)
{
    return root ? static_cast<T*>(root->FindObject(nullptr, &T::ms_kRTTI, true)) : nullptr;
}

} // namespace

CMotionFile::CMotionFile() = default;
CMotionFile::~CMotionFile() = default;

CMotionFile::CMotionFile(const CMotionFile& trees)
    : restRoot(trees.restRoot), motionRoot(trees.motionRoot), fileVersion(trees.fileVersion),
      quarterTurns(trees.quarterTurns)
{
}

bool CMotionFile::Load(const std::string& path)
{
    m_kRecord.Clear();
    if (path.empty())
        return m_kRecord.Fail(EFailure::NotFound);
    if (const StreamRow* row = FindStream(path))
    {
        const auto stream = row->make();
        stream->boneMeshes = boneMeshes;
        stream->progress_ = progress_;
        stream->lines.SetProgress(progress_);
        stream->importChoice = importChoice;
        const bool loaded = AnswerOf(stream->m_kRecord, [&] { return stream->Load(path); });
        m_kRecord = stream->m_kRecord;
        if (!stream->IsSourceWhole())
        {
            m_kRecord.Clear(); // discard failures caused by the missing bytes
            return m_kRecord.Fail(EFailure::Changed);
        }
        if (!loaded)
            return false;
        JudgeRestPose(*stream->motionRoot, m_kRecord);
        motionRoot = stream->motionRoot;
        fileVersion = stream->fileVersion;
        imported = std::move(stream->imported);
        if (row->hasRestTree)
            restRoot = stream->restRoot;
    }
    if (!motionRoot)
        return m_kRecord.Fail(EFailure::UnknownFormat);
    motionRoot->UpdateScene(0.0f, true);
    return true;
}

bool CMotionFile::Save(const std::string& path, float frameScale)
{
    m_kRecord.Clear();
    if (!HasExtension(path, ".htr"))
        return m_kRecord.Fail(path.empty() ? EFailure::NotFound : EFailure::UnknownFormat);
    return SaveBy([&](TKHTRStream& stream) { return stream.Save(path, frameScale); });
}

bool CMotionFile::SaveText(const CByteSink& sink, float frameScale, std::string_view head)
{
    m_kRecord.Clear();
    return SaveBy([&](TKHTRStream& stream) { return stream.SaveText(sink, frameScale, head); });
}

bool CMotionFile::SaveBy(const std::function<bool(TKHTRStream&)>& save)
{
    TKHTRStream stream(*this);
    stream.SetProgress(progress_);
    const bool saved = AnswerOf(stream.m_kRecord, [&] { return save(stream); });
    m_kRecord = stream.m_kRecord;
    return saved;
}

float CMotionFile::GetLastFrame() const
{
    const auto* control = FirstControl<CControl>(motionRoot);
    return control ? control->m_fEndTime : 0.0f;
}

float CMotionFile::GetFrequency() const
{
    const auto* control = FirstControl<CControl>(motionRoot);
    return control ? control->m_fFrequency : 0.0f;
}

int CMotionFile::GetKeyCount() const
{
    const auto* track = FirstControl<CKeyframeControl>(motionRoot);
    return track ? static_cast<int>(track->m_kKeyTimes.size()) : 0;
}

bool CMotionFile::ReadLines(const std::string& path)
{
    const EFailure failure = path.empty() ? EFailure::NotFound : lines.Open(path);
    return failure == EFailure::None || m_kRecord.Fail(failure);
}

bool CMotionFile::WriteLines(const std::string& path, const std::function<bool(CLineWriter&)>& append)
{
    CSafeFile file;
    if (path.empty())
        return m_kRecord.Fail(EFailure::WriteError);
    if (!file.Open(path))
        return m_kRecord.Fail(file.Failure());
    const CByteSink sink = [&](std::span<const std::byte> bytes) { return file.Write(bytes); };
    return WriteLines(sink, append) && (file.Commit() || m_kRecord.Fail(file.Failure()));
}

bool CMotionFile::WriteLines(const CByteSink& sink, const std::function<bool(CLineWriter&)>& append)
{
    CLineWriter writer(sink);
    return append(writer) && (writer.Flush() || m_kRecord.Fail(EFailure::WriteError));
}

void SwitchControls(CNode& root, bool active)
{
    std::vector<CObject*> found;
    root.FindObjects(found, nullptr, &CControl::ms_kRTTI, true);
    for (CObject* object : found)
        static_cast<CControl*>(object)->m_bActive = active;
}

} // namespace gw
