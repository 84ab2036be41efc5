// How MaskedBlend over a whole 640 × 480 24-bit background compares with copying that
// background, which every paint does anyway. The goal is a blend within 5× of the copy.
#include <benchmark/benchmark.h>

#include <cmath>
#include <cstdint>
#include <cstdio>
#include <cstring>
#include <random>
#include <string>
#include <utility>
#include <vector>

#include "graphics/dib.h"
#include "graphics/masked_blend.h"

namespace {

constexpr std::int32_t kWidth = 640;
constexpr std::int32_t kHeight = 480;
constexpr std::size_t kFrameBytes = std::size_t{kWidth} * kHeight * 3;

std::uint8_t* Pixels(DibBitmap* picture) {
    std::uint8_t* pixels = nullptr;
    std::uint32_t stride = 0;
    std::uint16_t bitCount = 0;
    DibRowInfo(picture, pixels, stride, bitCount);
    return pixels;
}

DibPtr RandomFrame(std::uint32_t seed) {
    DibPtr frame(CreateDib(kWidth, kHeight, 24));
    std::mt19937 random(seed);
    std::uint8_t* pixels = Pixels(frame.get());
    for (std::size_t i = 0; i < kFrameBytes; ++i) pixels[i] = static_cast<std::uint8_t>(random());
    return frame;
}

// Every pixel needs arithmetic: the value of the launcher's opaque mask.
DibPtr UniformMask(std::uint8_t value) {
    DibPtr mask(CreateDib(kWidth, kHeight, 8));
    std::memset(Pixels(mask.get()), value, std::size_t{kWidth} * kHeight);
    return mask;
}

// The launcher's own opaque mask mixes 251 and 252; here at random, so no run is long.
DibPtr DitheredMask() {
    DibPtr mask(CreateDib(kWidth, kHeight, 8));
    std::mt19937 random(3);
    std::uint8_t* pixels = Pixels(mask.get());
    for (std::size_t i = 0; i < std::size_t{kWidth} * kHeight; ++i) {
        pixels[i] = static_cast<std::uint8_t>(251 + (random() & 1));
    }
    return mask;
}

// A round button's mask: 255 inside, 0 outside, a one-pixel anti-aliased ring between.
DibPtr CircleMask() {
    DibPtr mask(CreateDib(kWidth, kHeight, 8));
    std::uint8_t* pixels = Pixels(mask.get());
    const double radius = 200.0;
    for (std::int32_t y = 0; y < kHeight; ++y) {
        for (std::int32_t x = 0; x < kWidth; ++x) {
            double distance = std::hypot(x + 0.5 - kWidth / 2.0, y + 0.5 - kHeight / 2.0);
            double cover = std::fmin(1.0, std::fmax(0.0, radius + 0.5 - distance));
            pixels[std::size_t(y) * kWidth + x] = static_cast<std::uint8_t>(cover * 255.0 + 0.5);
        }
    }
    return mask;
}

void BM_CopyFrame(benchmark::State& state) {
    DibPtr source = RandomFrame(1);
    DibPtr destination = RandomFrame(2);
    for (auto _ : state) {
        std::memcpy(Pixels(destination.get()), Pixels(source.get()), kFrameBytes);
        benchmark::ClobberMemory();
    }
    state.SetBytesProcessed(static_cast<std::int64_t>(state.iterations() * kFrameBytes));
}

void RunBlend(benchmark::State& state, const DibPtr& mask) {
    DibPtr picture = RandomFrame(1);
    DibPtr background = RandomFrame(2);
    for (auto _ : state) {
        MaskedBlend(picture.get(), {0, 0}, background.get(), {0, 0}, mask.get(), {0, 0},
                    background.get(), {0, 0}, {kWidth, kHeight});
        benchmark::ClobberMemory();
    }
    state.SetBytesProcessed(static_cast<std::int64_t>(state.iterations() * kFrameBytes));
}

void BM_BlendOpaqueMask(benchmark::State& state) {
    RunBlend(state, UniformMask(252));
}

void BM_BlendCircleMask(benchmark::State& state) {
    RunBlend(state, CircleMask());
}

void BM_BlendDitheredMask(benchmark::State& state) {
    RunBlend(state, DitheredMask());
}

// The rule written the obvious way, one byte at a time, for comparison.
void BM_BlendPlainLoop(benchmark::State& state) {
    DibPtr picture = RandomFrame(1);
    DibPtr background = RandomFrame(2);
    DibPtr mask = UniformMask(252);
    const std::uint8_t* a = Pixels(picture.get());
    std::uint8_t* d = Pixels(background.get());
    const std::uint8_t* m = Pixels(mask.get());
    for (auto _ : state) {
        for (std::size_t i = 0; i < std::size_t{kWidth} * kHeight; ++i) {
            unsigned weight = m[i];
            for (std::size_t k = i * 3; k < i * 3 + 3; ++k) {
                if (weight == 255) {
                    d[k] = a[k];
                } else if (weight != 0) {
                    d[k] = static_cast<std::uint8_t>((a[k] * weight + d[k] * (255 - weight)) >> 8);
                }
            }
        }
        benchmark::ClobberMemory();
    }
    state.SetBytesProcessed(static_cast<std::int64_t>(state.iterations() * kFrameBytes));
}

BENCHMARK(BM_CopyFrame);
BENCHMARK(BM_BlendOpaqueMask);
BENCHMARK(BM_BlendCircleMask);
BENCHMARK(BM_BlendDitheredMask);
BENCHMARK(BM_BlendPlainLoop);

// Shows the usual table and keeps each case's time for the ratios printed at the end.
class RatioReporter : public benchmark::ConsoleReporter {
  public:
    void ReportRuns(const std::vector<Run>& reports) override {
        ConsoleReporter::ReportRuns(reports);
        for (const Run& run : reports) {
            if (run.error_occurred) continue;
            // With repetitions the median stands for the case; otherwise the single run.
            if (run.run_type == Run::RT_Aggregate && run.aggregate_name != "median") continue;
            // CPU time: on a shared machine it leaves out the time the benchmark was not running.
            Record(run.run_name.function_name, run.GetAdjustedCPUTime() * Scale(run.time_unit));
        }
    }

    void PrintRatios() const {
        double copy = 0;
        for (const auto& [name, time] : nanoseconds) {
            if (name == "BM_CopyFrame") copy = time;
        }
        if (copy <= 0) return;
        std::printf("\nCPU time against copying the %zu-byte frame (goal: blend within 5x):\n",
                    kFrameBytes);
        for (const auto& [name, time] : nanoseconds) {
            std::printf("  %-20s %10.1f us  = %5.1fx copy\n", name.c_str(), time / 1000.0,
                        time / copy);
        }
    }

  private:
    static double Scale(benchmark::TimeUnit unit) {
        switch (unit) {
            case benchmark::kSecond:
                return 1e9;
            case benchmark::kMillisecond:
                return 1e6;
            case benchmark::kMicrosecond:
                return 1e3;
            default:
                return 1.0;
        }
    }

    // In the order the cases ran; a later run of a case (its median) replaces the earlier.
    void Record(const std::string& name, double time) {
        for (auto& entry : nanoseconds) {
            if (entry.first == name) {
                entry.second = time;
                return;
            }
        }
        nanoseconds.emplace_back(name, time);
    }

    std::vector<std::pair<std::string, double>> nanoseconds;
};

}  // namespace

int main(int argc, char** argv) {
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    RatioReporter reporter;
    benchmark::RunSpecifiedBenchmarks(&reporter);
    reporter.PrintRatios();
    benchmark::Shutdown();
    return 0;
}
