#include "NoticeJson.h"

#include "CFailureRecord.h"
#include "CJsonMembers.h"
#include "CJsonWriter.h"
#include "FindingWords.h"
#include "Notice.h"

namespace gw {

namespace {

// Most records end with this text, exactly as WriteNotices writes it, and need not be parsed.
constexpr std::string_view kNoNotices = R"("failures":[],"warnings":[])";

struct Member
{
    const char* key;
    ESeverity severity;
};
constexpr Member kMembers[] = {
    {"failures", ESeverity::Error  },
    {"warnings", ESeverity::Warning}
};

void WriteNotice(CJsonWriter& json, const Notice& notice)
{
    json.BeginObject();
    json.Key("path").Text(notice.path);
    json.Key("where").Integer(static_cast<int64_t>(notice.where));
    json.Key("code").Text(notice.code);
    json.Key("name").Text(notice.name);
    json.Key("words").Text(notice.words);
    json.EndObject();
}

Notice ReadNotice(std::string_view text, ESeverity severity)
{
    CJsonMembers json;
    json.Read(text);
    Notice notice;
    notice.severity = severity;
    json.TakeText("path", notice.path);
    json.TakeText("code", notice.code);
    json.TakeText("name", notice.name);
    json.TakeText("words", notice.words);
    uint64_t where = 0;
    if (json.TakeCount("where", where))
        notice.where = where;
    return notice;
}

// Returns the elements of an array member.
std::vector<CJsonMembers::Member> ReadList(const CJsonMembers& json, std::string_view key)
{
    CJsonMembers list;
    const CJsonMembers::Member* const member = json.Find(key);
    if (member && member->text.starts_with('[') && member->kind == CJsonMembers::EKind::Nested)
        list.Read(member->text);
    return list.Members();
}

} // namespace

void WriteNotices(CJsonWriter& json, const std::vector<Notice>& notices)
{
    for (const Member& member : kMembers)
    {
        json.Key(member.key).BeginArray();
        for (const Notice& notice : notices)
        {
            if (notice.severity == member.severity)
                WriteNotice(json, notice);
        }
        json.EndArray();
    }
}

void WriteRecord(CJsonWriter& json, const std::string& path, const CFailureRecord& record)
{
    std::vector<Notice> notices;
    if (record.Failure())
        notices.push_back(MakeNotice(path, record.Failure()));
    for (const Finding& warning : record.Warnings())
        notices.push_back(MakeNotice(path, warning));
    WriteNotices(json, notices);
}

bool ReadNotices(std::string_view text, std::vector<Notice>& notices)
{
    if (text.find(kNoNotices) != text.npos)
        return true;
    CJsonMembers json;
    json.Read(text);
    for (const Member& member : kMembers)
    {
        for (const CJsonMembers::Member& notice : ReadList(json, member.key))
            notices.push_back(ReadNotice(notice.text, member.severity));
    }
    return json.IsObject();
}

EFailure ReadReportLine(std::string_view text, std::string& output, std::string& outcome)
{
    CJsonMembers json;
    const EFailure failure = json.Read(text);
    if (failure != EFailure::None)
        return failure;
    return json.TakeText("output", output) && json.TakeText("outcome", outcome) ? EFailure::None
                                                                                : EFailure::UnexpectedLine;
}

} // namespace gw
