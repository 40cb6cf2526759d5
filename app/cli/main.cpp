#include "Program.h"

int main(int argc, char** argv)
{
    return gw::RunProgram(argc, argv);
}
