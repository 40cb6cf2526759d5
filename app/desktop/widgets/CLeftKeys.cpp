#include "CLeftKeys.h"

#include "LeftKeyCodes.h"

#include <QCoreApplication>
#include <QKeyEvent>
#include <QMouseEvent>
#include <optional>
#include <utility>

namespace gw {

namespace {

std::optional<EKey> LeftKey(const QKeyEvent& event)
{
    switch (event.nativeVirtualKey())
    {
    case kLeftCtrl:
        return EKey::LeftCtrl;
    case kLeftShift:
        return EKey::LeftShift;
    default:
        return std::nullopt;
    }
}

} // namespace

CLeftKeys::CLeftKeys(Query query, QObject* parent) : QObject(parent), m_kQuery(std::move(query))
{
    QCoreApplication::instance()->installEventFilter(this);
}

// When one window of the program loses the keyboard to another, the keys are kept: a click on an inactive
// window activates it before the button receives the click.
bool CLeftKeys::eventFilter(QObject* watched, QEvent* event)
{
    switch (event->type())
    {
    case QEvent::ApplicationDeactivate:
        m_kDown.clear();
        break;
    case QEvent::KeyPress:
        if (const auto key = LeftKey(static_cast<const QKeyEvent&>(*event)))
            m_kDown.insert(*key);
        break;
    case QEvent::KeyRelease:
        if (const auto key = LeftKey(static_cast<const QKeyEvent&>(*event)))
            m_kDown.erase(*key);
        break;
    case QEvent::MouseButtonPress:
    case QEvent::MouseButtonRelease: {
        const Qt::KeyboardModifiers modifiers = static_cast<const QMouseEvent&>(*event).modifiers();
        Check(EKey::LeftCtrl, modifiers.testFlag(Qt::ControlModifier));
        Check(EKey::LeftShift, modifiers.testFlag(Qt::ShiftModifier));
        break;
    }
    default:
        break;
    }
    return QObject::eventFilter(watched, event);
}

// A click carries the modifiers at its own time, left or right, even if the program had no focus then. Only a
// modifier that no known left key explains requires a query to the system, which takes a round trip.
void CLeftKeys::Check(EKey key, bool isModified)
{
    if (!isModified)
        m_kDown.erase(key);
    else if (!IsDown(key) && m_kQuery().contains(key))
        m_kDown.insert(key);
}

} // namespace gw
