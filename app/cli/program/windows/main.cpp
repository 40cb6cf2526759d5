// The system's arguments are UTF-16, and its shells do not expand patterns.

#include "Program.h"

#include "WideText.h"

#include <string>
#include <vector>

// Read by the start-up code: patterns such as *.bvh become the names of files, unless they are quoted.
extern "C" int _dowildcard; // NOLINT(bugprone-reserved-identifier)
int _dowildcard = -1;

extern "C" int wmain(int argc, wchar_t** wide)
{
    std::vector<std::string> arguments;
    for (int i = 0; i < argc; ++i)
        arguments.push_back(gw::NarrowText(wide[i]));
    std::vector<char*> argv;
    for (std::string& argument : arguments)
        argv.push_back(argument.data());
    argv.push_back(nullptr);
    return gw::RunProgram(argc, argv.data());
}
