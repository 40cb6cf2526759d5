// The settings file: every value that is stored is found again, whatever stands there already.

#include "FuzzTarget.h"
#include "IniText.h"
#include "Text.h"

void gw::FuzzOne(std::span<const std::byte> input)
{
    const std::string_view text = TextOf(input);
    FindIniValue(text, "Settings", "LastFolder");
    const std::string value = "a, \"b\"; c=d\\";
    const std::string written = SetIniValue(text, "Settings", "LastFolder", value);
    Require(FindIniValue(written, "Settings", "LastFolder") == value, "what was stored is found");
    // Of several byte order marks each save takes one.
    Require(SetIniValue(written, "Settings", "LastFolder", value) == SkipByteOrderMark(written),
            "storing again changes nothing");
}
