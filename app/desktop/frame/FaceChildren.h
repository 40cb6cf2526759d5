#pragma once

#include "CSkin.h"

#include <QPushButton>

namespace gw {

class CLeftKeys;

/// A button of the face with one picture per state. Enter clicks it, because the space bar plays.
class CFaceButton : public QPushButton
{
public:
    CFaceButton(const SkinChild& child, const CSkin& skin, QWidget* face);

    /// Shows the first picture for 0, otherwise the second.
    void SetFace(int face) { setIcon(face == 0 ? m_kFirst : m_kSecond); }

protected:
    void keyPressEvent(QKeyEvent* event) override;

private:
    QIcon m_kFirst;
    QIcon m_kSecond;
};

/// Creates the widget of a child with name, position and texts. The face owns it.
QWidget* MakeFaceChild(const SkinChild& child, const CSkin& skin, const CLeftKeys& keys, QWidget* face);

} // namespace gw
