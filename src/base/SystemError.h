#pragma once

#include <string>

namespace gw {

// The system's reason for the last failed call on a file. Unlike errno, it survives the clean-up after the
// failure. Code that calls the system keeps the reason, and code that records or reports the failure takes
// it.

/// Keeps a code of errno until it is taken. Without an argument, keeps errno itself.
void KeepSystemError();
void KeepSystemError(int code);
/// Forgets a reason that was kept, because a new operation begins.
void ForgetSystemError();
/// Returns the code that was kept, or 0, and forgets it.
int TakeSystemError();

/// Returns ": No space left on device" for a code of errno; empty for 0.
std::string SystemErrorWords(int code);
/// Same for the code that was kept, which is then forgotten.
std::string TakeSystemErrorWords();

} // namespace gw
