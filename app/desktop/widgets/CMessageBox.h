#pragma once

#include "CProfileOwner.h"

#include <QDialog>
#include <string>

class QBoxLayout;
class QPlainTextEdit;
class QToolButton;

namespace gw {

/// The initial state of a message box's details.
enum class EDetails
{
    Folded,
    Unfolded,
};

/// The program's message box: a text, buttons, and details that unfold below. All texts are plain text,
/// whatever a file name contains. Enter presses the first button; Escape and the close box press the last
/// one, which is the safest of each set.
class CMessageBox : public QDialog
{
public:
    CMessageBox(QWidget* owner, const QString& caption, const QString& text, EButtons buttons,
                const QString& details, EDetails shown = EDetails::Folded);

    /// Shows the box until it is answered.
    EAnswer Run();

    void reject() override;

private:
    QWidget* MakeText(const QString& text);
    QWidget* MakeDetails(const QString& details);
    QLayout* MakeButtons(EButtons buttons, bool hasDetails);
    void AddDetailsButtons(QBoxLayout& layout);
    void ShowDetails(bool visible);

    EAnswer m_eEscape;
    QPlainTextEdit* m_pkDetails = nullptr;
    QToolButton* m_pkFold = nullptr;
};

/// Shows a message box until it is answered. Empty details cannot be unfolded.
EAnswer RunMessageBox(QWidget* owner, const std::string& caption, const std::string& text, EButtons buttons,
                      const std::string& details = {}, EDetails shown = EDetails::Folded);

} // namespace gw
