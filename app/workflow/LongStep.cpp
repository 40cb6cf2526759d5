// Progress of opening, converting and saving, and its end by the user. A canceled step ends by an exception,
// because it can be anywhere in a reader, the retargeter or a writer; none of them changes anything that the
// program still uses before it is finished.

#include "CContentWindow.h"
#include "CLongStep.h"

namespace gw {

CGaitConvertContent::CLongStep::~CLongStep()
{
    content_.m_bCancelable = false;
    if (content_.m_bProgressShown)
        content_.ShowTitle(content_.m_kTitle);
    content_.m_bProgressShown = false;
}

std::function<void(size_t, size_t)> CGaitConvertContent::ProgressOf(const char* verb)
{
    return [this, verb](size_t done, size_t total) { ShowProgress(verb, done, total); };
}

void CGaitConvertContent::ShowProgress(const char* verb, size_t done, size_t total)
{
    if (!window_.IsProgressDue())
        return;
    std::string text = m_kTitle.empty() ? verb : m_kTitle;
    if (total > 0)
        text += (m_kTitle.empty() ? " " : ", ") + std::to_string(100 * done / total) + " %";
    else
        text += "...";
    ShowTitle(m_bCancelable ? text + " (Esc cancels)" : text);
    m_bProgressShown = true;
    window_.StayPainted();
    if (m_bCancelable && window_.IsCancelRequested())
        throw CCanceled();
}

} // namespace gw
