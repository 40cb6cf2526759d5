// What the face asks of the user and of the desktop around it.

#include "CContent.h"
#include "CGaitConvertContent.h"
#include "QtText.h"
#include "StringTable.h"
#include "Stubs.h"

#include <QFileDialog>
#include <QGuiApplication>

namespace gw {

namespace {

// The arrow in place of the wait cursor, for as long as something is asked in the midst of an operation.
class CArrowCursor
{
public:
    CArrowCursor() { QGuiApplication::setOverrideCursor(Qt::ArrowCursor); }
    ~CArrowCursor() { QGuiApplication::restoreOverrideCursor(); }
    CArrowCursor(const CArrowCursor&) = delete;
    CArrowCursor& operator=(const CArrowCursor&) = delete;
};

// "text|pattern|" pairs as the toolkit names them: "text (pattern)".
QStringList NameFilters(const std::string& filter)
{
    QStringList names;
    const QStringList parts = ToQString(filter).split(QLatin1Char('|'));
    for (qsizetype i = 0; i + 1 < parts.size() && !parts[i].isEmpty(); i += 2)
    {
        const QString text = parts[i].left(parts[i].indexOf(QLatin1Char('('))).trimmed();
        names << text + QStringLiteral(" (") +
                     QString(parts[i + 1]).replace(QLatin1Char(';'), QLatin1Char(' ')) + QLatin1Char(')');
    }
    return names;
}

std::optional<std::string> AskFile(QWidget* owner, const CFileDialogSetup& setup,
                                   QFileDialog::AcceptMode mode)
{
    const CArrowCursor arrow;
    QFileDialog dialog(owner);
    dialog.setAcceptMode(mode);
    dialog.setFileMode(mode == QFileDialog::AcceptOpen ? QFileDialog::ExistingFile : QFileDialog::AnyFile);
    dialog.setNameFilters(NameFilters(setup.filter));
    dialog.setDefaultSuffix(ToQString(setup.defaultExtension));
    if (!setup.initialFolder.empty())
        dialog.setDirectory(ToQString(setup.initialFolder));
    if (dialog.exec() != QDialog::Accepted || dialog.selectedFiles().isEmpty())
        return std::nullopt;
    return ToUtf8(dialog.selectedFiles().constFirst());
}

} // namespace

EAnswer CContent::ShowMessageBox(int, const std::string& text, EButtons buttons)
{
    const CArrowCursor arrow;
    const std::string details = Notes();
    m_kReports.clear(); // they are shown here
    return RunMessageBox(this, m_pkLogic->Message(kTitleMessage), text, buttons, details);
}

std::optional<std::string> CContent::AskOpenFile(const CFileDialogSetup& setup)
{
    return AskFile(this, setup, QFileDialog::AcceptOpen);
}

std::optional<std::string> CContent::AskSaveFile(const CFileDialogSetup& setup)
{
    return AskFile(this, setup, QFileDialog::AcceptSave);
}

std::optional<CFolderChoice> CContent::AskFolder(const CFileDialogSetup& setup)
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
