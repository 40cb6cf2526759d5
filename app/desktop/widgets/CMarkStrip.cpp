#include "CMarkStrip.h"

#include "FaultWords.h"
#include "QtText.h"

#include <QHelpEvent>
#include <QMouseEvent>
#include <QPainter>
#include <QToolTip>
#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr double kEnd = 7.0; // half of the bar's handle: pixels left of the first and right of the last frame
constexpr double kLineHeight = 2.0;
constexpr double kLineStep = 3.0;
constexpr double kTickWidth = 3.0;
constexpr double kTickReach = 4.0; // pixels within which a tick is meant

// The colors of mapped bones in the editor's two trees; a tick stands out from both.
constexpr QRgb kLineColors[] = {0xff3fb6a8, 0xffe0a33e};
constexpr QRgb kTickColor = 0xffff6b6b;

bool IsPlanted(const std::vector<Contact>& contacts, int frame)
{
    return std::ranges::any_of(contacts, [=](const Contact& c) { return c.first <= frame && frame < c.end; });
}

} // namespace

CMarkStrip::CMarkStrip(QWidget* parent) : QWidget(parent)
{
    setAttribute(Qt::WA_NoSystemBackground);
}

void CMarkStrip::ShowMarks(const MotionMarks& marks)
{
    m_kMarks = marks;
    setCursor(marks.frameCount > 0 ? Qt::PointingHandCursor : Qt::ArrowCursor);
    update();
}

double CMarkStrip::PlaceOf(double frame) const
{
    return kEnd + frame * (width() - 2 * kEnd) / std::max(m_kMarks.frameCount - 1, 1);
}

double CMarkStrip::FrameAt(double x) const
{
    const double frame = (x - kEnd) * (m_kMarks.frameCount - 1) / (width() - 2 * kEnd);
    return std::clamp(frame, 0.0, std::max(m_kMarks.frameCount - 1.0, 0.0));
}

const WorstFrame* CMarkStrip::WorstAt(double x) const
{
    const auto distance = [&](const WorstFrame& worst) { return std::fabs(PlaceOf(worst.frame) - x); };
    const auto nearest = std::ranges::min_element(m_kMarks.worst, {}, distance);
    return nearest != m_kMarks.worst.end() && distance(*nearest) <= kTickReach ? &*nearest : nullptr;
}

void CMarkStrip::PaintContacts(QPainter& painter, const std::vector<Contact>& contacts, int line) const
{
    for (const Contact& contact : contacts)
    {
        const double left = PlaceOf(contact.first);
        const double right = std::max(PlaceOf(contact.end - 1), left + 1.0);
        painter.fillRect(QRectF(left, line * kLineStep, right - left, kLineHeight),
                         QColor::fromRgb(kLineColors[line % 2]));
    }
}

void CMarkStrip::paintEvent(QPaintEvent*)
{
    if (m_kMarks.frameCount == 0)
        return;
    QPainter painter(this);
    int line = 0;
    for (const FootMarks& foot : m_kMarks.feet)
    {
        PaintContacts(painter, foot.source, line++);
        PaintContacts(painter, foot.result, line++);
    }
    for (const WorstFrame& worst : m_kMarks.worst)
        painter.fillRect(QRectF(PlaceOf(worst.frame) - kTickWidth / 2, 0, kTickWidth, height()),
                         QColor::fromRgb(kTickColor));
}

void CMarkStrip::mousePressEvent(QMouseEvent* event)
{
    const double x = event->position().x();
    if (event->button() != Qt::LeftButton || m_kMarks.frameCount == 0)
        return;
    const WorstFrame* const worst = WorstAt(x);
    goTo(worst ? worst->frame : static_cast<int>(std::lround(FrameAt(x))));
}

QString CMarkStrip::TipAt(const QPoint& at) const
{
    if (const WorstFrame* worst = WorstAt(at.x()))
        return tr("Check %1. N goes to the next one.").arg(ToQString(WorstFrameText(*worst)));
    const int frame = static_cast<int>(std::lround(FrameAt(at.x())));
    QStringList lines{tr("Where feet are planted: source above, result below. Frame %1:").arg(frame)};
    for (const FootMarks& foot : m_kMarks.feet)
    {
        const auto word = [&](const auto& contacts) {
            return IsPlanted(contacts, frame) ? tr("planted") : tr("free");
        };
        lines << tr("%1: %2 in the source, %3 in the result")
                     .arg(ToQString(foot.target), word(foot.source), word(foot.result));
    }
    return lines.join(QLatin1Char('\n'));
}

bool CMarkStrip::event(QEvent* event)
{
    if (event->type() != QEvent::ToolTip || m_kMarks.frameCount == 0)
        return QWidget::event(event);
    const auto& help = static_cast<const QHelpEvent&>(*event);
    QToolTip::showText(help.globalPos(), TipAt(help.pos()), this);
    return true;
}

} // namespace gw
