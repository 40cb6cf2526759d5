#include "PicturePainter.h"

#include "CPicturePainter.h"
#include "Processes.h"

namespace gw {

namespace {

CPicturePainter* OpenPainter()
{
    void* const entry = ModuleEntry("gw_picture_painter", kPicturePainterEntry);
    return entry ? reinterpret_cast<CPicturePainterEntry>(entry)() : nullptr;
}

} // namespace

CPicturePainter* LoadPicturePainter()
{
    static CPicturePainter* const painter = OpenPainter();
    return painter;
}

} // namespace gw
