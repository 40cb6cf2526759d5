#pragma once

#include <QPushButton>
#include <cstdint>

namespace gw {

/// The pictures on the map tool's small buttons.
enum class EButtonIcon : uint8_t
{
    SeekStart,
    StepBack,
    Stop,
    Play,
    StepForward,
    Menu,
};

/// A push button with a picture in its text color, drawn at any scale. Its accessible name, also used as tool
/// tip, describes it.
class CIconButton : public QPushButton
{
public:
    CIconButton(EButtonIcon icon, const QString& name, QWidget* parent);

    QSize sizeHint() const override;
    QSize minimumSizeHint() const override { return sizeHint(); }

protected:
    void paintEvent(QPaintEvent* event) override;

private:
    EButtonIcon m_eIcon;
};

} // namespace gw
