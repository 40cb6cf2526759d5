#include "RunMapTool.h"

namespace gw {

int RunMapTool(CPlatform&, const CLeftKeys&)
{
    return 0;
}

} // namespace gw
