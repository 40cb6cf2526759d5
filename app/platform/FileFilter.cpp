#include "FileFilter.h"

#include "Text.h"

namespace gw {

namespace {

// Splits off the text up to the next bar, and removes the bar.
std::string_view NextPart(std::string_view& rest)
{
    const size_t bar = rest.find('|');
    const std::string_view part = rest.substr(0, bar);
    rest.remove_prefix(bar == rest.npos ? rest.size() : bar + 1);
    return part;
}

} // namespace

std::vector<FileFilter> SplitFilter(std::string_view filter)
{
    std::vector<FileFilter> choices;
    while (!filter.empty())
    {
        FileFilter choice;
        choice.text = NextPart(filter);
        std::string_view patterns = NextPart(filter);
        for (std::string_view pattern = NextToken(patterns, ";"); !pattern.empty();
             pattern = NextToken(patterns, ";"))
            choice.patterns.emplace_back(pattern);
        if (!choice.text.empty() && !choice.patterns.empty())
            choices.push_back(choice);
    }
    return choices;
}

} // namespace gw
