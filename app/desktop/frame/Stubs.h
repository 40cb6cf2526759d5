#pragma once
#include "CContentWindow.h"
#include "CMessageBox.h"
#include "QtText.h"
#include <QDesktopServices>
#include <QFileDialog>
#include <QUrl>
namespace gw {
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
