#pragma once
#include "CContentWindow.h"
#include "QtText.h"
#include <QDesktopServices>
#include <QFileDialog>
#include <QMessageBox>
#include <QUrl>
namespace gw {
inline EAnswer RunMessageBox(QWidget* o, const std::string& c, const std::string& t, EButtons b,
                             const std::string& d = {})
{
    QMessageBox box(QMessageBox::NoIcon, ToQString(c), ToQString(t), QMessageBox::NoButton, o);
    if (b == EButtons::OK || b == EButtons::OKCancel)
        box.addButton(QMessageBox::Ok);
    else
    {
        box.addButton(QMessageBox::Yes);
        box.addButton(QMessageBox::No);
    }
    if (b == EButtons::OKCancel || b == EButtons::YesNoCancel)
        box.addButton(QMessageBox::Cancel);
    if (!d.empty())
        box.setDetailedText(ToQString(d));
    switch (box.exec())
    {
    case QMessageBox::Ok:
        return EAnswer::OK;
    case QMessageBox::Yes:
        return EAnswer::Yes;
    case QMessageBox::No:
        return EAnswer::No;
    default:
        return EAnswer::Cancel;
    }
}
inline std::optional<CFolderChoice> AskFolder(QWidget* o, const CFileDialogSetup& s)
{
    auto d = QFileDialog::getExistingDirectory(o, {}, ToQString(s.initialFolder));
    if (d.isEmpty())
        return std::nullopt;
    return CFolderChoice{ToUtf8(d) + "/", 1};
}
inline void ShowInFileManager(const std::string&) {}
inline void OpenHelpFile(const std::string&) {}
inline bool OpenWebPage(const std::string& a)
{
    return QDesktopServices::openUrl(QUrl(ToQString(a)));
}
} // namespace gw
