#include "SystemError.h"

#include <cerrno>
#include <system_error>
#include <utility>

namespace gw {

namespace {

thread_local int t_iKept = 0; // like errno

} // namespace

void KeepSystemError()
{
    t_iKept = errno;
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

std::string SystemErrorWords(int code)
{
    return code == 0 ? std::string() : ": " + std::generic_category().message(code);
}

std::string TakeSystemErrorWords()
{
    return SystemErrorWords(TakeSystemError());
}

} // namespace gw
