#pragma once

#include "CObject.h"
#include "Watch.h"

namespace gw {

/// How a control's time continues outside its range. Any unnamed value acts as Reverse.
enum class ECycleType : uint32_t
{
    Clamp,
    Loop,
    Reverse,
};

/// An object that changes another object over time. The caller's time is converted to a key time by
/// frequency, phase and cycle type.
class CControl : public CObject
{
public:
    static const CRTTI ms_kRTTI;

    CControl();
    CControl(const CControl& source);
    ~CControl() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    void Fields(CFieldArchive& archive) override;
    uint64_t GetMemoryUsed() const override;

    /// Returns the controlled object, or null. The pointer does not keep it alive and becomes null when it
    /// dies.
    CObject* GetTarget() const { return m_pkTarget.Get(); }
    virtual void SetTarget(CObject* target) { m_pkTarget.Set(target); }
    /// Updates the target's transform. Returns true if it was written.
    virtual bool UpdateTransform(float time) = 0;
    bool Update(float time) override = 0;
    /// Updates without regard to the range.
    bool UpdateRange(uint32_t range, float time) override;

    CControl* GetNext() const { return m_spkNext.Get(); }
    void SetNext(CControl* next) { m_spkNext = next; }
    /// Returns the last control of the chain that starts here.
    CControl* GetLast();

    /// Converts a caller's time to a key time: time x frequency + phase, mapped into the range by the cycle
    /// type. A NaN becomes the begin time.
    float MapTime(float time) const;

    uint32_t m_iCycleType = 0; ///< ECycleType, as stored
    float m_fFrequency = 1.0f; ///< multiplies the caller's time; motions store the frame time in seconds here
    float m_fBeginTime = 0.0f;
    float m_fEndTime = 0.0f;
    float m_fPhase = 0.0f; ///< added after the multiplication
    bool m_bActive = true; ///< an inactive control does not animate

protected:
    void CloneHeld(CCloneMap& map, CObject& copy) override;

private:
    float CycledTime(float s) const;

    Watch<CObject> m_pkTarget;
    Held<CControl> m_spkNext;
};

/// The class that links of a modifier chain must have. It has no concrete classes, so no such object exists.
class CModifier : public CControl
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
};

} // namespace gw
