// Eight threads use the library at the same time, each with its own motions and all with shared ones. Every
// result must be the one that a single thread gets. Built with ThreadSanitizer (the preset tsan), this also
// finds races that happen to do no harm.

#include "CMotionFile.h"
#include "COrrinStream.h"
#include "Skeleton.h"
#include "TempFolder.h"

#include <functional>
#include <gaitwright/gaitwright.h>
#include <gtest/gtest.h>
#include <optional>
#include <string>
#include <thread>
#include <vector>

namespace gaitwright {

namespace {

constexpr size_t kThreads = 8;
constexpr int kRounds = 3;

/// A source and how to convert it.
struct Task
{
    std::string path;
    ConvertOptions options;
    const char* format;
};

/// What a task yields.
struct Yield
{
    std::vector<std::byte> bytes = {};
    std::vector<float> positions = {};
    double meanError = 0.0;
    size_t findings = 0;
    std::string reason = {}; ///< of a failure that is part of the task

    bool operator==(const Yield&) const = default;
};

/// Writes a container with the walk of the examples. Bone meshes are not part of the format.
void WriteScene(const std::string& path)
{
    gw::CMotionFile motion;
    ASSERT_TRUE(motion.Load(EXAMPLES "walk.bvh"));
    for (gw::CNode* node : gw::NodesOf(*motion.motionRoot))
    {
        for (size_t i = node->GetChildCount(); i-- > 0;)
        {
            if (node->ChildAt(i) && !gw::RecordCast<gw::CNode>(node->ChildAt(i)))
                node->DetachChild(node->ChildAt(i));
        }
    }
    gw::COrrinStream stream;
    stream.AddRoot(motion.motionRoot.Get());
    ASSERT_TRUE(stream.SaveFile(path));
}

std::vector<Task> TasksIn(const gw::CTempFolder& folder)
{
    const std::string walk = EXAMPLES "walk.bvh";
    const std::string wave = EXAMPLES "wave.bvh";
    WriteScene(folder.Path("scene.orn"));
    const Outcome<Motion> source = Load(walk);
    EXPECT_TRUE(source && source->Save(folder.Path("walk.glb")));
    return {
        {walk, {}, "kinetra"},
        {wave, {.align = true, .faithful = true}, "htr"},
        {walk, {.draft = true, .inPlace = true}, "glb"},
        {folder.Path("scene.orn"), {.faithful = true}, "kinetra"},
        {wave, {.frames = {3, 12}, .mirror = true}, "bvh"},
        {folder.Path("scene.orn"), {.mapName = "Poser BVH", .legs = false}, "htr"},
        {folder.Path("walk.glb"), {.draft = true, .align = true}, "kinetra"},
        {walk, {.align = true, .frames = {0, 30}}, "kinetra"},
    };
}

Yield YieldOf(const Motion& motion, const Task& task)
{
    Yield yield;
    const auto positions = motion.Positions();
    yield.positions.assign(positions->begin(), positions->end());
    const Outcome<Conversion> conversion = Convert(motion, task.options);
    if (!conversion)
        return {.reason = conversion.Error().reason};
    if (const Outcome<Figures> figures = conversion->Check())
        yield.meanError = figures->meanError;
    if (const Outcome<Suggestion> draft = Suggest(motion))
        yield.findings = draft->rows.size();
    yield.bytes = *conversion->Bytes(task.format);
    return yield;
}

Yield DoTask(const Task& task, const std::string& output)
{
    const Outcome<Motion> motion = Load(task.path);
    if (!motion)
        return {.reason = motion.Error().reason};
    Yield yield = YieldOf(*motion, task);
    yield.findings += Doctor(task.path)->findings.size();
    EXPECT_EQ(Load(output + ".missing.bvh").Error().reason, "not-found");
    EXPECT_TRUE(motion->Bytes("bvh") || task.path.ends_with(".orn"));
    const Outcome<Conversion> again = Convert(*motion, task.options);
    EXPECT_TRUE(!again || again->Save(output)); // all threads write the same name
    return yield;
}

void RunThreads(const std::function<void(size_t)>& run)
{
    std::vector<std::jthread> threads;
    for (size_t i = 0; i < kThreads; ++i)
        threads.emplace_back(run, i);
}

TEST(Threads, ConvertDifferentMotionsAtTheSameTime)
{
    const gw::CTempFolder folder;
    const std::vector<Task> tasks = TasksIn(folder);
    std::vector<Yield> expected;
    expected.reserve(tasks.size());
    for (const Task& task : tasks)
        expected.push_back(DoTask(task, folder.Path("single.htr")));
    EXPECT_FALSE(expected[0].bytes.empty());
    EXPECT_FALSE(expected[3].bytes.empty()) << "the container: " << expected[3].reason;
    RunThreads([&](size_t thread) {
        for (int round = 0; round < kRounds; ++round)
        {
            const size_t task = (thread + static_cast<size_t>(round)) % tasks.size();
            EXPECT_EQ(DoTask(tasks[task], folder.Path("all.htr")), expected[task]) << tasks[task].path;
        }
    });
}

TEST(Threads, UseOneMotionAtTheSameTime)
{
    const gw::CTempFolder folder;
    const std::vector<Task> tasks = TasksIn(folder);
    std::vector<Yield> expected;
    expected.reserve(tasks.size());
    for (const Task& task : tasks)
        expected.push_back(YieldOf(*Load(tasks[0].path), task));
    const Outcome<Motion> shared = Load(tasks[0].path);
    ASSERT_TRUE(shared);
    RunThreads([&](size_t thread) {
        // NOLINTNEXTLINE(performance-unnecessary-copy-initialization): each thread has its own handle
        const Motion own = *shared;
        EXPECT_EQ(YieldOf(own, tasks[thread]), expected[thread]);
        EXPECT_EQ(own.Poses()->data(), shared->Poses()->data()) << "computed once";
    });
}

TEST(Threads, UseOneConversionAtTheSameTime)
{
    const gw::CTempFolder folder;
    std::optional<Outcome<Conversion>> conversion = Convert(*Load(EXAMPLES "walk.bvh"), {.mirror = true});
    ASSERT_TRUE(*conversion);
    const std::vector<std::byte> expected = *(*conversion)->Bytes("kinetra");
    std::vector<std::optional<Conversion>> handles(kThreads, **conversion);
    conversion.reset(); // the last thread frees it
    RunThreads([&](size_t thread) {
        const Conversion own = *handles[thread];
        handles[thread].reset();
        // NOLINTNEXTLINE(performance-unnecessary-copy-initialization): as above
        const Motion result = own.Result();
        EXPECT_TRUE(own.Check());
        EXPECT_EQ(*own.Bytes("Kinetra"), expected);
        EXPECT_TRUE(result.Positions());
        EXPECT_TRUE(own.Save(folder.Path("same.Kinetra")));
    });
}

} // namespace

} // namespace gaitwright
