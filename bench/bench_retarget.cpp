// The cost of a conversion without reading and writing: both skeletons are in memory.

#include "CMotionFile.h"
#include "CRetargeter.h"
#include "FindBone.h"
#include "ProfileRows.h"
#include "Skeleton.h"

#include <benchmark/benchmark.h>
#include <ctime>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>

namespace gw {
namespace {

constexpr int kRepeats = 100;

// The example's steps, repeated.
void WriteLongWalk(const std::string& path)
{
    std::ifstream walk(GAITWRIGHT_ROOT "/examples/walk.bvh");
    std::stringstream text;
    text << walk.rdbuf();
    const std::string whole = text.str();
    const size_t counts = whole.find("Frames:");
    const size_t rows = whole.find('\n', whole.find("Frame Time:")) + 1;
    const int frames = std::stoi(whole.substr(counts + 7));
    std::ofstream out(path);
    out << whole.substr(0, counts) << "Frames: " << frames * kRepeats
        << whole.substr(whole.find('\n', counts), rows - whole.find('\n', counts));
    for (int i = 0; i < kRepeats; ++i)
        out << whole.substr(rows);
}

/// A prepared conversion.
class CPreparedConversion
{
public:
    bool Prepare()
    {
        const std::string path = (std::filesystem::temp_directory_path() / "gaitwright-bench.bvh").string();
        WriteLongWalk(path);
        const bool loaded = m_kSource.Load(path) && m_kTarget.Load(GAITWRIGHT_ROOT "/assets/base.htr");
        std::filesystem::remove(path);
        ProfileRows profile;
        if (!loaded || !ReadProfileRows(GAITWRIGHT_ROOT "/assets/PoserBVH.prf", profile))
            return false;
        m_kRetargeter.SetScenes(m_kSource.motionRoot.Get(), m_kTarget.motionRoot.Get());
        const CBoneNames sources(m_kSource.motionRoot.Get());
        const CBoneNames targets(m_kTarget.motionRoot.Get());
        return ApplyRows(profile.rows, sources, targets, &m_kRetargeter).IsWhole();
    }
    void Run()
    {
        m_kRetargeter.Retarget(0.0f, m_kSource.GetLastFrame(), 0.0f, m_kSource.GetFrequency(),
                               {0.0f, 923.0f, 13.0f}, true, true);
    }
    /// Returns the number of target bones times frames.
    double Steps() const
    {
        return static_cast<double>(NodesOf(*m_kTarget.motionRoot).size()) * m_kSource.GetKeyCount();
    }

private:
    CMotionFile m_kSource;
    CMotionFile m_kTarget;
    CRetargeter m_kRetargeter;
};

// CPU time in microseconds per bone and frame, legs included. This is a time and not a ratio, because there
// is no common reference.
void Retarget(benchmark::State& state)
{
    CPreparedConversion conversion;
    if (!conversion.Prepare())
    {
        state.SkipWithError("the example and its profile do not fit");
        return;
    }
    const std::clock_t start = std::clock();
    while (state.KeepRunning())
        conversion.Run();
    const double spent = 1e6 * static_cast<double>(std::clock() - start) / CLOCKS_PER_SEC;
    state.counters["us/bone/frame"] = spent / (conversion.Steps() * static_cast<double>(state.iterations()));
}
BENCHMARK(Retarget)->Unit(benchmark::kMillisecond);

} // namespace
} // namespace gw
