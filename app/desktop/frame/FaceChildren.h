#pragma once

#include "CPushButton.h"
#include "CSkin.h"

namespace gw {

class CLeftKeys;

/// A button of the face with one picture per state.
class CFaceButton : public CPushButton
{
public:
    CFaceButton(const SkinChild& child, const CSkin& skin, QWidget* face);

    /// Shows the first picture for 0, otherwise the second.
    void SetFace(int face) { setIcon(face == 0 ? m_kFirst : m_kSecond); }

private:
    QIcon m_kFirst;
    QIcon m_kSecond;
};

/// Creates the widget of a child with name, position and texts. The face owns it.
QWidget* MakeFaceChild(const SkinChild& child, const CSkin& skin, const CLeftKeys& keys, QWidget* face);

} // namespace gw
