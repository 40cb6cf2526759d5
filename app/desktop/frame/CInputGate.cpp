#include "CInputGate.h"

#include <QCoreApplication>
#include <QKeyEvent>

namespace gw {

namespace {

bool IsModifier(int key)
{
    return key == Qt::Key_Shift || key == Qt::Key_Control || key == Qt::Key_Alt || key == Qt::Key_AltGr ||
           key == Qt::Key_Meta;
}

} // namespace

CInputGate::CInputGate()
{
    QCoreApplication::instance()->installEventFilter(this);
}

bool CInputGate::eventFilter(QObject*, QEvent* event)
{
    switch (event->type())
    {
    case QEvent::ShortcutOverride: // accepted, so that no shortcut runs
    case QEvent::KeyPress:
    case QEvent::KeyRelease: {
        const int key = static_cast<QKeyEvent*>(event)->key();
        m_bEscape = m_bEscape || (key == Qt::Key_Escape && event->type() != QEvent::KeyRelease);
        event->accept();
        return !IsModifier(key);
    }
    case QEvent::Shortcut:
    case QEvent::MouseButtonPress:
    case QEvent::MouseButtonRelease:
    case QEvent::MouseButtonDblClick:
    case QEvent::Wheel:
    case QEvent::ContextMenu:
    case QEvent::DragEnter:
    case QEvent::Drop:
        return true;
    default:
        return false;
    }
}

} // namespace gw
