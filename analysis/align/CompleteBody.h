#pragma once

#include "CBodyMap.h"

namespace gw {

/// Completes a body from its tree: the spine between hip and arms, if spine, neck and head are all unknown,
/// and hands and feet at the ends of forearms and shins.
void CompleteBody(CBodyMap& body);

} // namespace gw
