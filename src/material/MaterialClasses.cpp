#include "CAnmImage.h"
#include "CAnmImageControl.h"
#include "CBlendMaterial.h"
#include "CFactoryMap.h"
#include "CImage.h"
#include "CMaterialBase.h"
#include "CMultiMaterial.h"
#include "CNormalBumpTex.h"
#include "COrrinStream.h"
#include "CSprite.h"
#include "CStandardMaterial.h"
#include "CTextureMap.h"

namespace gw {
namespace {

constexpr FactoryRow kClasses[] = {
    {&CMaterialBase::ms_kRTTI,     MakeNothing                  },
    {&CMaterial::ms_kRTTI,         MakeNothing                  },
    {&CStandardMaterial::ms_kRTTI, MakeObject<CStandardMaterial>},
    {&CBlendMaterial::ms_kRTTI,    MakeObject<CBlendMaterial>   },
    {&CMultiMaterial::ms_kRTTI,    MakeObject<CMultiMaterial>   },
    {&CTexture::ms_kRTTI,          MakeNothing                  },
    {&CTextureMap::ms_kRTTI,       MakeObject<CTextureMap>      },
    {&CBlendTex::ms_kRTTI,         MakeNothing                  },
    {&CMultiTex::ms_kRTTI,         MakeNothing                  },
    {&CImage::ms_kRTTI,            MakeObject<CImage>           },
    {&CAnmImage::ms_kRTTI,         MakeObject<CAnmImage>        },
    {&CAnmImageControl::ms_kRTTI,  MakeObject<CAnmImageControl> },
    {&CSprite::ms_kRTTI,           MakeObject<CSprite>          },
    {&CNormalBumpTex::ms_kRTTI,    MakeObject<CNormalBumpTex>   },
};

} // namespace

extern "C" {
// The linker requires this name, so the table is part of every program that links this room.
extern const int gw_material_classes;
const int gw_material_classes = RegisterClasses(kClasses);
}

} // namespace gw
