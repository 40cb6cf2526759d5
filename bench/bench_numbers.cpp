// Ratios within one run: both sides alternate, so a noisy machine slows both.

#include "CKeyframeControl.h"
#include "CNode.h"
#include "COrrinStream.h"
#include "Numbers.h"
#include "ReadFloat.h"

#include <benchmark/benchmark.h>
#include <charconv>
#include <chrono>
#include <random>

namespace gw {
namespace {

using Clock = std::chrono::steady_clock;

std::vector<float> Angles(size_t count)
{
    std::mt19937 random(1);
    std::uniform_real_distribution<float> degrees(-180.0f, 180.0f);
    std::vector<float> values(count);
    for (float& value : values)
        value = degrees(random);
    return values;
}

// Writing a number, compared with the standard library's exact conversion.
void WriteNumbers(benchmark::State& state)
{
    const std::vector<float> values = Angles(100'000);
    std::chrono::duration<double> ours{};
    std::chrono::duration<double> library{};
    char text[kFixed6Bytes];
    while (state.KeepRunning())
    {
        const Clock::time_point start = Clock::now();
        for (const float value : values)
            benchmark::DoNotOptimize(WriteFixed6(text, value));
        const Clock::time_point middle = Clock::now();
        for (const float value : values)
            benchmark::DoNotOptimize(std::to_chars(text, text + sizeof text, static_cast<double>(value),
                                                   std::chars_format::fixed, 6));
        ours += middle - start;
        library += Clock::now() - middle;
    }
    state.counters["ours/library"] = ours.count() / library.count();
}
BENCHMARK(WriteNumbers);

// Reading a number, compared with the standard library.
void ReadNumbers(benchmark::State& state)
{
    std::string text;
    for (const float value : Angles(100'000))
    {
        AppendFixed6(text, value);
        text += ' ';
    }
    std::chrono::duration<double> ours{};
    std::chrono::duration<double> library{};
    const char* end = text.data() + text.size();
    while (state.KeepRunning())
    {
        const Clock::time_point start = Clock::now();
        ENumber kind;
        for (const char* at = text.data(); at < end; ++at)
            benchmark::DoNotOptimize(ReadFloat(at, end, at, kind));
        const Clock::time_point middle = Clock::now();
        double value = 0.0;
        for (const char* at = text.data(); at < end; ++at)
        {
            at = std::from_chars(at, end, value).ptr;
            benchmark::DoNotOptimize(value);
        }
        ours += middle - start;
        library += Clock::now() - middle;
    }
    state.counters["ours/library"] = ours.count() / library.count();
}
BENCHMARK(ReadNumbers);

// Reading a container with large tracks through its list of fields, compared with copying its bytes.
void ReadContainer(benchmark::State& state)
{
    Ref<CNode> node = new CNode;
    CKeyframeControl* track = new CKeyframeControl;
    node->AttachControl(track);
    track->m_kRotationKeys.assign(1'000'000, kQuatIdentity);
    track->m_kPositionKeys.assign(1'000'000, kVec3Zero);
    track->m_kKeyTimes = Angles(1'000'000);
    COrrinStream stream;
    stream.AddRoot(node.Get());
    std::vector<std::byte> bytes;
    stream.SaveBuffer(bytes);

    std::chrono::duration<double> copy{};
    std::chrono::duration<double> read{};
    while (state.KeepRunning())
    {
        const Clock::time_point start = Clock::now();
        benchmark::DoNotOptimize(std::vector<std::byte>(bytes));
        const Clock::time_point middle = Clock::now();
        COrrinStream again;
        benchmark::DoNotOptimize(again.LoadBuffer(bytes, 0));
        copy += middle - start;
        read += Clock::now() - middle;
    }
    state.counters["read/copy"] = read.count() / copy.count();
}
BENCHMARK(ReadContainer);

} // namespace
} // namespace gw
