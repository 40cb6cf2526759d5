#include "CMadeSkeleton.h"
#include "CheckBody.h"
#include "FindBody.h"
#include "FindBodyByShape.h"
#include "Skeleton.h"

#include <gtest/gtest.h>

namespace gw {
namespace {

constexpr unsigned kSeeds = 2; // names, lengths and orders differ by seed

std::string NameOf(const CNode* node)
{
    return node ? node->GetName() : "";
}

const char* PlaceText(BodyPlace place)
{
    constexpr const char* kNames[] = {"hip",     "spine", "neck",  "head", "clavicle", "upper arm",
                                      "forearm", "hand",  "thigh", "shin", "foot",     "toe"};
    return kNames[static_cast<size_t>(place.joint)];
}

TEST(FindBodyByShape, FindsTheBodyOfEveryMadeSkeleton)
{
    for (const std::string& recipe : SkeletonRecipes())
    {
        for (unsigned seed = 1; seed <= kSeeds; ++seed)
        {
            SCOPED_TRACE("\"" + recipe + "\", seed " + std::to_string(seed));
            const CMadeSkeleton made(recipe, seed);
            const CBodyMap body = FindBodyByShape(made.Root());
            for (const BodyPlace& place : BodyPlaces())
            {
                EXPECT_EQ(NameOf(JointAt(body, place)), made.NameAt(place)) << PlaceText(place);
            }
        }
    }
}

TEST(CheckBody, HasNoDoubtsAboutTrueBodies)
{
    for (const std::string& recipe : SkeletonRecipes())
    {
        const CMadeSkeleton made(recipe, 1);
        EXPECT_TRUE(CheckBody(FindBodyByShape(made.Root())).empty()) << recipe;
    }
}

} // namespace
} // namespace gw
