#pragma once
#include "CContentWindow.h"
#include "CMessageBox.h"
#include "QtText.h"
#include <QDesktopServices>
#include <QFileDialog>
#include <QUrl>
namespace gw {
inline void ShowInFileManager(const std::string&) {}
inline void OpenHelpFile(const std::string&) {}
inline bool OpenWebPage(const std::string& a)
{
    return QDesktopServices::openUrl(QUrl(ToQString(a)));
}
} // namespace gw
