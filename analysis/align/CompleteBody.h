#pragma once

#include "CBodyMap.h"

namespace gw {

/// Fills in missing joints of a body from its tree: the spine between hip and arms, if spine, neck and head
/// are all unknown, and the hands and feet below forearms and shins.
void CompleteBody(CBodyMap& body);

} // namespace gw
