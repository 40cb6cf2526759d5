#pragma once

#include "CControl.h"
#include "KeySpan.h"

namespace gw {

class CAnmImage;
class CImage;

/// Plays a film on its target, an image: each frame is drawn at its position when its time comes.
class CAnmImageControl : public CControl
{
public:
    static const CRTTI ms_kRTTI;

    CAnmImageControl();
    CAnmImageControl(const CAnmImageControl& source);
    ~CAnmImageControl() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    uint64_t GetMemoryUsed() const override;
    /// Times are in milliseconds. Returns false if it is inactive, has no film, or its target is not an
    /// image.
    bool Update(float time) override;
    bool UpdateTransform(float) override { return false; }

    CAnmImage* GetFilm() const { return m_spkAnmImage.Get(); }
    void SetFilm(CAnmImage* film);

private:
    Held<CAnmImage> m_spkAnmImage;
    KeyCursor m_uiCursor = 0;
};

} // namespace gw
