#include "HeldLeftKeys.h"

#include "LeftKeyCodes.h"
#include "WindowsCalls.h"

namespace gw {

namespace {

bool IsHeld(uint32_t code)
{
    return GetAsyncKeyState(static_cast<int>(code)) < 0;
}

} // namespace

std::set<EKey> HeldLeftKeys()
{
    std::set<EKey> keys;
    if (IsHeld(kLeftCtrl))
        keys.insert(EKey::LeftCtrl);
    if (IsHeld(kLeftShift))
        keys.insert(EKey::LeftShift);
    return keys;
}

} // namespace gw
