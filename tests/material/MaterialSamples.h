#pragma once

#include "CAnmImage.h"
#include "CBlendMaterial.h"
#include "CImage.h"
#include "CMultiMaterial.h"
#include "CNormalBumpTex.h"
#include "CStandardMaterial.h"
#include "CTextureMap.h"

#include <algorithm>
#include <cstring>

namespace gw {

/// Returns an image stored as plain pixels, all different.
inline Ref<CImage> PlainImage(const char* name, int32_t format = 0,
                              EPixelStorage storage = EPixelStorage::Heap)
{
    Ref<CImage> image = new CImage;
    image->SetName(name);
    image->m_bJPEG = false;
    CPixelBuffer& pixels = image->Pixels();
    pixels.SetStorage(storage);
    pixels.SetRowAlignment(true);
    pixels.SetResolution(72, 300);
    pixels.Create(3, 2, format);
    uint8_t value = 0;
    const CPixelLock lock(pixels);
    for (uint8_t& byte : lock.Bytes())
        byte = ++value;
    return image;
}

/// Returns a texture with an image of the same name.
inline Ref<CTextureMap> MapOf(CImage* image)
{
    Ref<CTextureMap> map = new CTextureMap;
    map->SetName(image->GetName());
    map->m_iUVWChannel = 3;
    map->m_spkImage = image;
    return map;
}

/// Returns a graph with each kind of material and texture, shared images in both kinds of
/// storage, and a material blended with itself.
inline Ref<CObject> SampleMaterial(EPixelStorage bricksStorage = EPixelStorage::TempStore)
{
    const Ref<CImage> wood = PlainImage("wood");
    const Ref<CStandardMaterial> material = new CStandardMaterial;
    const Ref<CNormalBumpTex> bump = new CNormalBumpTex;
    bump->m_bUseFirstMap = false;
    bump->m_fSecondAmount = 2.0f;
    bump->m_spkFirstMap = MapOf(wood.Get()).Get();
    bump->m_spkSecondMap = MapOf(PlainImage("bricks", 1, bricksStorage).Get()).Get();
    material->m_aspkTexture[TT_Diffuse] = MapOf(wood.Get()).Get();
    material->m_aspkTexture[TT_Bump] = bump.Get();

    const Ref<CBlendMaterial> blend = new CBlendMaterial;
    blend->m_fBlend = 0.5f;
    blend->m_aspkMtl[0] = new CStandardMaterial;
    blend->m_aspkMtl[1] = blend->m_aspkMtl[0].Get();
    Ref<CMultiMaterial> multi = new CMultiMaterial;
    multi->SetSubMaterialCount(3);
    multi->m_kSubMaterials[0] = material.Get();
    multi->m_kSubMaterials[1] = blend.Get();
    return multi.Get();
}

/// Returns a picture of 16 x 8 pixels, blue on the left and orange on the right, which JPEG preserves well.
inline Ref<CImage> Halves(int32_t format = 0)
{
    const uint8_t blue[4] = {250, 20, 10, 255};
    const uint8_t orange[4] = {10, 120, 240, 255};
    Ref<CImage> image = new CImage;
    CPixelBuffer& pixels = image->Pixels();
    pixels.Create(16, 8, format, blue);
    const auto bytes = static_cast<size_t>(pixels.GetBytesPerPixel());
    const CPixelLock lock(pixels);
    for (int32_t i = 0; i < 64; ++i)
        std::memcpy(lock.Row(i / 8) + static_cast<size_t>(8 + i % 8) * bytes, orange, bytes);
    return image;
}

inline bool ShowsHalves(CImage& image, int tolerance)
{
    const CPixelBuffer& pixels = image.Pixels();
    const CPixelView view(pixels);
    if (pixels.GetWidth() != 16 || pixels.GetHeight() != 8 || pixels.GetFormat() != 0)
        return false;
    const auto isNear = [&](int32_t x, std::initializer_list<int> color) {
        const uint8_t* byte = view.Row(5) + std::ptrdiff_t{4} * x;
        return std::ranges::all_of(color, [&](int c) { return std::abs(*byte++ - c) <= tolerance; });
    };
    return isNear(2, {250, 20, 10, 255}) && isNear(13, {10, 120, 240, 255});
}

} // namespace gw
