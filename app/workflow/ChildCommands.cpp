// The commands of the window's children, timers and scroll bar.

#include "CContentWindow.h"
#include "CGaitConvertContent.h"
#include "CProfileEditorDialog.h"
#include "Text.h"

namespace gw {

namespace {

// The clock of both views, and the timer that updates the result view's buttons. The second never moves a
// picture: after "play1", the motion runs only while the first timer runs as well.
constexpr int kClockTimer = 0;
constexpr int kResultTimer = 1;
constexpr int kResultMilliseconds = 100;

constexpr std::string_view kPlaybar = "|playbar";

} // namespace

struct CGaitConvertContent::Command
{
    std::string_view m_kChild;
    void (CGaitConvertContent::*m_pkRun)();
    bool m_bPassOn; // the window also handles the click itself
};

void CGaitConvertContent::ForViews(void (CMotionView::*operation)())
{
    for (CMotionView* view : {m_pkSourceView.get(), m_pkResultView.get()})
    {
        if (view)
            (view->*operation)();
    }
}

// Runs an operation and ignores its result.
template <auto Operation>
void CGaitConvertContent::Run()
{
    (this->*Operation)();
}

template <auto Operation>
void CGaitConvertContent::OnViews()
{
    ForViews(Operation);
    UpdateControls();
}

template <auto Operation>
void CGaitConvertContent::OnResultView()
{
    if (m_pkResultView)
        (m_pkResultView.get()->*Operation)();
    UpdateControls();
}

// "PreFrm1" and "NextFrm1" have no rows: these two buttons light up and do nothing.
bool CGaitConvertContent::ChildClick(std::string_view child)
{
    using Content = CGaitConvertContent;
    using View = CMotionView;
    static constexpr Command kCommands[] = {
        {"close",   &Content::RequestClose,                   false},
        {"exit",    &Content::RequestClose,                   false},
        {"help",    &Content::ShowHelp,                       true },
        {"open",    &Content::OpenSourceOrRunBatch,           true },
        {"convert", &Content::Run<&Content::ConvertMotion>,   true },
        {"apply",   &Content::Run<&Content::SaveResult>,      true },
        {"play",    &Content::TogglePlay,                     true },
        {"stop",    &Content::StopAndRewind,                  true },
        {"back",    &Content::OnViews<&View::SeekStart>,      true },
        {"end",     &Content::OnViews<&View::SeekEnd>,        true },
        {"fback",   &Content::OnViews<&View::StepBack>,       true },
        {"fend",    &Content::OnViews<&View::StepForward>,    true },
        {"play1",   &Content::PlayResult,                     true },
        {"stop1",   &Content::OnResultView<&View::Stop>,      true },
        {"start1",  &Content::OnResultView<&View::SeekStart>, true },
        {"end1",    &Content::OnResultView<&View::SeekEnd>,   true },
        {"%adv",    &Content::ToggleProfileEditor,            true },
        {"del",     &Content::DeleteSelectedProfile,          true },
    };
    for (const Command& command : kCommands)
    {
        if (!EqualNoCase(command.m_kChild, child))
            continue;
        (this->*command.m_pkRun)();
        return command.m_bPassOn;
    }
    return true;
}

void CGaitConvertContent::RequestClose()
{
    window_.PostCloseRequest();
}

// Holding the left Ctrl key during the click is the only way to start a batch conversion.
void CGaitConvertContent::OpenSourceOrRunBatch()
{
    if (window_.IsKeyDown(EKey::LeftCtrl))
        RunBatch();
    else
        OpenSource();
}

void CGaitConvertContent::TogglePlay()
{
    const bool plays = m_pkSourceView && m_pkSourceView->IsPlaying();
    ForViews(plays ? &CMotionView::Stop : &CMotionView::Play);
    UpdateControls();
    window_.SetTimer(kClockTimer, kClockMilliseconds);
}

void CGaitConvertContent::StopAndRewind()
{
    ForViews(&CMotionView::Stop);
    OnViews<&CMotionView::SeekStart>();
}

void CGaitConvertContent::PlayResult()
{
    OnResultView<&CMotionView::Play>();
    window_.SetTimer(kResultTimer, kResultMilliseconds);
}

void CGaitConvertContent::ToggleProfileEditor()
{
    if (!m_pkProfileDialog)
        return;
    const bool visible = window_.GetChildButtonState("%adv");
    if (visible)
        m_pkProfileDialog->Show();
    else
        m_pkProfileDialog->Close();
    window_.ShowProfileEditor(visible);
}

void CGaitConvertContent::OnTimer(int id)
{
    if (id == kClockTimer)
        ForViews(&CMotionView::Advance);
    const CMotionView* const view = id == kClockTimer ? m_pkSourceView.get() : m_pkResultView.get();
    if (!view || !view->IsPlaying())
        window_.KillTimer(id);
    UpdateControls();
}

void CGaitConvertContent::ChildMouseDown(std::string_view child)
{
    if (EqualNoCase(child, kPlaybar))
        window_.KillTimer(kClockTimer); // so that the clock does not compete with the dragging user
}

void CGaitConvertContent::ChildMouseUp(std::string_view child)
{
    if (EqualNoCase(child, kPlaybar))
        window_.SetTimer(kClockTimer, kClockMilliseconds);
}

void CGaitConvertContent::ChildScroll(std::string_view child, int value)
{
    if (!EqualNoCase(child, kPlaybar))
        return;
    for (CMotionView* view : {m_pkSourceView.get(), m_pkResultView.get()})
    {
        if (view)
            view->Seek(value, kScrollRange);
    }
    UpdateControls();
}

} // namespace gw
