#pragma once

namespace gw {

/// Limits what this process can still do: memory and computing time are bounded, and it can create no file,
/// process or connection. Returns false if the system refuses one of the limits.
bool EnterSandbox();

} // namespace gw
