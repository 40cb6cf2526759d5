#pragma once

#include "Access.h"
#include "CSourceMotion.h"
#include "EditMotion.h"
#include "gaitwright/gaitwright.h"

#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <vector>

namespace gaitwright {

/// What the handles of a motion share.
struct Motion::Content
{
    std::string path;
    std::string format;
    std::vector<Failure> warnings;
    std::shared_ptr<void>
        conversion; ///< what made a result; its tree is the same, so it must not die earlier
    std::shared_ptr<gw::CSourceMotion> source;
    std::optional<gw::CEditedMotion> edited; ///< the changes of a result, as long as it exists

    // Facts, constant once the motion is loaded.
    std::vector<gw::CNode*> nodes;
    std::vector<std::string> names;
    std::vector<int32_t> parents;
    std::vector<std::string> clips;
    std::string clip;
    size_t frameCount = 0;
    float frequency = 0.0f;
    double unitMeters = 0.0;
    double frameSeconds = 0.0;

    std::mutex mutex; ///< of everything below, of the tree's pose, and of its reference counts
    std::vector<float> rest;
    std::vector<float> poses;
    std::vector<float> positions;

    /// Lists the tree when it is complete. Returns a failure if it has too many frames to be true.
    Outcome<void> Describe();
};

} // namespace gaitwright
