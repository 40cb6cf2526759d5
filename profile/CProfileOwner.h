#pragma once

#include <span>
#include <string>

namespace gw {

class CBoneOffsetDialog;

/// Button sets of a message box; the numbers never change.
enum class EButtons : int
{
    OK = 0,
    OKCancel = 1,
    YesNoCancel = 3,
    YesNo = 4,
};

/// The answer to a message box.
enum class EAnswer : int
{
    OK = 1,
    Cancel = 2,
    Yes = 6,
    No = 7,
};

/// What the profile editor needs from the program around it. Independent of any toolkit.
class CProfileOwner
{
public:
    virtual ~CProfileOwner() = default;

    /// Shows a message by id, formatted with the numbers, if any.
    virtual EAnswer ShowMessage(int id, EButtons buttons, std::span<const int> numbers = {}) = 0;
    /// The editor's state has changed (buttons, selections): window message 1032.
    virtual void ProfileStateChanged() = 0;
    /// The set of profiles or a profile's name has changed: window message 1033.
    virtual void ProfileSetChanged() = 0;
    /// Returns the file of the profile with a display name, or empty.
    virtual std::string FindProfilePath(const std::string& name) = 0;
    /// Returns the full path of a name in the folder of custom profiles, which is created if necessary.
    virtual std::string ProfileFile(const std::string& name) = 0;
    /// Returns the full path of a name next to the executable.
    virtual std::string ExeFile(const std::string& name) = 0;
    /// Shows the offset dialog: returns true on OK, false on Cancel or if no window can show it.
    virtual bool RunBoneOffset(CBoneOffsetDialog&) { return false; }
};

} // namespace gw
