#include "CFieldEdit.h"

#include <QKeyEvent>
#include <QStyle>

namespace gw {

void CFieldEdit::ShowText(const QString& text)
{
    if (this->text() != text)
        setText(text);
}

void CFieldEdit::ShowFailure(bool failed)
{
    constexpr const char* kProperty = "failed"; // the style sheet has a rule for it
    if (property(kProperty).toBool() == failed)
        return;
    setProperty(kProperty, failed);
    style()->polish(this);
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
