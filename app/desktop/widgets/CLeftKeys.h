#pragma once

#include "CContentWindow.h"
#include "HeldLeftKeys.h"

#include <QObject>
#include <functional>
#include <set>

namespace gw {

/// Which of the left modifier keys are down: the toolkit's own modifiers do not distinguish left from right.
/// Keys follow the program's keyboard events, from window to window. Each click checks them, since a key may
/// have been pressed or released while another program had the keyboard.
class CLeftKeys : public QObject
{
public:
    /// Returns the left keys that are down right now, whoever has the keyboard.
    using Query = std::function<std::set<EKey>()>;

    /// Watches every event of the application, which must exist.
    explicit CLeftKeys(Query query = HeldLeftKeys, QObject* parent = nullptr);

    bool IsDown(EKey key) const { return m_kDown.contains(key); }

    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void Check(EKey key, bool isModified);

    Query m_kQuery;
    std::set<EKey> m_kDown;
};

} // namespace gw
