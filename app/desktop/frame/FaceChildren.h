#pragma once

#include "CSkin.h"

#include <QPushButton>

namespace gw {

class CLeftKeys;

/// A button of the face with a picture for each of its two faces. Enter clicks it: the space bar plays.
class CFaceButton : public QPushButton
{
public:
    CFaceButton(const SkinChild& child, const CSkin& skin, QWidget* face);

    /// 0 is the first picture, anything else the second one.
    void SetFace(int face) { setIcon(face == 0 ? m_kFirst : m_kSecond); }

protected:
    void keyPressEvent(QKeyEvent* event) override;

private:
    QIcon m_kFirst;
    QIcon m_kSecond;
};

/// Makes the widget of a child, named, placed and with its texts. The face owns it.
QWidget* MakeFaceChild(const SkinChild& child, const CSkin& skin, const CLeftKeys& keys, QWidget* face);

} // namespace gw
