// Decoding 8-bit sRGB pictures to linear light, as the viewer does for
// every image set from Qt: through the table that OpenColorIO fills once,
// against a table of the curve written out by hand (what the viewer used
// before) and against OpenColorIO's processor run over every value.
#include "orbane/ColourSpaces.h"

#include <benchmark/benchmark.h>

#include <array>
#include <cmath>
#include <random>
#include <vector>

namespace {

constexpr int kWidth = 1920, kHeight = 1080;

const std::vector<unsigned char> &Codes()
{
    static const std::vector<unsigned char> codes = [] {
        std::vector<unsigned char> c(std::size_t(kWidth) * kHeight * 4);
        std::mt19937 random(5);
        for (unsigned char &v : c)
            v = static_cast<unsigned char>(random() & 0xFF);
        return c;
    }();
    return codes;
}

void Decode(const std::array<float, 256> &table, std::vector<float> &out)
{
    const std::vector<unsigned char> &codes = Codes();
    for (std::size_t i = 0; i < codes.size(); ++i)
        out[i] = table[codes[i]];
}

void BM_Srgb8Decode_Table(benchmark::State &state)
{
    std::vector<float> out(Codes().size());
    const std::array<float, 256> &table = Orbane::ColourSpaces::Srgb8ToLinear();
    for (auto _ : state) {
        Decode(table, out);
        benchmark::DoNotOptimize(out.data());
    }
}
BENCHMARK(BM_Srgb8Decode_Table)->Unit(benchmark::kMillisecond);

void BM_Srgb8Decode_HandTable(benchmark::State &state)
{
    std::vector<float> out(Codes().size());
    std::array<float, 256> table{};
    for (int i = 0; i < 256; ++i) {
        const double v = i / 255.0;
        table[std::size_t(i)] = float(v <= 0.04045 ? v / 12.92 : std::pow((v + 0.055) / 1.055, 2.4));
    }
    for (auto _ : state) {
        Decode(table, out);
        benchmark::DoNotOptimize(out.data());
    }
}
BENCHMARK(BM_Srgb8Decode_HandTable)->Unit(benchmark::kMillisecond);

// Without the table: every value through the processor (alpha left alone).
void BM_Srgb8Decode_Processor(benchmark::State &state)
{
    const std::vector<unsigned char> &codes = Codes();
    std::vector<float> values(codes.size());
    for (auto _ : state) {
        for (std::size_t i = 0; i < codes.size(); ++i)
            values[i] = codes[i] / 255.0f;
        Orbane::ColourSpaces::SrgbToLinear(values.data(), codes.size() / 4, 4, true);
        benchmark::DoNotOptimize(values.data());
    }
}
BENCHMARK(BM_Srgb8Decode_Processor)->Unit(benchmark::kMillisecond);

} // namespace
