#pragma once

#include "CMessageFilter.h"

#include <QPoint>
#include <QWidget>
#include <memory>
#include <optional>
#include <string>

namespace gw {

class CContent;
class CGaitConvertContent;
class CLeftKeys;
class CPlatform;
class CProfileEditorWindow;
class CSkin;

/// The main window: a borderless frame around its face, and the conversion. The skin determines its size.
class CGaitConvertFrame : public QWidget
{
public:
    /// Keys and platform must outlive the window.
    CGaitConvertFrame(const CSkin& skin, const CLeftKeys& keys, CPlatform& platform);
    ~CGaitConvertFrame() override;

    CGaitConvertContent& Content() { return *m_spContent; }
    /// Opens a file requested from outside (another start of the program, a drop) as soon as no operation is
    /// running.
    void OpenSoon(const std::string& path);
    /// Raises the window, and opens a file if the path is not empty.
    void RaiseAndOpen(const std::string& path);

protected:
    void closeEvent(QCloseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void dragEnterEvent(QDragEnterEvent* event) override;
    void dropEvent(QDropEvent* event) override;

private:
    void Place(const QSize& size);
    void AddShortcuts();
    void BeginMove(const QPoint& globalPosition);
    void OpenCornerMenu(const QPoint& globalPosition);

    CPlatform& platform_;
    CContent* m_pkFace;
    std::unique_ptr<CGaitConvertContent> m_spContent;
    CProfileEditorWindow* m_pkEditor;
    CMessageFilter m_kFilter;
    std::optional<QPoint> grip_; ///< where the mouse holds the window during a drag
};

} // namespace gw
