#pragma once

#include "CToolWindow.h"

#include <QWidget>
#include <functional>
#include <memory>

class QLabel;
class QLayout;

namespace gw {

class CLeftKeys;
class CPreviewWidget;

/// One of the map tool's three previews: caption, picture, five transport buttons. Motion files can be
/// dropped on it.
class CMotionPanel : public QWidget
{
public:
    /// `keys` must outlive the panel.
    CMotionPanel(EToolMotion motion, const CLeftKeys& keys, QWidget* parent);

    /// Creates a view. Without GL, the view draws nothing.
    std::unique_ptr<CMotionView> MakeView();
    void ShowFrame(int frame, int lastFrame);
    /// Sets the function to call with the id of a clicked transport button.
    void SetClicked(std::function<void(int id)> clicked) { clicked_ = std::move(clicked); }
    /// Called with the bone that was clicked in the picture.
    void SetBoneClicked(std::function<void(const std::string& bone)> clicked);
    /// Called with a dropped motion file. If not set, nothing can be dropped.
    void SetDropped(std::function<void(const QString& path)> dropped);

protected:
    void dragEnterEvent(QDragEnterEvent* event) override;
    void dropEvent(QDropEvent* event) override;

private:
    QLayout* MakeCaption();
    QWidget* MakePicture(const CLeftKeys& keys);
    QLayout* MakeTransport();

    EToolMotion m_eMotion;
    QLabel* m_pkFrame = nullptr;
    CPreviewWidget* m_pkPreview = nullptr;
    std::function<void(int)> clicked_;
    std::function<void(const QString&)> dropped_;
};

} // namespace gw
