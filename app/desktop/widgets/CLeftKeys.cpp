#include "CLeftKeys.h"

#include <QCoreApplication>
#include <QKeyEvent>
#include <optional>

namespace gw {

namespace {

std::optional<EKey> LeftKey(const QKeyEvent& event)
{
#ifdef _WIN32
    constexpr quint32 kLeftCtrl = 0xa2;
    constexpr quint32 kLeftShift = 0xa0;
#else
    constexpr quint32 kLeftCtrl = 0xffe3; // the key symbols of X
    constexpr quint32 kLeftShift = 0xffe1;
#endif
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

CLeftKeys::CLeftKeys(QObject* parent) : QObject(parent)
{
    QCoreApplication::instance()->installEventFilter(this);
}

bool CLeftKeys::eventFilter(QObject* watched, QEvent* event)
{
    const QEvent::Type type = event->type();
    if (type == QEvent::ApplicationDeactivate || type == QEvent::WindowDeactivate)
        m_kDown.clear();
    if (type != QEvent::KeyPress && type != QEvent::KeyRelease)
        return QObject::eventFilter(watched, event);
    if (const auto key = LeftKey(static_cast<const QKeyEvent&>(*event)))
    {
        if (type == QEvent::KeyPress)
            m_kDown.insert(*key);
        else
            m_kDown.erase(*key);
    }
    return QObject::eventFilter(watched, event);
}

} // namespace gw
