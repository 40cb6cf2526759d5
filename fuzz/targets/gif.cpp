// Reads every image of a GIF file, up to the first damaged one.

#include "FuzzTarget.h"
#include "PicturePromises.h"

void gw::FuzzOne(std::span<const std::byte> input)
{
    const auto picture = OpenPicture(ScratchFile("in.gif", input), "r");
    while (picture && ReadsWhole(*picture) && picture->NextPicture())
    {
    }
}
