#pragma once

#include <QByteArray>
#include <optional>
#include <string>

namespace gw {

// The message from a later start to the first instance: four letters, the number of following bytes (4 bytes,
// lowest first), and a file path in UTF-8, which can be empty.

inline constexpr qsizetype kMessageHead = 8;    ///< bytes before the path
inline constexpr qsizetype kLongestPath = 4096; ///< in bytes; no file has a longer path
inline constexpr char kMessageAnswer = '!';     ///< the first instance's reply to a valid message

/// The state of a message being received.
enum class EMessageState : uint8_t
{
    Partial, ///< more may follow
    Whole,
    Wrong, ///< not from this program
};

/// Returns the message with a path. A path longer than any file's is left out.
QByteArray MakeMessage(const std::string& path);

/// Parses the bytes received so far. Sets `path` only if the message is complete.
EMessageState ReadMessage(const QByteArray& bytes, std::string& path);

} // namespace gw
