#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// A step that helps after a message, or that comes next, and that the window offers as a button.
enum class ERemedy : uint8_t
{
    None,
    UseMap,         ///< selects the bone map that fits best
    DraftMap,       ///< drafts a bone map for the open source
    AlignRestPose,  ///< turns the alignment on, and converts again if there is a result
    OpenMendedCopy, ///< writes a repaired copy next to the file that was read last, and opens it
};

/// A remedy and the text of its button.
struct Offer
{
    ERemedy remedy = ERemedy::None;
    std::string button;

    bool operator==(const Offer&) const = default;
};

/// What an empty view says: the next step, with buttons for it.
struct Hint
{
    std::string text; ///< lines; nothing is shown if it is empty
    std::vector<Offer> offers;

    bool operator==(const Hint&) const = default;
};

/// Returns the remedy for a notice, by the notice's code. UseMap means that another bone map is needed,
/// whether an installed one fits or not.
ERemedy RemedyOf(std::string_view noticeCode);

} // namespace gw
