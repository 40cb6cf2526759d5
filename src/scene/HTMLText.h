#pragma once

#include "Mat4.h"
#include "Quat.h"
#include "Vec3.h"

#include <string>
#include <string_view>

namespace gw {

// Values and names as the pages of the HTML dump show them. The pages are in the Big5 code page, and names
// are in whatever encoding their author used: UTF-8 is shown by its code points, anything else by its bytes.

/// Returns a name as text of a page, without anything in it that could be markup.
std::string HTMLText(std::string_view name);
/// Returns a name for use between double quotes in a script: printable ASCII only, everything else escaped.
/// Big5 names are escaped by their code points, names in any other encoding by their bytes.
std::string HTMLScriptText(std::string_view name);

/// Three decimals; INFINITY and -INFINITY for the largest numbers and beyond.
std::string HTMLText(float value);
/// "(x, y, z)"
std::string HTMLText(const Vec3& v);
/// "(w, x, y, z)"
std::string HTMLText(const Quat& q);
/// "[(...),(...),(...),(...)]", row by row.
std::string HTMLText(const Mat4& m);
inline std::string HTMLText(bool value)
{
    return value ? "true" : "false";
}

} // namespace gw
