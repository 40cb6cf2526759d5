#pragma once

#include <QDialog>
#include <array>

class QComboBox;

namespace gw {

class CBoneOffsetDialog;
class CFieldEdit;
class CGaitConvertContent;

/// The dialog window for the rotation and axes of one row.
class CBoneOffsetWindow : public QDialog
{
public:
    /// `content` provides the field names. `dialog` holds the numbers and must outlive the window.
    CBoneOffsetWindow(const CGaitConvertContent& content, CBoneOffsetDialog& dialog, QWidget* owner);

    void accept() override;

private:
    static constexpr int kAxisCount = 3;

    QWidget* MakePair();
    QLayout* MakeNumbers(const CGaitConvertContent& content);
    CFieldEdit* MakeRotation(int axis);
    QComboBox* MakeAxis(int axis);
    QLayout* MakeButtons();
    void LeaveRotation(int axis);
    void ShowAxes();

    CBoneOffsetDialog& dialog_;
    std::array<CFieldEdit*, kAxisCount> m_pkRotation{};
    std::array<QComboBox*, kAxisCount> m_pkAxis{};
};

} // namespace gw
