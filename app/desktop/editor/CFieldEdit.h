#pragma once

#include <QLineEdit>
#include <functional>

namespace gw {

/// A text field that reports when it loses the keyboard. It handles the undo keys only while there is typing
/// to undo; otherwise they are the window's.
class CFieldEdit : public QLineEdit
{
public:
    using QLineEdit::QLineEdit;

    /// Called when the focus moves elsewhere, even to another window, but not to a menu over the field.
    void SetOnLeave(std::function<void()> onLeave) { onLeave_ = std::move(onLeave); }
    /// Shows a text. Does not touch typing or the caret if it is already shown.
    void ShowText(const QString& text);
    /// Shows by its color whether the text is a search that found nothing.
    void ShowFailure(bool failed);

protected:
    bool event(QEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;

private:
    std::function<void()> onLeave_;
};

} // namespace gw
