// The face's questions to the user, and its use of the desktop environment.

#include "CContent.h"
#include "CGaitConvertContent.h"
#include "CMessageBox.h"
#include "CNextSteps.h"
#include "CProfileEditorWindow.h"
#include "CSelectFolderDialog.h"
#include "DesktopServices.h"
#include "FileDialog.h"
#include "QtText.h"
#include "StringTable.h"

#include <QCoreApplication>
#include <QGuiApplication>

namespace gw {

namespace {

// Shows the arrow instead of the wait cursor while a question interrupts an operation.
class CArrowCursor
{
public:
    CArrowCursor() { QGuiApplication::setOverrideCursor(Qt::ArrowCursor); }
    ~CArrowCursor() { QGuiApplication::restoreOverrideCursor(); }
    CArrowCursor(const CArrowCursor&) = delete;
    CArrowCursor& operator=(const CArrowCursor&) = delete;
};

} // namespace

EAnswer CContent::ShowMessageBox(int id, const std::string& text, EButtons buttons)
{
    const CArrowCursor arrow;
    // Notices are cleared when a step begins, so outside a step they are from an earlier one.
    if (m_iWaits == 0 || !EndsStep(id))
        return AskWithOffers(Asker(id), text, buttons, {});
    BoxExtras extras;
    extras.details = Notes();
    if (id == kInvalidSourceMessage || id == kCannotConvertMessage)
        extras.summary = SummaryOf(m_kNotices);
    for (const Offer& offer : m_pkLogic->OffersFor(m_kNotices))
        extras.offers.push_back(offer.button);
    return AskWithOffers(Asker(id), text, buttons, extras);
}

EAnswer CContent::AskWithOffers(QWidget* asker, const std::string& text, EButtons buttons,
                                const BoxExtras& extras)
{
    const std::vector<Offer> offers = m_pkLogic->OffersFor(m_kNotices);
    int chosen = -1;
    const EAnswer answer =
        RunMessageBox(asker, m_pkLogic->Message(kTitleMessage), text, buttons, extras, &chosen);
    if (chosen >= 0)
        RunSoon(offers[static_cast<size_t>(chosen)].remedy);
    return answer;
}

// After the operation that asked.
void CContent::RunSoon(ERemedy remedy)
{
    QTimer::singleShot(0, this, [this, remedy] {
        if (IsBusy())
            RunSoon(remedy);
        else
            m_pkLogic->RunRemedy(remedy);
    });
}

QWidget* CContent::Asker(int messageId)
{
    return m_pkEditor && m_pkEditor->Raised(messageId) ? static_cast<QWidget*>(m_pkEditor) : this;
}

void CContent::ShowNotes()
{
    BoxExtras extras;
    extras.details = Notes();
    extras.shown = EDetails::Unfolded;
    for (const Offer& offer : m_pkLogic->OffersFor(m_kNotices))
        extras.offers.push_back(offer.button);
    AskWithOffers(this, ToUtf8(QCoreApplication::translate("Face", "Warnings from the last step")),
                  EButtons::OK, extras);
}

std::optional<std::string> CContent::AskOpenFile(const FileDialogSetup& setup)
{
    const CArrowCursor arrow;
    return RunFileDialog(*this, QFileDialog::AcceptOpen, setup);
}

std::optional<std::string> CContent::AskSaveFile(const FileDialogSetup& setup)
{
    const CArrowCursor arrow;
    return RunFileDialog(*Asker(), QFileDialog::AcceptSave, setup);
}

std::optional<FolderChoice> CContent::AskFolder(const FileDialogSetup& setup)
{
    const CArrowCursor arrow;
    return gw::AskFolder(this, setup);
}

void CContent::ShowInFileManager(const std::string& path)
{
    gw::ShowInFileManager(path);
}

void CContent::OpenHelpFile(const std::string& path)
{
    gw::OpenHelpFile(path);
}

bool CContent::OpenWebPage(const std::string& address)
{
    return gw::OpenWebPage(address);
}

} // namespace gw
