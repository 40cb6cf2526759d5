#include "CGlbBuffer.h"

#include <nlohmann/json.hpp>

#include <algorithm>

namespace gw {

namespace {

using Json = nlohmann::ordered_json;

constexpr size_t kAlignment = 4; // of every component type in use

} // namespace

CGlbBuffer::CGlbBuffer()
    : m_spViews(std::make_unique<Json>(Json::array())), m_spAccessors(std::make_unique<Json>(Json::array()))
{
}

CGlbBuffer::~CGlbBuffer() = default;

size_t CGlbBuffer::AddView(std::span<const std::byte> bytes, EGlbComponent component, size_t count,
                           std::string_view type, EGlbTarget target)
{
    m_kBytes.resize((m_kBytes.size() + kAlignment - 1) / kAlignment * kAlignment);
    Json view = {
        {"buffer",     0              },
        {"byteOffset", m_kBytes.size()},
        {"byteLength", bytes.size()   },
    };
    if (target != EGlbTarget::None)
        view["target"] = static_cast<int>(target);
    m_kBytes.insert(m_kBytes.end(), bytes.begin(), bytes.end());
    m_spAccessors->push_back({
        {"bufferView",    m_spViews->size()          },
        {"componentType", static_cast<int>(component)},
        {"count",         count                      },
        {"type",          type                       },
    });
    m_spViews->push_back(std::move(view));
    return m_spAccessors->size() - 1;
}

void CGlbBuffer::SetBounds(size_t accessor, std::span<const float> components, size_t width)
{
    std::vector<float> low(components.begin(), components.begin() + static_cast<std::ptrdiff_t>(width));
    std::vector<float> high(low);
    for (size_t i = width; i < components.size(); ++i)
    {
        low[i % width] = std::min(low[i % width], components[i]);
        high[i % width] = std::max(high[i % width], components[i]);
    }
    (*m_spAccessors)[accessor]["min"] = low;
    (*m_spAccessors)[accessor]["max"] = high;
}

} // namespace gw
