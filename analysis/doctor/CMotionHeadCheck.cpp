// Checks "Frames:" and "Frame Time:", which the strict reader requires literally. Misspelled keywords are
// reported and repaired, and a frame time that is really a rate is recognized by its size.

#include "CMotionHeadCheck.h"

#include "CFindings.h"
#include "CTextEdits.h"
#include "CTextLines.h"
#include "NumberText.h"
#include "Numbers.h"
#include "Text.h"

#include <algorithm>
#include <string>

namespace gw {

namespace {

constexpr double kLongestFrame = 10.0; // seconds; a larger value is a rate

// Removes a keyword from the front of a text, in any case, with any blanks between its letters, with or
// without a colon. False if the text starts differently.
bool TakeKeyword(std::string_view keyword, std::string_view& text)
{
    std::string_view rest = text;
    for (const char letter : keyword)
    {
        if (letter == ' ')
            continue;
        rest.remove_prefix(std::min(rest.find_first_not_of(kTokenDelimiters), rest.size()));
        const bool fits = !rest.empty() && EqualNoCase(rest.substr(0, 1), {&letter, 1});
        if (!fits && letter != ':')
            return false;
        rest.remove_prefix(fits);
    }
    text = rest;
    return true;
}

// Returns whether the strict reader recognizes the keyword at the front of a line, followed by a value.
bool IsSpelled(std::string_view keyword, std::string_view line)
{
    for (std::string_view word = NextToken(keyword); !word.empty(); word = NextToken(keyword))
    {
        if (NextToken(line) != word)
            return false;
    }
    return true;
}

} // namespace

bool CMotionHeadCheck::Read(BVHOutline& outline)
{
    if (!ReadFrameCount(outline) || !ReadFrameTime(outline))
        return false;
    outline.rowsBegin = lines_.NextOffset();
    outline.rowsLine = lines_.NextNumber();
    return true;
}

bool CMotionHeadCheck::SkipEmptyLines()
{
    while (lines_.Next())
    {
        if (!lines_.IsBlank())
            return true;
        findings_.Add(EFailure::EmptyLineBeforeFrames, lines_.Number());
        const size_t begin = lines_.OffsetOf(lines_.Line());
        edits_.Replace(begin, lines_.NextOffset() - begin, "");
    }
    return false;
}

// Reads the text after a keyword on the next line.
bool CMotionHeadCheck::NextValue(std::string_view keyword, std::string_view& value)
{
    if (!SkipEmptyLines())
        return false;
    const std::string_view line = lines_.Line();
    value = line;
    if (!TakeKeyword(keyword, value))
        return false;
    const auto begin = std::min(value.find_first_not_of(kTokenDelimiters), value.size());
    value.remove_prefix(begin);
    if (!value.empty() && !IsSpelled(keyword, line))
    {
        findings_.Add(EFailure::KeywordSpelling, lines_.Number(), Quote(line));
        edits_.Replace(lines_.OffsetOf(line), line.size() - value.size(), std::string(keyword) + ' ');
    }
    return !value.empty();
}

bool CMotionHeadCheck::ReadFrameCount(BVHOutline& outline)
{
    std::string_view value;
    if (!NextValue("Frames:", value))
        return false;
    const std::string_view token = NextToken(value);
    outline.framesLine = lines_.Number();
    outline.framesBegin = lines_.OffsetOf(token);
    outline.framesLength = token.size();
    return ScanInt(token, outline.frameCount);
}

bool CMotionHeadCheck::ReadFrameTime(BVHOutline& outline)
{
    std::string_view value;
    if (!NextValue("Frame Time:", value))
        return false;
    value = CutTrailing(value);
    std::string points;
    if (HasDecimalCommas(value, 1))
    {
        points = WithPoints(value);
        findings_.Add(EFailure::DecimalComma, lines_.Number());
        edits_.Replace(lines_.OffsetOf(value), value.size(), points);
        value = points;
    }
    outline.frameTimeLine = lines_.Number();
    if (ParseDouble(NextToken(value)) >= kLongestFrame)
        findings_.Add(EFailure::RateForTime, lines_.Number());
    return true;
}

} // namespace gw
