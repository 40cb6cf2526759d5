#include "WritePng.h"

#include "CPicturePainter.h"
#include "CSafeFile.h"
#include "PicturePainter.h"

#include <span>

namespace gw {

bool WritePng(const std::string& path, const RgbPicture& picture)
{
    CPicturePainter* const painter = LoadPicturePainter();
    if (!painter)
        return false;
    const std::vector<std::byte> bytes = painter->EncodePng(picture);
    CSafeFile file;
    return !bytes.empty() && file.Open(path) && file.Write(std::span(bytes)) && file.Commit();
}

} // namespace gw
