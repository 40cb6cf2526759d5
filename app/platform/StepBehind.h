#pragma once

namespace gw {

/// Leaves the processor to everything else from now on, as far as the calling thread is concerned. If the
/// system refuses, the thread goes on as it was.
void StepBehind();

} // namespace gw
