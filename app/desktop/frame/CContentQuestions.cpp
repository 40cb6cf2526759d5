// The face's questions to the user, and its use of the desktop environment.

#include "CContent.h"
#include "CGaitConvertContent.h"
#include "CMessageBox.h"
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
    const std::string details = m_iWaits > 0 && EndsStep(id) ? Notes() : std::string();
    return RunMessageBox(this, m_pkLogic->Message(kTitleMessage), text, buttons, details);
}

void CContent::ShowNotes()
{
    RunMessageBox(this, m_pkLogic->Message(kTitleMessage),
                  ToUtf8(QCoreApplication::translate("Face", "Warnings from the last step")), EButtons::OK,
                  Notes(), EDetails::Unfolded);
}

std::optional<std::string> CContent::AskOpenFile(const FileDialogSetup& setup)
{
    const CArrowCursor arrow;
    return RunFileDialog(*this, QFileDialog::AcceptOpen, setup);
}

std::optional<std::string> CContent::AskSaveFile(const FileDialogSetup& setup)
{
    const CArrowCursor arrow;
    return RunFileDialog(*this, QFileDialog::AcceptSave, setup);
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
