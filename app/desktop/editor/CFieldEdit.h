#pragma once

#include <QLineEdit>
#include <functional>

namespace gw {

/// A text field that tells when the keyboard leaves it. The undo keys are its own only while there is typing
/// to take back; else they are the window's.
class CFieldEdit : public QLineEdit
{
public:
    using QLineEdit::QLineEdit;

    /// Called when the focus goes elsewhere, be it in another window; a menu over the field takes nothing
    /// away.
    void SetOnLeave(std::function<void()> onLeave) { onLeave_ = std::move(onLeave); }
    /// Called at the Escape key, which then goes no further. Without it the key is the window's.
    void SetOnEscape(std::function<void()> onEscape) { onEscape_ = std::move(onEscape); }
    /// Shows a text, and leaves typing and caret alone where it is there already.
    void ShowText(const QString& text);

protected:
    bool event(QEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;

private:
    std::function<void()> onLeave_;
    std::function<void()> onEscape_;
};

} // namespace gw
