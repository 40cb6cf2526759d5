#pragma once

#include "CContentWindow.h"
#include "HeldLeftKeys.h"

#include <QObject>
#include <functional>
#include <set>

namespace gw {

/// Tracks which left modifier keys are down, because the toolkit's modifiers do not distinguish left from
/// right. Keys are tracked by the program's keyboard events in all windows. Each click verifies them, since a
/// key may have been pressed or released while another program had the keyboard.
class CLeftKeys : public QObject
{
public:
    /// Returns the left keys that are down right now, whichever program has the keyboard.
    using Query = std::function<std::set<EKey>()>;

    /// Filters every event of the application, which must exist.
    explicit CLeftKeys(Query query = HeldLeftKeys, QObject* parent = nullptr);

    bool IsDown(EKey key) const { return m_kDown.contains(key); }

    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void Check(EKey key, bool isModified);

    Query m_kQuery;
    std::set<EKey> m_kDown;
};

} // namespace gw
