#pragma once

#include "gaitwright/gaitwright.h"

#include <memory>
#include <utility>

namespace gaitwright {

/// Creates handles, and returns what they share.
struct Access
{
    using MotionContent = Motion::Content;
    using MapContent = BoneMap::Content;
    using ConversionContent = Conversion::Content;

    static Motion Make(std::shared_ptr<MotionContent> content) { return Motion(std::move(content)); }
    static BoneMap Make(std::shared_ptr<const MapContent> content) { return BoneMap(std::move(content)); }
    static Conversion Make(std::shared_ptr<ConversionContent> content)
    {
        return Conversion(std::move(content));
    }
    static MotionContent& Of(const Motion& motion) { return *motion.m_spContent; }
    static const MapContent& Of(const BoneMap& map) { return *map.m_spContent; }
};

} // namespace gaitwright
