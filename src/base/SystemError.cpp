#include "SystemError.h"

#include <utility>

namespace gw {

namespace {

thread_local int t_iKept = 0; // like the system's own code

} // namespace

void KeepSystemError()
{
    t_iKept = LastSystemError();
}

void KeepSystemError(int code)
{
    t_iKept = code;
}

void ForgetSystemError()
{
    t_iKept = 0;
}

int TakeSystemError()
{
    return std::exchange(t_iKept, 0);
}

std::string TakeSystemErrorWords()
{
    return SystemErrorWords(TakeSystemError());
}

} // namespace gw
