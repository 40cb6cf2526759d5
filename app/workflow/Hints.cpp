// What the window says about the state: captions over the views, and hints in empty views.

#include "CContentWindow.h"
#include "CGaitConvertContent.h"
#include "CProfileEditorDialog.h"
#include "Paths.h"
#include "Text.h"

namespace gw {

namespace {

std::string FileName(const std::string& path)
{
    return path.substr(SplitPath(path).folder.size());
}

} // namespace

void CGaitConvertContent::ShowCaptions()
{
    const std::string source =
        SourceRoot() ? MotionCaption(Printable(FileName(m_kSourcePath)), Timing(), kClockMilliseconds)
                     : "Source";
    window_.SetChildText("source", source);
    window_.SetChildText("#sourceNote", SourceNote());
    std::string result = "Result";
    std::string made;
    if (m_kOrigin)
    {
        const std::string name =
            m_kResultFile.empty() ? "Result, not saved" : Printable(FileName(m_kResultFile));
        result = MotionCaption(name, m_kOrigin->timing, kClockMilliseconds);
        made = OriginCaption(*m_kOrigin);
        if (m_bConversionFailed)
            made += "; the last conversion failed, so there is nothing to save";
        else if (HasChangedSince())
            made += "; settings have changed since";
    }
    window_.SetChildText("result", result);
    window_.SetChildText("#resultNote", made);
    const StepState state = State();
    window_.ShowHint(kSourceViewChild, CNextSteps::SourceHint(state));
    window_.ShowHint(kResultViewChild, m_kNextSteps.ResultHint(state));
}

// What a person should know about the source that is on display.
std::string CGaitConvertContent::SourceNote() const
{
    const std::string& up = m_kNextSteps.UpAxis();
    std::string note;
    if (const size_t count = Clips().size(); count > 1)
        note = "Clip " + Quoted(OpenClip()) + ", one of " + std::to_string(count) +
               "; the options menu has the others";
    if (!up.empty())
        note += (note.empty() ? "Up axis: " : ". Up axis: ") + up;
    return note;
}

bool CGaitConvertContent::HasChangedSince() const
{
    return !(m_kChoices == m_kOrigin->choices) || !m_pkProfileDialog->Rows().HasSameRows(m_kOrigin->rows);
}

} // namespace gw
