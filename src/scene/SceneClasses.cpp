#include "CCamera.h"
#include "CCameraControl.h"
#include "CCustomData.h"
#include "CFactoryMap.h"
#include "CKeyframeClipControl.h"
#include "CLight.h"
#include "CLightControl.h"
#include "CNode.h"
#include "COrrinStream.h"

namespace gw {
namespace {

constexpr FactoryRow kClasses[] = {
    {&CObject::ms_kRTTI,              MakeNothing                     },
    {&CSpatial::ms_kRTTI,             MakeNothing                     },
    {&CNode::ms_kRTTI,                MakeObject<CNode>               },
    {&CLight::ms_kRTTI,               MakeNothing                     },
    {&CPointLight::ms_kRTTI,          MakeObject<CPointLight>         },
    {&CRenderState::ms_kRTTI,         MakeNothing                     },
    {&CCamera::ms_kRTTI,              MakeObject<CCamera>             },
    {&CCameraTarget::ms_kRTTI,        MakeObject<CCameraTarget>       },
    {&CControl::ms_kRTTI,             MakeNothing                     },
    {&CKeyframeControl::ms_kRTTI,     MakeObject<CKeyframeControl>    },
    {&CKeyframeClipControl::ms_kRTTI, MakeObject<CKeyframeClipControl>},
    {&CLightControl::ms_kRTTI,        MakeObject<CLightControl>       },
    {&CCameraControl::ms_kRTTI,       MakeObject<CCameraControl>      },
    {&CModifier::ms_kRTTI,            MakeNothing                     },
    {&CBillboardNode::ms_kRTTI,       MakeObject<CBillboardNode>      },
    {&CCustomData::ms_kRTTI,          MakeNothing                     },
    {&CRawData::ms_kRTTI,             MakeObject<CRawData>            },
    {&CAuthorInfo::ms_kRTTI,          MakeObject<CAuthorInfo>         },
};

} // namespace

extern "C" {
// The linker requires this name, so the table is part of every program that links this room.
extern const int gw_scene_classes;
const int gw_scene_classes = RegisterClasses(kClasses);
}

} // namespace gw
