#pragma once

#include <QKeyEvent>
#include <QPushButton>

namespace gw {

/// A button that Enter clicks, because the space bar plays. With Ctrl, Enter converts.
class CPushButton : public QPushButton
{
public:
    using QPushButton::QPushButton;

protected:
    void keyPressEvent(QKeyEvent* event) override
    {
        const bool plain = !(event->modifiers() & ~Qt::KeypadModifier);
        if (plain && (event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter))
            click();
        else
            QPushButton::keyPressEvent(event);
    }
};

} // namespace gw
