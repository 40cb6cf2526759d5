#include "CBoneSkinControl.h"
#include "CConnectControl.h"
#include "CConnectData.h"
#include "CEditNormalControl.h"
#include "CEditNormalData.h"
#include "CFactoryMap.h"
#include "CMeshSelControl.h"
#include "CMorphControl.h"
#include "COrrinStream.h"
#include "CParticleControl.h"
#include "CParticles.h"
#include "CShape.h"
#include "CSkinBoneControl.h"
#include "CTriMesh.h"
#include "CTriMeshUVWMap.h"
#include "CTriMeshUVWMapControl.h"

namespace gw {
namespace {

// The bone meshes are left out on purpose: they can be written, but a file that contains one cannot be read
// back.
constexpr FactoryRow kClasses[] = {
    {&CGeometry::ms_kRTTI,             MakeNothing                      },
    {&CTriMesh::ms_kRTTI,              MakeObject<CTriMesh>             },
    {&CTriMeshUVWMap::ms_kRTTI,        MakeObject<CTriMeshUVWMap>       },
    {&CShape::ms_kRTTI,                MakeNothing                      },
    {&CRectangle::ms_kRTTI,            MakeObject<CRectangle>           },
    {&CCircle::ms_kRTTI,               MakeObject<CCircle>              },
    {&CLine::ms_kRTTI,                 MakeObject<CLine>                },
    {&CParticles::ms_kRTTI,            MakeObject<CParticles>           },
    {&CSkinBoneControl::ms_kRTTI,      MakeObject<CSkinBoneControl>     },
    {&CBoneSkinControl::ms_kRTTI,      MakeObject<CBoneSkinControl>     },
    {&CMorphControl::ms_kRTTI,         MakeObject<CMorphControl>        },
    {&CEditNormalControl::ms_kRTTI,    MakeObject<CEditNormalControl>   },
    {&CEditNormalData::ms_kRTTI,       MakeObject<CEditNormalData>      },
    {&CConnectControl::ms_kRTTI,       MakeObject<CConnectControl>      },
    {&CConnectData::ms_kRTTI,          MakeObject<CConnectData>         },
    {&CMeshSelControl::ms_kRTTI,       MakeObject<CMeshSelControl>      },
    {&CParticleControl::ms_kRTTI,      MakeObject<CParticleControl>     },
    {&CTriMeshUVWMapControl::ms_kRTTI, MakeObject<CTriMeshUVWMapControl>},
};

} // namespace

extern "C" {
// The linker requires this name, so the table is part of every program that links this room.
extern const int gw_geometry_classes;
const int gw_geometry_classes = RegisterClasses(kClasses);
}

} // namespace gw
