#pragma once

#include <cstddef>
#include <functional>
#include <span>
#include <string_view>

namespace gw {

/// Receives written bytes. Returns false if they could not be stored.
using CByteSink = std::function<bool(std::span<const std::byte>)>;
/// Same for text.
using CTextSink = std::function<bool(std::string_view)>;

} // namespace gw
