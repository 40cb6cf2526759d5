#pragma once

#include "CContentWindow.h"

#include <QDialog>

class QComboBox;
class QFileSystemModel;
class QLineEdit;
class QListView;
class QToolButton;

namespace gw {

/// The folder chooser. It lists the subfolders of the open folder and, with a filter, the matching files in
/// gray. The path can be edited.
class CSelectFolderDialog : public QDialog
{
public:
    /// An empty filter shows no files. If the initial folder does not exist, the user's documents folder is
    /// opened.
    CSelectFolderDialog(QWidget* owner, const FileDialogSetup& setup);

    /// Returns the choice, after the dialog has ended with OK.
    FolderChoice Choice() const;

    /// Accepts the text. Asks about a folder that does not exist, and accepts it whatever the answer.
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

/// Asks for a folder. Returns nothing if the dialog was canceled.
std::optional<FolderChoice> AskFolder(QWidget* owner, const FileDialogSetup& setup);

} // namespace gw
