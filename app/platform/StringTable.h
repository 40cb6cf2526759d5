#pragma once

#include <span>
#include <string>
#include <string_view>

namespace gw {

/// The messages that the program itself shows, and the texts it looks things up by.
enum EMessage : int
{
    kOwnMessage = 0, ///< a text without an id
    kAboutToolMessage = 101,
    kTitleMessage = 128,
    kListFontMessage = 129,     ///< the family of the profile list's font
    kListFontSizeMessage = 130, ///< its size in tenths of a point
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

/// The program's own text of a message, misspellings and all; empty for an unknown id.
std::string_view BuiltInString(int id);

/// Whether a message reports how a step ended (an open, a conversion, a save, a batch run), so that its box
/// also shows what the step reported on the way. Questions in the middle of a step do not.
bool EndsStep(int id);

/// Returns a text with its %d and %s replaced in order. Formats may come from a translation: everything else
/// in them is copied, and a %d or %s without an argument is removed.
std::string FormatText(std::string_view format, std::span<const std::string> arguments);

} // namespace gw
