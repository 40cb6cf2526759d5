#pragma once

#include "CContentWindow.h"

#include <QDialog>

class QComboBox;
class QFileSystemModel;
class QLineEdit;
class QListView;
class QToolButton;

namespace gw {

/// The folder chooser. It lists the folders in the one that is open, and with a filter, greyed, the files
/// that it would take; the path of the open folder can be written over.
class CSelectFolderDialog : public QDialog
{
public:
    /// An empty filter shows none. An initial folder that there is not is that of the user's documents.
    CSelectFolderDialog(QWidget* owner, const FileDialogSetup& setup);

    /// What was chosen, once the dialog has ended with OK.
    FolderChoice Choice() const;

    /// Takes the text: asks about a folder that there is not, and takes it whatever the answer.
    void accept() override;

protected:
    void keyPressEvent(QKeyEvent* event) override;

private:
    QLayout* MakePathRow();
    QWidget* MakeList();
    QLayout* MakeFilterRow(const std::string& filter);
    QLayout* MakeButtons();
    void OpenFolder(const QString& path);
    void OpenParent();
    QString FolderThatIsOpen() const;

    QFileSystemModel* m_pkModel;
    QLineEdit* m_pkPath = nullptr;
    QToolButton* m_pkUp = nullptr;
    QListView* m_pkFolders = nullptr;
    QComboBox* m_pkFilter = nullptr; ///< null without a filter
    std::string m_kFolder;
};

/// Asks for a folder; nothing when the dialog was cancelled.
std::optional<FolderChoice> AskFolder(QWidget* owner, const FileDialogSetup& setup);

} // namespace gw
