// Kernels for scaling pictures, one function per row. Each interval includes its left end and excludes its
// right end, so two samples at the same distance on both sides never count twice.

#include "CFilter.h"

#include "SystemMath.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace gw {

namespace {

constexpr double kPi = std::numbers::pi;

struct MitchellData
{
    double p0, p1, p2;
    double q0, q1, q2, q3;
};

struct KaiserData
{
    double a;
    double i0a; // 1 / I0(a)
};

double Box(double x, const void*)
{
    return x >= -0.5 && x < 0.5 ? 1.0 : 0.0;
}

double Triangle(double x, const void*)
{
    if (x < -1.0 || x >= 1.0)
        return 0.0;
    return x < 0.0 ? 1.0 + x : 1.0 - x;
}

double Quadratic(double x, const void*)
{
    if (x < -1.5 || x >= 1.5)
        return 0.0;
    if (x < -0.5)
        return 0.5 * (x + 1.5) * (x + 1.5);
    return x < 0.5 ? 0.75 - x * x : 0.5 * (x - 1.5) * (x - 1.5);
}

double Cubic(double x, const void*)
{
    if (x < -2.0 || x >= 2.0)
        return 0.0;
    if (x < -1.0)
        return (x + 2.0) * (x + 2.0) * (x + 2.0) / 6.0;
    if (x < 0.0)
        return (x * x * (-6.0 - 3.0 * x) + 4.0) / 6.0;
    if (x < 1.0)
        return (x * x * (3.0 * x - 6.0) + 4.0) / 6.0;
    return (2.0 - x) * (2.0 - x) * (2.0 - x) / 6.0;
}

double CatmullRom(double x, const void*)
{
    if (x < -2.0 || x >= 2.0)
        return 0.0;
    if (x < -1.0)
        return 0.5 * (x * ((x + 5.0) * x + 8.0) + 4.0);
    if (x < 0.0)
        return 0.5 * (x * x * (-5.0 - 3.0 * x) + 2.0);
    if (x < 1.0)
        return 0.5 * (x * x * (3.0 * x - 5.0) + 2.0);
    return 0.5 * (x * ((5.0 - x) * x - 8.0) + 4.0);
}

double Mitchell(double x, const void* clientData)
{
    if (!clientData || x < -2.0 || x >= 2.0)
        return 0.0;
    const auto& [p0, p1, p2, q0, q1, q2, q3] = *static_cast<const MitchellData*>(clientData);
    if (x < -1.0)
        return q0 - x * (q1 - x * (q2 - x * q3));
    if (x < 0.0)
        return x * x * (p1 - x * p2) + p0;
    if (x < 1.0)
        return x * x * (p1 + x * p2) + p0;
    return x * ((x * q3 + q2) * x + q1) + q0;
}

void InitMitchell(CFilter& filter, double b, double c)
{
    filter.clientData = std::make_shared<MitchellData>(MitchellData{
        (6.0 - 2.0 * b) / 6.0,
        (12.0 * b + 6.0 * c - 18.0) / 6.0,
        (12.0 - 9.0 * b - 6.0 * c) / 6.0,
        (8.0 * b + 24.0 * c) / 6.0,
        (-12.0 * b - 48.0 * c) / 6.0,
        (6.0 * b + 30.0 * c) / 6.0,
        (-b - 6.0 * c) / 6.0,
    });
}

// Only the support limits it.
double Gaussian(double x, const void*)
{
    return std::exp(-2.0 * x * x) * std::sqrt(2.0 / kPi);
}

double Sinc(double x, const void*)
{
    return x == 0.0 ? 1.0 : std::sin(kPi * x) / (kPi * x);
}

double Bessel(double x, const void*)
{
    return x == 0.0 ? kPi / 4.0 : BesselJ1(kPi * x) / (2.0 * x);
}

double Hanning(double x, const void*)
{
    return 0.5 + 0.5 * std::cos(kPi * x);
}

double Hamming(double x, const void*)
{
    return 0.54 + 0.46 * std::cos(kPi * x);
}

double Blackman(double x, const void*)
{
    return 0.42 + 0.5 * std::cos(kPi * x) + 0.08 * std::cos(2.0 * kPi * x);
}

double Kaiser(double x, const void* clientData)
{
    if (!clientData)
        return 0.0;
    const auto& [a, i0a] = *static_cast<const KaiserData*>(clientData);
    return BesselI0(a * std::sqrt(1.0 - x * x)) * i0a;
}

void InitKaiser(CFilter& filter, double a, double)
{
    filter.clientData = std::make_shared<KaiserData>(KaiserData{a, 1.0 / BesselI0(a)});
}

// Name, function, support, blur, needs a window, cardinal, unit range, init, print, client data.
const CFilter kFilters[] = {
    {"point",     Box,        0.0,    1.0, false, true,  true,  nullptr,      nullptr, nullptr},
    {"box",       Box,        0.5,    1.0, false, true,  true,  nullptr,      nullptr, nullptr},
    {"triangle",  Triangle,   1.0,    1.0, false, true,  true,  nullptr,      nullptr, nullptr},
    {"quadratic", Quadratic,  1.5,    1.0, false, false, true,  nullptr,      nullptr, nullptr},
    {"cubic",     Cubic,      2.0,    1.0, false, false, true,  nullptr,      nullptr, nullptr},
    {"catrom",    CatmullRom, 2.0,    1.0, false, true,  false, nullptr,      nullptr, nullptr},
    {"mitchell",  Mitchell,   2.0,    1.0, false, false, false, InitMitchell, nullptr, nullptr},
    {"gaussian",  Gaussian,   1.25,   1.0, false, false, true,  nullptr,      nullptr, nullptr},
    {"sinc",      Sinc,       4.0,    1.0, true,  true,  false, nullptr,      nullptr, nullptr},
    {"bessel",    Bessel,     3.2383, 1.0, true,  false, false, nullptr,      nullptr, nullptr},
    {"hanning",   Hanning,    1.0,    1.0, false, true,  true,  nullptr,      nullptr, nullptr},
    {"hamming",   Hamming,    1.0,    1.0, false, true,  true,  nullptr,      nullptr, nullptr},
    {"blackman",  Blackman,   1.0,    1.0, false, true,  true,  nullptr,      nullptr, nullptr},
    {"kaiser",    Kaiser,     1.0,    1.0, false, true,  true,  InitKaiser,   nullptr, nullptr},
};

} // namespace

std::span<const CFilter> Filters()
{
    return kFilters;
}

const CFilter* FindFilter(std::string_view name)
{
    const auto* found = std::ranges::find(kFilters, name, &CFilter::name);
    return found == std::end(kFilters) ? nullptr : found;
}

// The power series. Beyond the range of a double the sum is infinite and no term gets small, and comparisons
// with NaN are false; both end the loop.
double BesselI0(double x)
{
    constexpr double kSmallest = 1e-7;
    const double y = x * x / 4.0;
    if (y <= kSmallest)
        return 1.0;
    double sum = 1.0;
    double term = y;
    double i = 2.0;
    do
    {
        sum += term;
        term *= y / (i * i);
        i += 1.0;
    } while (term > kSmallest && std::isfinite(sum));
    return sum;
}

} // namespace gw
