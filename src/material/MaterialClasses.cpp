#include "CFactoryMap.h"
#include "CMaterialBase.h"

namespace gw {
namespace {

constexpr CFactoryRow kClasses[] = {
    {&CMaterialBase::ms_kRTTI, MakeNothing},
    {&CMaterial::ms_kRTTI,     MakeNothing},
};

} // namespace

extern "C" {
// The linker is told to want this name, so that the table is part of every program that links the room.
extern const int gw_material_classes;
const int gw_material_classes = RegisterClasses(kClasses);
}

} // namespace gw
