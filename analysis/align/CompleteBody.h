#pragma once

#include "CBodyMap.h"

namespace gw {

/// Fills in of a body what its tree tells: a spine, the joints between hip and arms, where neither spine nor
/// neck nor head is known, and hands and feet at the ends of forearms and shins.
void CompleteBody(CBodyMap& body);

} // namespace gw
