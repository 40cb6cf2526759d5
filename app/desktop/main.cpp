#include "RunDesktop.h"

int main(int argc, char** argv)
{
    return gw::RunDesktop(argc, argv);
}
