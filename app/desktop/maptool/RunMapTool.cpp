#include "RunMapTool.h"

#include "CGaitToolWindow.h"

namespace gw {

int RunMapTool(CPlatform& platform, const CLeftKeys& keys)
{
    CGaitToolWindow window(platform, keys);
    window.exec();
    return 0;
}

} // namespace gw
