#include "PicturePainter.h"

#include "CPicturePainter.h"
#include "Paths.h"

#include <dlfcn.h>

namespace gw {

namespace {

constexpr const char* kModule = "gw_picture_painter.so";

CPicturePainter* OpenPainter()
{
    void* const module = dlopen((ExecutableFolder() + kModule).c_str(), RTLD_NOW | RTLD_LOCAL);
    void* const entry = module ? dlsym(module, kPicturePainterEntry) : nullptr;
    return entry ? reinterpret_cast<CPicturePainterEntry>(entry)() : nullptr;
}

} // namespace

CPicturePainter* LoadPicturePainter()
{
    static CPicturePainter* const painter = OpenPainter();
    return painter;
}

} // namespace gw
