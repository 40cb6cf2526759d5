#pragma once

#include "CControl.h"
#include "KeySpan.h"
#include "Vec3.h"

#include <vector>

namespace gw {

/// What controls with one track of vectors share. It has no class record of its own: those derived from it
/// name CControl as their base.
class CVectorKeyControl : public CControl
{
public:
    void Fields(CFieldArchive& archive) override;
    uint64_t GetMemoryUsed() const override;
    bool UpdateTransform(float) override { return false; }

    std::vector<Vec3> m_kKeys;
    std::vector<float> m_kKeyTimes; ///< ascending, one for each key

protected:
    /// Keys without times, or times without keys, count as none.
    bool HasKeys() const { return !m_kKeys.empty() && !m_kKeyTimes.empty(); }
    /// The value at a caller's time; `empty` where there are no keys.
    Vec3 ValueAt(float time, const Vec3& empty);

private:
    KeyCursor m_uiCursor = 0;
};

} // namespace gw
