#include "PageOutputRow.h"

#include "CJsonMembers.h"
#include "ConversionDetail.h"
#include "ConversionMeasures.h"
#include "FindingWords.h"
#include "KeyFigures.h"
#include "Notice.h"
#include "NoticeJson.h"
#include "NoticeKinds.h"
#include "Text.h"

#include <algorithm>

namespace gw {

namespace {

using EKind = CJsonMembers::EKind;

// Returns the message without the source's own path: "line 64: there are fewer rows than frames".
std::string CauseOf(const std::string& source, const Notice& notice)
{
    std::string line = NoticeLine(notice);
    line.resize(std::min(line.size(), line.find('\n')));
    const std::string path = Printable(source);
    if (line.starts_with(path + ": "))
        return line.substr(path.size() + 2);
    return line.starts_with(path + ':') ? "line " + line.substr(path.size() + 1) : line;
}

void TakeNotices(std::string_view record, PageRow& row)
{
    std::vector<Notice> notices;
    ReadNotices(record, notices);
    for (const Notice& notice : notices)
    {
        const std::string kind = KindWords(notice);
        if (notice.IsWarning() && std::ranges::count(row.warnings, kind) == 0)
            row.warnings.push_back(kind);
        if (notice.IsWarning() || !row.cause.empty())
            continue;
        row.cause = CauseOf(row.source, notice);
        row.causeKind = kind;
    }
}

std::vector<std::optional<double>> FiguresOf(const CJsonMembers& record)
{
    CJsonMembers stored;
    const CJsonMembers::Member* const text = record.Find("figures");
    if (!text || text->kind != EKind::Nested || stored.Read(text->text) != EFailure::None)
        return {};
    std::vector<std::optional<double>> values;
    for (const KeyFigure& figure : KeyFiguresOf({}, {}))
    {
        const CJsonMembers::Member* const value = stored.Find(figure.key);
        const bool isNumber = value && (value->kind == EKind::Number || value->kind == EKind::Integer);
        values.push_back(isNumber ? std::optional(value->number) : std::nullopt);
    }
    return values;
}

} // namespace

PageRow PageRowOf(const std::string& source, const char* outcome, std::string_view record)
{
    PageRow row{.source = source, .outcome = outcome};
    CJsonMembers members;
    if (members.Read(record) != EFailure::None)
        return row;
    members.TakeText("profile", row.profile);
    members.TakeText("sureness", row.confidence);
    if (const CJsonMembers::Member* const drafted = members.Find("drafted"); drafted && drafted->flag)
        row.confidence = "drafted";
    uint64_t frames = 0;
    if (members.TakeCount("frames", frames))
        row.frames = static_cast<long long>(frames);
    TakeNotices(record, row);
    row.figures = FiguresOf(members);
    return row;
}

} // namespace gw
