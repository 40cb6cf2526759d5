#pragma once

#include "CMaterialBase.h"

namespace gw {

/// Base of whatever fills a channel of a material. It derives from the material base so that it can be
/// two-sided.
class CTexture : public CMaterialBase
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }

protected:
    CTexture() = default;
    CTexture(const CTexture& source) = default;
};

/// Known by name only: such objects are never created, and reading a file stops at one.
class CMultiTex : public CTexture
{
public:
    static const CRTTI ms_kRTTI;

    CMultiTex() = delete;
};

/// Same as CMultiTex.
class CBlendTex : public CTexture
{
public:
    static const CRTTI ms_kRTTI;

    CBlendTex() = delete;
};

} // namespace gw
