#pragma once

#include "QtText.h"

namespace gw {

/// Returns the names of two mapped bones for display.
inline QString PairText(const std::string& source, const std::string& target)
{
    return ToQString(source) + QStringLiteral(" \u2192 ") + ToQString(target);
}

} // namespace gw
