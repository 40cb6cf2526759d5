#pragma once

#include <QByteArray>
#include <optional>
#include <string>

namespace gw {

// What a later start says to the first instance: four letters, the number of bytes that follow in four bytes,
// the lowest first, and the path of a file in UTF-8, or nothing.

inline constexpr qsizetype kMessageHead = 8;    ///< bytes before the path
inline constexpr qsizetype kLongestPath = 4096; ///< bytes; no file has a longer one
inline constexpr char kMessageAnswer = '!';     ///< what the first instance says when it has understood

/// How far a message has come.
enum class EMessageState : uint8_t
{
    Partial, ///< more may come
    Whole,
    Wrong, ///< nothing of this program
};

/// The message that hands over a path. One that no file can have is left out.
QByteArray MakeMessage(const std::string& path);

/// Reads what has arrived so far; only a whole message sets the path.
EMessageState ReadMessage(const QByteArray& bytes, std::string& path);

} // namespace gw
