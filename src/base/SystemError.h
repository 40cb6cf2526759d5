#pragma once

#include <string>

namespace gw {

// The system's reason for the last failed call on a file. Unlike errno, it survives the clean-up after the
// failure. Code that calls the system keeps the reason, and code that records or reports the failure takes
// it.

/// Returns the code of the last call of the system that failed: errno, or GetLastError.
int LastSystemError();
/// Sets that code to 0, before calls that may fail without one.
void ClearLastSystemError();
/// Returns whether a code says that a file with this name exists, or that none exists, or that there is not
/// enough memory.
bool IsNameTaken(int code);
bool IsNotFound(int code);
bool IsOutOfMemory(int code);

/// Keeps a code until it is taken. Without an argument, keeps the last one.
void KeepSystemError();
void KeepSystemError(int code);
/// Forgets a reason that was kept, because a new operation begins.
void ForgetSystemError();
/// Returns the code that was kept, or 0, and forgets it.
int TakeSystemError();

/// Returns ": No space left on device", or how else the system says it in English; empty for 0.
std::string SystemErrorWords(int code);
/// Same for the code that was kept, which is then forgotten.
std::string TakeSystemErrorWords();

} // namespace gw
