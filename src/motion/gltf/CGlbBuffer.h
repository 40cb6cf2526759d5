#pragma once

#include <nlohmann/json_fwd.hpp>

#include <cstddef>
#include <memory>
#include <span>
#include <string_view>
#include <type_traits>
#include <vector>

namespace gw {

/// What a view of the buffer is used for; the values are glTF's.
enum class EGlbTarget
{
    None = 0,
    Vertices = 34962,
    Indices = 34963,
};

/// The type of an accessor's components; the values are glTF's.
enum class EGlbComponent
{
    UnsignedShort = 5123,
    UnsignedInt = 5125,
    Float = 5126,
};

/// The one buffer of a binary glTF file, and the JSON lists of its views and accessors.
class CGlbBuffer
{
public:
    CGlbBuffer();
    ~CGlbBuffer();

    /// Adds elements of `width` components and returns the index of their accessor. `type` is glTF's name,
    /// such as "VEC3". Bounds are required for positions and key times.
    template <class T>
    size_t Add(std::span<const T> components, std::string_view type, size_t width,
               EGlbTarget target = EGlbTarget::None, bool hasBounds = false)
    {
        constexpr EGlbComponent kComponent = std::is_same_v<T, float>      ? EGlbComponent::Float
                                             : std::is_same_v<T, uint16_t> ? EGlbComponent::UnsignedShort
                                                                           : EGlbComponent::UnsignedInt;
        const size_t accessor =
            AddView(std::as_bytes(components), kComponent, components.size() / width, type, target);
        if constexpr (std::is_same_v<T, float>)
        {
            if (hasBounds)
                SetBounds(accessor, components, width);
        }
        return accessor;
    }

    const std::vector<std::byte>& Bytes() const { return m_kBytes; }
    const nlohmann::ordered_json& Views() const { return *m_spViews; }
    const nlohmann::ordered_json& Accessors() const { return *m_spAccessors; }

private:
    size_t AddView(std::span<const std::byte> bytes, EGlbComponent component, size_t count,
                   std::string_view type, EGlbTarget target);
    void SetBounds(size_t accessor, std::span<const float> components, size_t width);

    std::vector<std::byte> m_kBytes;
    std::unique_ptr<nlohmann::ordered_json> m_spViews;
    std::unique_ptr<nlohmann::ordered_json> m_spAccessors;
};

} // namespace gw
