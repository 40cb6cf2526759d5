// The string table of a library, and a translated text used as a format.

#include "CStringLibrary.h"
#include "FuzzTarget.h"
#include "StringTable.h"
#include "Text.h"

void gw::FuzzOne(std::span<const std::byte> input)
{
    const std::string arguments[] = {"7", "walk"};
    for (const uint32_t id : {0u, 101u, 138u, 4711u, 0x7fffffffu})
    {
        for (const uint32_t locale : {0u, 1031u, 2052u})
        {
            std::string text;
            if (!FindResourceString(input, id, locale, text))
                continue;
            Require(!text.empty(), "a text that was found is none that is empty");
            Require(text.size() <= 2 * input.size(), "a text is in the file");
            Require(Printable(FormatText(text, arguments)).find('\x1b') == std::string::npos,
                    "what is printed commands no terminal");
        }
    }
}
