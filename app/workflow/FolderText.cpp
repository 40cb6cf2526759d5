#include "FolderText.h"

#include "Paths.h"

#include <algorithm>

namespace gw {

namespace {

bool IsSeparator(char letter)
{
    return letter == '/' || letter == '\\';
}

bool HasEmptyName(std::string_view text)
{
    const auto bothSeparate = [](char a, char b) { return IsSeparator(a) && IsSeparator(b); };
    return std::ranges::adjacent_find(text, bothSeparate) != text.end();
}

// Returns whether a path starts at a root or a drive.
bool IsAbsolute(std::string_view text)
{
    return IsSeparator(text[0]) || (text.size() > 1 && text[1] == ':');
}

} // namespace

std::optional<std::string> FolderOfText(std::string text, const std::string& openFolder)
{
    if (HasEmptyName(text))
        return std::nullopt;
    if (text.empty() || text == openFolder)
        return WithSeparator(openFolder);
    std::ranges::replace_if(text, IsSeparator, kPathSeparator);
    return WithSeparator(IsAbsolute(text) ? text : WithSeparator(openFolder) + text);
}

std::string_view FolderName(std::string_view folder)
{
    return folder.substr(0, std::max<size_t>(folder.size(), 2) - 1);
}

} // namespace gw
