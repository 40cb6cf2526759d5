#pragma once

#include <QPushButton>
#include <cstdint>

namespace gw {

/// The pictures that the map tool's small buttons carry.
enum class EButtonIcon : uint8_t
{
    SeekStart,
    StepBack,
    Stop,
    Play,
    StepForward,
    Menu,
};

/// A push button with a picture in its text's colour, drawn at any scale. What it does is said by its
/// accessible name and its tool tip, which are the same.
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
