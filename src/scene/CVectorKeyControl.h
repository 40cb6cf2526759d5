#pragma once

#include "CControl.h"
#include "KeySpan.h"
#include "Vec3.h"

#include <vector>

namespace gw {

/// Base of controls with one track of vectors. It has no class record: derived classes name CControl as their
/// base.
class CVectorKeyControl : public CControl
{
public:
    void Fields(CFieldArchive& archive) override;
    uint64_t GetMemoryUsed() const override;
    bool UpdateTransform(float) override { return false; }

    std::vector<Vec3> m_kKeys;
    std::vector<float> m_kKeyTimes; ///< ascending, one per key

protected:
    /// Returns whether there are both keys and times.
    bool HasKeys() const { return !m_kKeys.empty() && !m_kKeyTimes.empty(); }
    /// Returns the value at a caller's time; `empty` without keys.
    Vec3 ValueAt(float time, const Vec3& empty);

private:
    KeyCursor m_uiCursor = 0;
};

} // namespace gw
