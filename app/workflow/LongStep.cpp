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

void CGaitConvertContent::ShowPercent(const char* verb, size_t done, size_t total)
{
    ShowProgress(verb, std::to_string(total > 0 ? 100 * done / total : 0) + " %");
}

void CGaitConvertContent::ShowProgress(const char* verb, const std::string& amount)
{
    if (!window_.IsProgressDue())
        return;
    const std::string text = m_kTitle.empty() ? std::string(verb) + ' ' + amount : m_kTitle + ", " + amount;
    ShowTitle(m_bCancelable ? text + " (Esc cancels)" : text);
    m_bProgressShown = true;
    window_.StayPainted();
    if (m_bCancelable && window_.IsCancelRequested())
        throw CCanceled();
}

} // namespace gw
