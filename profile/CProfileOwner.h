#pragma once

#include <span>
#include <string>

namespace gw {

class CBoneOffsetDialog;

/// Button sets of a message box, with the numbers that they have always had.
enum class EButtons : int
{
    OK = 0,
    OKCancel = 1,
    YesNoCancel = 3,
    YesNo = 4,
};

/// What a message box was answered with.
enum class EAnswer : int
{
    OK = 1,
    Cancel = 2,
    Yes = 6,
    No = 7,
};

/// What the profile editor asks of the program around it. No toolkit stands behind it but the one that
/// implements it.
class CProfileOwner
{
public:
    virtual ~CProfileOwner() = default;

    /// Shows the message of an id, formatted with numbers where it takes some.
    virtual EAnswer ShowMessage(int id, EButtons buttons, std::span<const int> numbers = {}) = 0;
    /// The editor's state changed (buttons, selections): window message 1032.
    virtual void ProfileStateChanged() = 0;
    /// The set of profiles or a profile's name changed: window message 1033.
    virtual void ProfileSetChanged() = 0;
    /// The file of the profile with a display name, or empty.
    virtual std::string FindProfilePath(const std::string& name) = 0;
    /// The full path of a name in the folder of custom profiles, which is made where it is missing.
    virtual std::string ProfileFile(const std::string& name) = 0;
    /// The full path of a name beside the executable.
    virtual std::string ExeFile(const std::string& name) = 0;
    /// Shows the offset dialog until the user ends it: true on OK, false on Cancel and where no window can
    /// show it.
    virtual bool RunBoneOffset(CBoneOffsetDialog&) { return false; }
};

} // namespace gw
