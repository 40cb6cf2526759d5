// The settings file: every stored value must be found again, whatever the file contains.

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
    // Each save removes one of several byte order marks.
    Require(SetIniValue(written, "Settings", "LastFolder", value) == SkipByteOrderMark(written),
            "storing again changes nothing");
}
