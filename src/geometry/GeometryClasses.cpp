#include "CFactoryMap.h"
#include "COrrinStream.h"
#include "CTriMesh.h"
#include "CTriMeshUVWMap.h"

namespace gw {
namespace {

// The bone meshes are absent on purpose: they can be written, and a file that holds one cannot be read back.
constexpr CFactoryRow kClasses[] = {
    {&CGeometry::ms_kRTTI,      MakeNothing               },
    {&CTriMesh::ms_kRTTI,       MakeObject<CTriMesh>      },
    {&CTriMeshUVWMap::ms_kRTTI, MakeObject<CTriMeshUVWMap>},
};

} // namespace

extern "C" {
// The linker is told to want this name, so that the table is part of every program that links the room.
extern const int gw_geometry_classes;
const int gw_geometry_classes = RegisterClasses(kClasses);
}

} // namespace gw
