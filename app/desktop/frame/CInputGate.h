#pragma once

#include <QObject>

namespace gw {

/// While it exists, the program ignores keys, clicks and drops, so that painting during an operation starts
/// nothing else. Modifier keys pass, because their state is followed elsewhere. Remembers whether Escape was
/// pressed.
class CInputGate : public QObject
{
public:
    CInputGate();

    bool WasEscapePressed() const { return m_bEscape; }

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    bool m_bEscape = false;
};

} // namespace gw
