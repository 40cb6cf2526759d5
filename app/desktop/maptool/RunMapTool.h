#pragma once

namespace gw {

class CLeftKeys;
class CPlatform;

/// Shows the map tool as the program's only window until it is closed. The application must exist. Returns
/// its exit code.
int RunMapTool(CPlatform& platform, const CLeftKeys& keys);

} // namespace gw
