// Lines of a run's report: failures and warnings must survive being written and read again.

#include "CJsonWriter.h"
#include "FuzzTarget.h"
#include "Notice.h"
#include "NoticeJson.h"
#include "Text.h"

#include <algorithm>
#include <cstdio>
#include <cstdlib>

namespace gw {

namespace {

std::string Written(const std::vector<Notice>& notices)
{
    char* text = nullptr;
    size_t size = 0;
    std::FILE* const file = open_memstream(&text, &size);
    {
        CJsonWriter json(file);
        json.BeginObject();
        WriteNotices(json, notices);
        json.EndObject();
    }
    std::fclose(file);
    std::string written(text, size);
    std::free(text);
    return written;
}

bool IsSame(const Notice& a, const Notice& b)
{
    return a.path == b.path && a.where == b.where && a.code == b.code && a.name == b.name &&
           a.words == b.words && a.severity == b.severity;
}

void CheckLine(std::string_view line)
{
    std::string output, outcome;
    std::vector<Notice> first, second;
    const bool isLine = ReadReportLine(line, output, outcome) == EFailure::None;
    const bool isObject = ReadNotices(line, first);
    Require(isObject || !isLine, "a line of a report is an object");
    Require(ReadNotices(Written(first), second), "what was written can be read");
    Require(std::ranges::equal(first, second, IsSame), "reports survive");
}

} // namespace

void FuzzOne(std::span<const std::byte> input)
{
    std::string_view rest = TextOf(input);
    for (std::string_view line; NextLine(rest, line);)
        CheckLine(line);
}

} // namespace gw
