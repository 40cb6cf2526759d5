#pragma once

#include <cstdint>
#include <string>

namespace gw {

/// Returns the number of this process.
uint32_t ProcessNumber();
/// Returns whether no process of this machine has this number.
bool IsProcessGone(uint32_t number);
/// Identifies the machine and, where the system has them, the process namespace.
std::string MachineName();

/// Returns a number that nobody can foresee.
uint32_t RandomNumber();
/// Returns a variable of the environment as UTF-8; empty if it is not set.
std::string EnvironmentVariable(const char* name);

/// Loads a module (a name without extension) from the program's folder, and returns its function `entry`.
/// Null if the module, or a library that it needs, is missing. The module stays loaded.
void* ModuleEntry(const std::string& module, const char* entry);

} // namespace gw
