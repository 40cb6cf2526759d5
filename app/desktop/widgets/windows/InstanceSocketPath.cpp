#include "CInstanceServer.h"

namespace gw {

// A named pipe of the user; the system keeps those of other sessions apart by the name.
QString InstanceSocketPath()
{
    return QStringLiteral("TK_KESTRO_GAIT_CONV_1-") + qEnvironmentVariable("USERNAME");
}

} // namespace gw
