#include "Failures.h"

#include "CFailureRecord.h"
#include "CFileConversion.h"
#include "FindingWords.h"

#include <algorithm>

namespace gaitwright {

namespace {

Severity SeverityOf(gw::ESeverity severity)
{
    static_assert(static_cast<int>(Severity::Note) == static_cast<int>(gw::ESeverity::Note));
    return static_cast<Severity>(severity);
}

} // namespace

Failure FailureOf(const gw::Notice& notice)
{
    const bool isBinary = gw::IsBinary(notice.path);
    return {.severity = SeverityOf(notice.severity),
            .reason = notice.code,
            .path = notice.path,
            .line = isBinary ? 0 : notice.where,
            .byte = isBinary ? notice.where : 0,
            .name = notice.name,
            .words = notice.words};
}

Failure FailureOf(const char* reason, const std::string& words)
{
    return {.reason = reason, .words = words};
}

Failure FailureOf(const std::string& path, const gw::CFailureRecord& record)
{
    return FailureOf(gw::MakeNotice(path, record.Failure()));
}

void CNotices::Add(const gw::Notice& notice)
{
    if (notice.code == gw::kFixedMessage) // tells less than the notice before it
        return;
    notices_.push_back(notice);
    hasFailed_ = hasFailed_ || !notice.IsWarning();
}

Failure CNotices::FirstError() const
{
    const auto error = std::ranges::find_if_not(notices_, &gw::Notice::IsWarning);
    return error == notices_.end() ? FailureOf("internal", "the operation failed without a reason")
                                   : FailureOf(*error);
}

std::vector<Failure> CNotices::Warnings() const
{
    std::vector<Failure> warnings;
    for (const gw::Notice& notice : notices_)
    {
        if (notice.IsWarning())
            warnings.push_back(FailureOf(notice));
    }
    return warnings;
}

// Texts of up to 15 characters are stored in the string itself.
Failure OutOfMemory() noexcept
{
    return {.reason = "out-of-memory", .words = "out of memory"};
}

Failure InternalFailure(const std::exception& reason) noexcept
{
    try
    {
        return FailureOf("internal", reason.what());
    } catch (const std::bad_alloc&)
    {
        return OutOfMemory();
    }
}

const char* LibraryVersion() noexcept
{
    return GAITWRIGHT_VERSION;
}

const char* SeverityName(Severity severity) noexcept
{
    return gw::SeverityName(static_cast<gw::ESeverity>(severity)).data(); // of a literal
}

std::string Line(const Failure& failure) noexcept
{
    try
    {
        gw::Notice notice = gw::MakeNotice(failure.path, "", failure.words);
        notice.where = std::max(failure.line, failure.byte);
        return gw::NoticeLine(notice);
    } catch (const std::bad_alloc&)
    {
        return {};
    }
}

} // namespace gaitwright
