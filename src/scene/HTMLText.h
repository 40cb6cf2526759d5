#pragma once

#include "Mat4.h"
#include "Quat.h"
#include "Vec3.h"

#include <string>
#include <string_view>

namespace gw {

// Formats values and names for the pages of the HTML dump. The pages use the Big5 code page, and names are in
// any encoding: UTF-8 is shown by code points, anything else byte by byte.

/// Returns a name as page text, with markup characters escaped.
std::string HTMLText(std::string_view name);
/// Returns a name for use between double quotes in a script: printable ASCII only, everything else escaped.
/// Big5 names are escaped by code point, names in other encodings byte by byte.
std::string HTMLScriptText(std::string_view name);

/// Formats three decimals; INFINITY and -INFINITY for the largest numbers and beyond.
std::string HTMLText(float value);
/// Formats "(x, y, z)".
std::string HTMLText(const Vec3& v);
/// Formats "(w, x, y, z)".
std::string HTMLText(const Quat& q);
/// Formats "[(...),(...),(...),(...)]", row by row.
std::string HTMLText(const Mat4& m);
inline std::string HTMLText(bool value)
{
    return value ? "true" : "false";
}

} // namespace gw
