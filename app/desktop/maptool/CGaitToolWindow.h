#pragma once

#include "CGaitToolDialog.h"

#include <QDialog>
#include <QStringListModel>
#include <QTimer>
#include <array>
#include <functional>
#include <initializer_list>
#include <vector>

class QGridLayout;
class QLabel;
class QListView;
class QMenu;
class QPushButton;

namespace gw {

class CBoneTreeView;
class CLeftKeys;
class CMotionPanel;

/// The window of the map tool: shows the tool's state and forwards user actions.
class CGaitToolWindow : public QDialog, private CToolWindow
{
public:
    /// Both arguments must outlive the window.
    CGaitToolWindow(const CPlatform& platform, const CLeftKeys& keys);
    ~CGaitToolWindow() override;

    const CGaitToolDialog& Tool() const { return m_kTool; }

protected:
    void contextMenuEvent(QContextMenuEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;

private:
    std::optional<std::string> AskOpenFile(const FileDialogSetup& setup) override;
    std::optional<std::string> AskSaveFile(const FileDialogSetup& setup) override;
    bool EditLine(MapLine& line) override;
    std::unique_ptr<CMotionView> CreateView(EToolMotion motion) override;
    void CloseWindow() override { accept(); }
    void BeginWaitCursor() override;
    void EndWaitCursor() override;

    // Defined in ToolLayout.cpp.
    void MakeMenu();
    void MakeLayout(const CLeftKeys& keys);
    void MakeTop(QGridLayout& grid);
    void MakePanels(QGridLayout& grid, const CLeftKeys& keys);
    void MakeTrees(QGridLayout& grid);
    void MakeLines(QGridLayout& grid);
    void MakeStatus(QGridLayout& grid);
    QLayout* MakeButtons(std::initializer_list<int> ids);
    QPushButton* MakeButton(int id);
    CMotionPanel& Panel(EToolMotion motion) { return *m_kPanels[static_cast<size_t>(motion)]; }

    /// Runs an operation of the tool and shows its outcome.
    void Forward(const std::function<void()>& operation);
    void SelectLine(const QModelIndex& line);
    void Click(int id);
    void ClickBone(EToolMotion motion, const std::string& bone);
    void Tick();
    void Refresh();
    void ShowFrames();
    void ShowLines();

    std::array<CMotionPanel*, 3> m_kPanels{};
    CBoneTreeView* m_pkSourceTree = nullptr;
    CBoneTreeView* m_pkTargetTree = nullptr;
    QListView* m_pkLines = nullptr;
    QLabel* m_pkStatus = nullptr;
    QMenu* m_pkMenu = nullptr;
    QStringListModel m_kLineTexts;
    std::vector<QPushButton*> m_kButtons;
    QTimer m_kClock;
    bool m_bShowing = false; // the tool's state is being shown
    CGaitToolDialog m_kTool; // last, because its views may draw on the panels until they are destroyed
};

} // namespace gw
