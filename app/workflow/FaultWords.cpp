#include "FaultWords.h"

#include "Text.h"

#include <cstdio>

namespace gw {

namespace {

// Indexed by EFrameFault.
constexpr FaultWords kFaults[] = {
    {"direction",  "mean error of the main bones", "deg"},
    {"trunk",      "trunk error",                  "deg"},
    {"kneePop",    "knee pop beyond the source's", "deg"},
    {"ankleSlide", "added slide of the ankle",     "mm" },
    {"toeSlide",   "added slide of the toe",       "mm" },
    {"heldSole",   "held sole off the floor by",   "mm" },
    {"handGap",    "hand gap",                     "mm" },
    {"handDepth",  "hand below the floor by",      "mm" },
};

} // namespace

const FaultWords& WordsOf(EFrameFault fault)
{
    return kFaults[static_cast<size_t>(fault)];
}

std::string WorstFrameText(const WorstFrame& worst)
{
    const FaultWords& words = WordsOf(worst.fault);
    char amount[32];
    std::snprintf(amount, sizeof amount, "%.1f", worst.amount);
    return "frame " + std::to_string(worst.frame) + ": " + words.text + ' ' + amount + ' ' + words.unit +
           " (" + Printable(worst.target) + ')';
}

} // namespace gw
