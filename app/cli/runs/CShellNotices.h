#pragma once

#include "CFileConversion.h"
#include "ConvertFile.h"
#include "HelpWords.h"
#include "Words.h"

#include <string>
#include <vector>

namespace gw {

struct ShellOptions;

/// The notices of a conversion. They are printed to standard error immediately, and all are kept except the
/// program's fixed messages, which other programs do not need.
class CShellNotices
{
public:
    /// The options must outlive the notices.
    explicit CShellNotices(const ShellOptions& options, EVoice voice = EVoice::Speaks)
        : options_(options), voice_(voice)
    {
    }

    void Add(const Notice& told)
    {
        Notice notice = WithHelp(options_, told);
        if (!copy_.empty() && notice.path == copy_)
            notice.path = name_;
        if (voice_ == EVoice::Speaks || (voice_ == EVoice::Failures && !notice.IsWarning()))
            SayNotice(options_, notice);
        if (notice.code == kFixedMessage)
            return;
        notices_.push_back(notice);
        hasFailed_ = hasFailed_ || !notice.IsWarning();
    }
    /// Replaces the path of a temporary file in all notices by a name that the user knows.
    void ShowAs(const std::string& copy, const std::string& name)
    {
        copy_ = copy;
        name_ = name;
    }
    /// Changes which notices are printed; all are still kept.
    void SetVoice(EVoice voice) { voice_ = voice; }
    EVoice Voice() const { return voice_; }
    /// Returns whether any notice is not a warning.
    bool HasFailed() const { return hasFailed_; }
    /// Returns all notices, in order.
    const std::vector<Notice>& All() const { return notices_; }

private:
    const ShellOptions& options_;
    std::vector<Notice> notices_;
    std::string copy_;
    std::string name_;
    bool hasFailed_ = false;
    EVoice voice_;
};

} // namespace gw
