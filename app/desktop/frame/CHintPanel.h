#pragma once

#include "Remedy.h"

#include <QFrame>
#include <functional>

class QBoxLayout;
class QLabel;

namespace gw {

/// A text with buttons in the middle of an empty view. It covers only what it needs, so the view around it
/// can still be dragged.
class CHintPanel : public QFrame
{
public:
    /// The panel is a child of the view's parent.
    explicit CHintPanel(QWidget* view);

    /// Shows a hint; hides the panel if its text is empty.
    void Show(const Hint& hint);

    /// Called with the remedy of a clicked button.
    std::function<void(ERemedy)> chosen;
    /// Called before a button that has the keyboard is removed.
    std::function<void()> focusLost;

private:
    void MakeButtons();

    QWidget* view_;
    Hint m_kHint;
    QLabel* m_pkText;
    QBoxLayout* m_pkButtons;
};

} // namespace gw
