#pragma once

#include <cstdint>
#include <span>
#include <string_view>

namespace gw {

/// A fault of a motion file, or something worth knowing about it.
enum class EFault : uint8_t
{
    Reader, ///< the reader's own failure or warning, which has its own message

    // In the bytes.
    LfsPointer,
    NotText,
    ByteOrderMark,
    CarriageReturn,
    StrayCharacter,

    // In the hierarchy.
    KeywordSpelling,
    BraceOnLine,
    BlankInName,
    SameName,
    ChannelCount,
    UnknownChannel,
    SecondRoot,

    // In the motion's head and rows.
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

    // In the poses.
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
    Error,   ///< refused, or read differently than intended
    Warning, ///< read, but visible in a conversion
    Note,    ///< valid, but good to know
};

/// The fixed properties of a fault.
struct FaultRow
{
    EFault fault;
    std::string_view code; ///< a short word for programs, which never changes
    ESeverity severity;
    bool mends; ///< a repaired copy can fix it
    std::string_view words;
    std::string_view remedy;
};

/// Returns all faults, in EFault order.
std::span<const FaultRow> FaultTable();
/// Returns the properties of a fault.
const FaultRow& RowOf(EFault fault);
/// Returns "error", "warning" or "note".
std::string_view SeverityName(ESeverity severity);

} // namespace gw
