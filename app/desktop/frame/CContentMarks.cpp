// The face's strip of marks under the bar.

#include "CContent.h"
#include "CGaitConvertContent.h"
#include "CMarkStrip.h"

namespace gw {

namespace {

constexpr int kMarksMilliseconds = 50;

// Returns the strip among the children, or null if the skin has none.
CMarkStrip* StripOf(const std::map<std::string, QWidget*, std::less<>>& children)
{
    const auto found = children.find("#marks");
    return found == children.end() ? nullptr : dynamic_cast<CMarkStrip*>(found->second);
}

} // namespace

void CContent::ConnectMarks()
{
    if (CMarkStrip* const strip = StripOf(m_kChildren))
        strip->goTo = [this](int frame) { m_pkLogic->GoToFrame(frame); };
    m_kMarksClock.setInterval(kMarksMilliseconds);
    connect(&m_kMarksClock, &QTimer::timeout, this, [this] {
        if (!m_pkLogic || (!IsBusy() && !m_pkLogic->UpdateMarks()))
            m_kMarksClock.stop();
    });
}

void CContent::WatchMarks()
{
    m_kMarksClock.start();
}

void CContent::ShowMarks(const MotionMarks& marks)
{
    if (CMarkStrip* const strip = StripOf(m_kChildren))
        strip->ShowMarks(marks);
}

} // namespace gw
