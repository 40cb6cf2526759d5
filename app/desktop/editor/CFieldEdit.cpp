#include "CFieldEdit.h"

#include <QKeyEvent>

namespace gw {

void CFieldEdit::ShowText(const QString& text)
{
    if (this->text() != text)
        setText(text);
}

bool CFieldEdit::event(QEvent* event)
{
    if (event->type() == QEvent::ShortcutOverride)
    {
        const auto& key = static_cast<const QKeyEvent&>(*event);
        const bool nothingToUndo = key.matches(QKeySequence::Undo) && !isUndoAvailable();
        const bool nothingToRedo = key.matches(QKeySequence::Redo) && !isRedoAvailable();
        if (nothingToUndo || nothingToRedo)
            return false;
    }
    return QLineEdit::event(event);
}

void CFieldEdit::keyPressEvent(QKeyEvent* event)
{
    if (event->key() == Qt::Key_Escape && onEscape_)
        onEscape_();
    else
        QLineEdit::keyPressEvent(event);
}

void CFieldEdit::focusOutEvent(QFocusEvent* event)
{
    QLineEdit::focusOutEvent(event);
    if (event->reason() == Qt::PopupFocusReason)
        return;
    setText(text()); // clears the undo history
    if (onLeave_)
        onLeave_();
}

} // namespace gw
