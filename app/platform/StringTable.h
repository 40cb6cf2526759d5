#pragma once

#include <span>
#include <string>
#include <string_view>

namespace gw {

/// The program's messages, and other texts looked up by id.
enum EMessage : int
{
    kOwnMessage = 0, ///< a text that has no id
    kAboutToolMessage = 101,
    kTitleMessage = 128,
    kListFontMessage = 129,     ///< font family of the profile list
    kListFontSizeMessage = 130, ///< font size in tenths of a point
    kHostKeyMessage = 131,
    kHostProgramMessage = 135,
    kNoHostMessage = 137,
    kInvalidSourceMessage = 138,
    kSaveResultMessage = 139,
    kWebPageMessage = 143,
    kCannotConvertMessage = 144,
    kConvertedMessage = 146,
    kBatchTitleMessage = 147,
    kPackagedMessage = 148,
    kCustomFolderKeyMessage = 154,
    kOpenFilterMessage = 164,
    kSaveFilterMessage = 165,
    kRemoveProfileMessage = 166,
    kHelpTopicMessage = 167,
    kShowFileMessage = 171,
};

/// Returns the program's own text of a message, with its misspellings; empty for an unknown id.
std::string_view BuiltInString(int id);

/// Returns whether a message reports the end of a step (an open, a conversion, a save, a batch run), so that
/// its box also shows the step's warnings. Questions during a step do not.
bool EndsStep(int id);

/// Replaces %d and %s in a text, in order. Formats can come from a translation: everything else is copied,
/// and a %d or %s without an argument is removed.
std::string FormatText(std::string_view format, std::span<const std::string> arguments);

} // namespace gw
