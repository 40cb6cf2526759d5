#pragma once

#include "CMaterialBase.h"
#include "CTexture.h"
#include "Vec3.h"

#include <array>

namespace gw {

/// What a texture of a standard material controls: its index in m_aspkTexture.
enum ETextureChannel : uint8_t
{
    TT_Ambient,
    TT_Diffuse,
    TT_Specular,
    TT_Shininess,
    TT_ShininessStrength,
    TT_SelfIllumination,
    TT_Opacity,
    TT_FilterColor,
    TT_Bump,
    TT_Reflection,
    TT_Refraction,
    TT_Displacement,
};
inline constexpr size_t kTextureChannels = 12;

/// A leaf of the material tree: colors, parameters, and one texture per channel.
class CStandardMaterial : public CMaterial
{
public:
    static const CRTTI ms_kRTTI;

    CStandardMaterial();
    CStandardMaterial(const CStandardMaterial& source);
    ~CStandardMaterial() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    void DumpTable(CHTMLTables& tables) override;
    uint64_t GetMemoryUsed() const override;

    Vec3 m_kAmbient{0.2f, 0.2f, 0.2f};
    Vec3 m_kDiffuse{0.8f, 0.0f, 0.0f}; ///< red instead of gray, on purpose
    Vec3 m_kSpecular{0.5f, 0.5f, 0.5f};
    Vec3 m_kFilter{0.0f, 0.0f, 0.0f};
    float m_fShininess = 0.5f;
    float m_fShineStrength = 1.0f;
    float m_fSelfIllum = 0.0f;
    float m_fOpacity = 1.0f;
    float m_fOpfall = 0.0f;
    float m_fWireSize = 0.0f;
    float m_fIORefract = 0.0f;
    float m_fDimIntens = 0.0f;
    float m_fDimMult = 0.0f;
    float m_fSoftThresh = 0.0f;
    std::array<Held<CTexture>, kTextureChannels> m_aspkTexture; ///< by channel; entries may be null
};

} // namespace gw
