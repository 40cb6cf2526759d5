// The marks of the open result: planted feet and worst frames, measured after each conversion.

#include "CContentWindow.h"
#include "CGaitConvertContent.h"
#include "CKeyframeControl.h"
#include "CProfileEditorDialog.h"
#include "FaultWords.h"
#include "SourceTiming.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace gw {

namespace {

// Returns the frame that a view shows, or -1 without a motion.
int FrameOf(const CMotionView* view)
{
    if (!view || !(view->GetFrameStep() > 0.0f))
        return -1;
    return static_cast<int>(std::lround(view->GetTime() / view->GetFrameStep()));
}

} // namespace

// `driving` is what drove the result: the source, or its aligned copy.
void CGaitConvertContent::StartMarks(CNode& driving)
{
    ClearMarks();
    const CKeyframeControl* const track = ConversionTrack(SourceRoot());
    if (!track || !m_kResultMotion.motionRoot)
        return;
    m_kMarksMeter.Start(driving, *track, m_kResultMotion, m_pkProfileDialog->Rows());
    window_.WatchMarks();
}

void CGaitConvertContent::ClearMarks()
{
    m_kMarksMeter.Cancel();
    m_kMarks = {};
    window_.ShowMarks(m_kMarks);
}

bool CGaitConvertContent::UpdateMarks()
{
    std::optional<MotionMarks> marks = m_kMarksMeter.Take();
    if (marks)
    {
        m_kMarks = std::move(*marks);
        window_.ShowMarks(m_kMarks);
        ShowWorstFrame();
    }
    return m_kMarksMeter.IsMeasuring();
}

void CGaitConvertContent::GoToFrame(int frame)
{
    const int last = m_kMarks.frameCount - 1;
    if (last < 1)
        return;
    ForViews(&CMotionView::Stop);
    for (CMotionView* view : {m_pkSourceView.get(), m_pkResultView.get()})
    {
        if (view)
            view->Seek(std::clamp(frame, 0, last), last);
    }
    UpdateControls();
}

// In the order of the frames, and from the last one to the first.
void CGaitConvertContent::GoToNextWorst()
{
    const int present = FrameOf(m_pkSourceView.get());
    const int count = m_kMarks.frameCount;
    const auto ahead = [=](const WorstFrame& worst) { return (worst.frame - present - 1 + count) % count; };
    const auto next = std::ranges::min_element(m_kMarks.worst, {}, ahead);
    if (next != m_kMarks.worst.end())
        GoToFrame(next->frame);
}

// Says what is wrong in the present frame, if it is one of the worst.
void CGaitConvertContent::ShowWorstFrame()
{
    if (!m_pkResultView)
        return;
    const auto found = std::ranges::find(m_kMarks.worst, FrameOf(m_pkSourceView.get()), &WorstFrame::frame);
    const bool isWorst = found != m_kMarks.worst.end();
    m_pkResultView->SetNote(isWorst ? "Check " + WorstFrameText(*found) : std::string());
}

} // namespace gw
