#pragma once

#include "CContentWindow.h"

#include <QObject>
#include <set>

namespace gw {

/// Which of the left modifier keys are down: the toolkit's own modifiers do not tell left from right. Keys
/// count from the program's keyboard events only, and none counts once the program has lost the keyboard.
class CLeftKeys : public QObject
{
public:
    /// Watches every event of the application, which must exist.
    explicit CLeftKeys(QObject* parent = nullptr);

    bool IsDown(EKey key) const { return m_kDown.contains(key); }

    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    std::set<EKey> m_kDown;
};

} // namespace gw
