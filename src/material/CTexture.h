#pragma once

#include "CMaterialBase.h"

namespace gw {

/// The base of what fills a channel of a material. A texture is a material so that it can be two-sided too.
class CTexture : public CMaterialBase
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }

protected:
    CTexture() = default;
    CTexture(const CTexture& source) = default;
};

/// Known by name only: no such object is ever made, and a file that holds one ends there.
class CMultiTex : public CTexture
{
public:
    static const CRTTI ms_kRTTI;

    CMultiTex() = delete;
};

/// The same.
class CBlendTex : public CTexture
{
public:
    static const CRTTI ms_kRTTI;

    CBlendTex() = delete;
};

} // namespace gw
