#include "CMarksMeter.h"

#include "BonePairs.h"
#include "CKeyframeControl.h"
#include "CMapRowTable.h"
#include "CMotionFile.h"
#include "FaultWords.h"
#include "FindBone.h"
#include "HTRPose.h"
#include "MeasureConversion.h"
#include "StepBehind.h"

#include <atomic>
#include <new>
#include <thread>

namespace gw {

namespace {

Ref<CNode> CopyOf(CNode* tree)
{
    CCloneMap map;
    return tree ? static_cast<CNode*>(tree->Clone(map)) : nullptr;
}

std::vector<BonePair> PairsOf(const CMapRowTable& rows, CNode* source, CNode* result)
{
    const CBoneNames sources(source);
    const CBoneNames targets(result);
    std::vector<BonePair> pairs;
    for (int row = 0; row < rows.RowCount(); ++row)
    {
        const BonePair pair{targets.Find(rows.Text(row, kTargetColumn)),
                            sources.Find(rows.Text(row, kSourceColumn))};
        if (!rows.IsFixed(row) && pair.target && pair.source)
            pairs.push_back(pair);
    }
    return pairs;
}

} // namespace

class CMarksMeter::CJob
{
public:
    CJob(CNode& source, const CKeyframeControl& track, const CMotionFile& result, const CMapRowTable& rows)
        : m_spkSource(CopyOf(&source)), m_kSource{m_spkSource.Get(), track.m_fFrequency,
                                                  static_cast<int>(track.m_kKeyTimes.size())},
          m_kResult(result)
    {
        m_kResult.motionRoot = CopyOf(result.motionRoot.Get());
        m_kResult.restRoot = CopyOf(result.restRoot.Get());
        m_kPairs = PairsOf(rows, m_kSource.root, m_kResult.motionRoot.Get());
    }

    void Run(std::mutex& turn)
    {
        m_kThread = std::jthread([this, &turn](const std::stop_token& stop) {
            StepBehind();
            const std::lock_guard lock(turn);
            if (!stop.stop_requested())
                Measure();
            m_bDone = true;
        });
    }
    void Cancel() { m_kThread.request_stop(); }
    bool IsDone() const { return m_bDone; }
    MotionMarks TakeMarks() { return std::move(m_kMarks); }

private:
    void Measure()
    try
    {
        if (m_kResult.restRoot)
            TakeWrittenPoses(m_kResult);
        ConversionDetail detail;
        const ConversionMeasures sums = MeasureConversion(m_kSource, ClipOf(m_kResult), m_kPairs, &detail);
        for (size_t i = 0; i < detail.feet.size() && i < sums.feet.size(); ++i)
        {
            FootDetail& foot = detail.feet[i];
            m_kMarks.feet.push_back(
                {sums.feet[i].target, std::move(foot.sourceContacts), std::move(foot.resultContacts)});
        }
        if (sums.frameCount > 0)
            m_kMarks.worst = FindWorstFrames(sums, detail, kWorstFrames);
        m_kMarks.frameCount = static_cast<int>(sums.frameCount);
    } catch (const std::bad_alloc&)
    {
        m_kMarks = {}; // marks are only an offer
    }

    Ref<CNode> m_spkSource;
    MotionClip m_kSource;
    CMotionFile m_kResult;
    std::vector<BonePair> m_kPairs;
    MotionMarks m_kMarks;
    std::atomic<bool> m_bDone = false;
    std::jthread m_kThread; // last: it is joined before the copies are destroyed
};

CMarksMeter::CMarksMeter() = default;
CMarksMeter::~CMarksMeter() = default;

void CMarksMeter::Start(CNode& source, const CKeyframeControl& track, const CMotionFile& result,
                        const CMapRowTable& rows)
{
    Cancel();
    m_spJob = std::make_unique<CJob>(source, track, result, rows);
    m_spJob->Run(m_kTurn);
}

void CMarksMeter::Cancel()
{
    if (m_spJob)
    {
        m_spJob->Cancel();
        m_kCanceled.push_back(std::move(m_spJob));
    }
    DropFinished();
}

void CMarksMeter::DropFinished()
{
    std::erase_if(m_kCanceled, [](const auto& job) { return job->IsDone(); });
}

std::optional<MotionMarks> CMarksMeter::Take()
{
    DropFinished();
    if (!m_spJob || !m_spJob->IsDone())
        return std::nullopt;
    const std::unique_ptr<CJob> done = std::move(m_spJob);
    return done->TakeMarks();
}

} // namespace gw
