#pragma once

#include "CProfileOwner.h"

#include <QDialog>
#include <string>
#include <vector>

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

/// Parts of a message box besides its text and answers.
struct BoxExtras
{
    std::string summary;             ///< shown below the text
    std::vector<std::string> offers; ///< buttons next to the answers; they close the box like the last answer
    std::string details;             ///< text to unfold; may be empty
    EDetails shown = EDetails::Folded;
};

/// The program's message box: a text, buttons, and details that unfold below. All texts are plain text,
/// whatever a file name contains. Enter presses the first button; Escape and the close box press the last
/// one, which is the safest of each set.
class CMessageBox : public QDialog
{
public:
    CMessageBox(QWidget* owner, const QString& caption, const QString& text, EButtons buttons,
                const BoxExtras& extras);

    /// Shows the box until it is answered.
    EAnswer Run();

    /// Returns the index of the offer that closed the box, or -1.
    int ChosenOffer() const { return m_iOffer; }

    void reject() override;

private:
    QWidget* MakeText(const QString& text, const char* name);
    QWidget* MakeDetails(const QString& details);
    QLayout* MakeButtons(EButtons buttons, const BoxExtras& extras);
    void AddOffers(QBoxLayout& layout, const std::vector<std::string>& offers);
    void AddDetailsButtons(QBoxLayout& layout);
    void ShowDetails(bool visible);

    EAnswer m_eEscape;
    QPlainTextEdit* m_pkDetails = nullptr;
    QToolButton* m_pkFold = nullptr;
    int m_iOffer = -1;
};

/// Shows a message box until it is answered. `offer` receives the index of the offer that was clicked, or -1.
EAnswer RunMessageBox(QWidget* owner, const std::string& caption, const std::string& text, EButtons buttons,
                      const BoxExtras& extras = {}, int* offer = nullptr);

} // namespace gw
