#pragma once

#include <cstdint>
#include <span>
#include <string_view>

namespace gw {

/// What can be wrong with a motion file, or worth knowing about it.
enum class EFault : uint8_t
{
    Reader, ///< what the format's own reader failed on or warned of; it has words of its own

    // Of the bytes.
    LfsPointer,
    NotText,
    ByteOrderMark,
    CarriageReturn,
    StrayCharacter,

    // Of the hierarchy.
    KeywordSpelling,
    BraceOnLine,
    BlankInName,
    SameName,
    ChannelCount,
    UnknownChannel,
    SecondRoot,

    // Of the motion's head and its rows.
    EmptyLineBeforeFrames,
    EmptyLineInRows,
    DecimalComma,
    RateForTime,
    MissingRows,
    SurplusRows,
    NoFrames,
    ShortRow,
    LongRow,
    NaN,
    StuckNumber,

    // Of the poses.
    DoubledOffset,
    DoubledHipOffset,
    Spike,
    StillRoot,
    SidesSwapped,
    WrongRate,
    MixedChannels,
};

enum class ESeverity : uint8_t
{
    Error,   ///< refused, or read as something else than was meant
    Warning, ///< read, but a conversion will show it
    Note,    ///< legal and in order, but good to know
};

/// What is known of a fault beforehand.
struct FaultRow
{
    EFault fault;
    std::string_view code; ///< a short word that stays as it is, for programs
    ESeverity severity;
    bool mends; ///< a mended copy can be free of it
    std::string_view words;
    std::string_view remedy;
};

/// All faults, in the order of EFault.
std::span<const FaultRow> FaultTable();
const FaultRow& RowOf(EFault fault);
/// "error", "warning" or "note".
std::string_view SeverityName(ESeverity severity);

} // namespace gw
