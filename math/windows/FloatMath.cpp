// The functions of the C library for floats that conversions call, with the results that they have on Linux,
// so that the same motion becomes the same bytes. This system's library rounds up to one result in six the
// other way. They stand before its own when a program is linked. Functions for doubles are left to it: they
// differ in a last bit now and then, which is gone once a result becomes a float.
//
// The arctangent is that of Sun's freely distributable math library. Sine and cosine are polynomials in
// double on
// [-pi / 4, pi / 4], whose sums are fused where the processor can, as on Linux.

#include <bit>
#include <cmath>
#include <cstdint>

namespace {

constexpr float kPi = 0x1.921fb6p+1f;
constexpr float kPiRest = -0x1.777a5cp-24f; // pi - kPi

// Sums of arctangents at 0.5, 1, 1.5 and infinity, in two parts.
constexpr float kAtanHigh[] = {0x1.dac67p-2f, 0x1.921fb4p-1f, 0x1.f730bcp-1f, 0x1.921fb4p+0f};
constexpr float kAtanLow[] = {0x1.586ed2p-28f, 0x1.4442dp-25f, 0x1.281f68p-25f, 0x1.4442dp-24f};
constexpr float kAtan[] = {0x1.555556p-2f, -0x1.99999ap-3f, 0x1.24924ap-3f, -0x1.c71c7p-4f,
                           0x1.745cdcp-4f, -0x1.3b0f2ap-4f, 0x1.10d66ap-4f, -0x1.dde2d6p-5f,
                           0x1.97b4b2p-5f, -0x1.2b4442p-5f, 0x1.0ad3aep-6f};

struct Reduced
{
    float x;
    int part; // index into the tables above, or -1
};

// |x| becomes an angle below 0.4375 and one of the table.
Reduced ReduceTangent(float x)
{
    if (std::fabs(x) < 0.4375f)
        return {x, -1};
    x = std::fabs(x);
    if (x < 0.6875f)
        return {(2.0f * x - 1.0f) / (2.0f + x), 0};
    if (x < 1.1875f)
        return {(x - 1.0f) / (x + 1.0f), 1};
    if (x < 2.4375f)
        return {(x - 1.5f) / (1.0f + 1.5f * x), 2};
    return {-1.0f / x, 3};
}

float Arctangent(float tangent)
{
    constexpr float kLarge = 0x1p25f;
    constexpr float kSmall = 0x1p-29f;
    if (std::isnan(tangent))
        return tangent + tangent;
    if (std::fabs(tangent) >= kLarge)
        return std::copysign(kAtanHigh[3] + kAtanLow[3], tangent);
    if (std::fabs(tangent) < kSmall)
        return tangent;
    const auto [x, part] = ReduceTangent(tangent);
    const float z = x * x;
    const float w = z * z;
    const float even =
        z * (kAtan[0] + w * (kAtan[2] + w * (kAtan[4] + w * (kAtan[6] + w * (kAtan[8] + w * kAtan[10])))));
    const float odd = w * (kAtan[1] + w * (kAtan[3] + w * (kAtan[5] + w * (kAtan[7] + w * kAtan[9]))));
    if (part < 0)
        return x - x * (even + odd);
    const float angle = kAtanHigh[part] - ((x * (even + odd) - kAtanLow[part]) - x);
    return std::signbit(tangent) ? -angle : angle;
}

float Arctangent(float y, float x)
{
    constexpr int kManyBits = 60;
    if (std::isnan(x) || std::isnan(y))
        return x + y;
    if (x == 1.0f)
        return Arctangent(y);
    if (y == 0.0f)
        return std::signbit(x) ? std::copysign(kPi, y) : y;
    if (x == 0.0f || (std::isinf(y) && !std::isinf(x)))
        return std::copysign(kPi / 2.0f, y);
    if (std::isinf(x))
    {
        const float angle = std::isinf(y) ? kPi / 4.0f : 0.0f;
        return std::copysign(x < 0.0f ? (std::isinf(y) ? 3.0f * angle : kPi) : angle, y);
    }
    const auto exponents = [](float value) {
        return static_cast<int>(std::bit_cast<uint32_t>(std::fabs(value)));
    };
    const int bits = (exponents(y) - exponents(x)) >> 23;
    float angle = 0.0f;
    if (bits > kManyBits)
        angle = kPi / 2.0f + 0.5f * kPiRest;
    else if (x > 0.0f || bits >= -kManyBits)
        angle = Arctangent(std::fabs(y / x));
    if (x > 0.0f)
        return std::signbit(y) ? -angle : angle;
    return std::signbit(y) ? (angle - kPiRest) - kPi : kPi - (angle - kPiRest);
}

template <bool isFused>
[[gnu::always_inline]] inline double Sum(double a, double b, double c)
{
    if constexpr (isFused)
        return __builtin_fma(a, b, c);
    else
        return a * b + c;
}

constexpr double kHalfPi = 0x1.921FB54442D18p0;

// The quadrant of an angle, and the rest, for angles up to 120.
template <bool isFused>
[[gnu::always_inline]] inline double Reduce(double x, int& quadrant)
{
    constexpr double kTwoByPi = 0x1.45F306DC9C883p+23; // times 2 to the 24th
    quadrant = (static_cast<int32_t>(x * kTwoByPi) + 0x800000) >> 24;
    return Sum<isFused>(-static_cast<double>(quadrant), kHalfPi, x);
}

// The same for larger angles, by 192 bits of 4 / pi.
double ReduceLarge(float y, int& quadrant)
{
    constexpr uint32_t kFourByPi[] = {0xa2,       0xa2f9,     0xa2f983,   0xa2f9836e, 0xf9836e4e, 0x836e4e44,
                                      0x6e4e4415, 0x4e441529, 0x441529fc, 0x1529fc27, 0x29fc2757, 0xfc2757d1,
                                      0x2757d1f5, 0x57d1f534, 0xd1f534dd, 0xf534ddc0, 0x34ddc0db, 0xddc0db62,
                                      0xc0db6295, 0xdb629599, 0x6295993c, 0x95993c43, 0x993c4390, 0x3c439041};
    const auto bits = std::bit_cast<uint32_t>(y);
    const uint32_t* const digits = kFourByPi + (bits >> 26 & 15);
    const uint32_t mantissa = ((bits & 0xffffff) | 0x800000) << (bits >> 23 & 7);
    const uint64_t low = uint64_t{mantissa} * digits[8];
    uint64_t turns = low >> 32 | uint64_t{mantissa * digits[0]} << 32;
    turns += uint64_t{mantissa} * digits[4];
    const uint64_t whole = (turns + (uint64_t{1} << 61)) >> 62;
    quadrant = static_cast<int>(whole);
    return static_cast<double>(static_cast<int64_t>(turns - (whole << 62))) * 0x1.921FB54442D18p-62;
}

template <bool isFused>
[[gnu::always_inline]] inline float SineOf(double x)
{
    const double x2 = x * x;
    const double x3 = x * x2;
    const double end = Sum<isFused>(x2, -0x1.994eb3774cf24p-13, 0x1.1107605230bc4p-7);
    return static_cast<float>(Sum<isFused>(x3 * x2, end, Sum<isFused>(x3, -0x1.555545995a603p-3, x)));
}

template <bool isFused>
[[gnu::always_inline]] inline float CosineOf(double x)
{
    const double x2 = x * x;
    const double x4 = x2 * x2;
    const double end = Sum<isFused>(x2, 0x1.99343027bf8c3p-16, -0x1.6c087e89a359dp-10);
    const double start = Sum<isFused>(x2, -0x1.ffffffd0c621cp-2, 1.0);
    return static_cast<float>(Sum<isFused>(x4 * x2, end, Sum<isFused>(x4, 0x1.55553e1068f19p-5, start)));
}

// The sine of an angle plus so many quarter turns.
template <bool isFused>
[[gnu::always_inline]] inline float Sine(float y, int quarters)
{
    constexpr float kFastLimit = 120.0f;
    if (!std::isfinite(y))
        return y - y;
    int quadrant = 0;
    double x = y;
    if (std::fabs(y) >= kFastLimit)
    {
        x = ReduceLarge(y, quadrant);
        if (std::signbit(y))
        {
            x = -x;
            quadrant = -quadrant;
        }
    }
    else if (std::fabs(y) >= 0x1.921fb6p-1f)
        x = Reduce<isFused>(x, quadrant);
    quadrant += quarters;
    const float value = (quadrant & 1) != 0 ? CosineOf<isFused>(x) : SineOf<isFused>(x);
    return (quadrant & 2) != 0 ? -value : value;
}

[[gnu::target("fma")]] float SineFused(float y, int quarters)
{
    return Sine<true>(y, quarters);
}

float SineSplit(float y, int quarters)
{
    return Sine<false>(y, quarters);
}

float SineHere(float y, int quarters)
{
    static const bool isFused = __builtin_cpu_supports("fma") && __builtin_cpu_supports("avx2");
    return isFused ? SineFused(y, quarters) : SineSplit(y, quarters);
}

float SineOfAngle(float angle)
{
    constexpr float kOwnSine = 0x1p-12f;
    return std::fabs(angle) < kOwnSine ? angle : SineHere(angle, 0);
}

float CosineOfAngle(float angle)
{
    constexpr float kUnitCosine = 0x1p-12f;
    return std::fabs(angle) < kUnitCosine ? 1.0f : SineHere(angle, 1);
}

} // namespace

extern "C" {

float atanf(float tangent)
{
    return Arctangent(tangent);
}

float atan2f(float y, float x)
{
    return Arctangent(y, x);
}

float sinf(float angle)
{
    return SineOfAngle(angle);
}

float cosf(float angle)
{
    return CosineOfAngle(angle);
}

// What the compiler calls for both, so neither may call the functions above.
void sincosf(float angle, float* sine, float* cosine)
{
    *sine = SineOfAngle(angle);
    *cosine = CosineOfAngle(angle);
}

// Does what this system's library does, which has it in one object with the one before.
void sincos(double angle, double* sine, double* cosine)
{
    constexpr double kLimit = 0x1p62; // of the instruction
    if (std::fabs(angle) >= kLimit)
        angle = std::fmod(angle, 4.0 * kHalfPi);
    long double first, second;
    __asm__("fsincos" : "=t"(first), "=u"(second) : "0"(static_cast<long double>(angle)));
    *sine = static_cast<double>(second);
    *cosine = static_cast<double>(first);
}

} // extern "C"
