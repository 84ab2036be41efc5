#include "sound.h"

#include <algorithm>
#include <cmath>

#include "noise.h"

namespace discart {

namespace {

constexpr double kTwoPi = 6.283185307179586;

double MidiFrequency(int note) {
    return 440.0 * std::pow(2.0, (note - 69) / 12.0);
}

// Scales to the given peak and fades both ends, so that nothing clips and nothing pops.
std::vector<int16_t> Finish(std::vector<double> signal, double peak, double fadeIn,
                            double fadeOut) {
    double loudest = 0.0;
    for (double v : signal) loudest = std::max(loudest, std::fabs(v));
    const double gain = loudest > 0.0 ? peak / loudest : 0.0;
    const size_t n = signal.size();
    const size_t inSamples = static_cast<size_t>(fadeIn * kSampleRate);
    const size_t outSamples = static_cast<size_t>(fadeOut * kSampleRate);
    std::vector<int16_t> samples(n);
    for (size_t i = 0; i < n; ++i) {
        double v = signal[i] * gain;
        if (i < inSamples) v *= static_cast<double>(i) / static_cast<double>(inSamples);
        const size_t fromEnd = n - 1 - i;
        if (fromEnd < outSamples) {
            const double t = static_cast<double>(fromEnd) / static_cast<double>(outSamples);
            v *= 0.5 - 0.5 * std::cos(t * kTwoPi * 0.5);
        }
        samples[i] = static_cast<int16_t>(std::lround(std::clamp(v, -1.0, 1.0) * 32767.0));
    }
    return samples;
}

struct Partial {
    double ratio;
    double amplitude;
    double decay;  // seconds to fall by e
};

void AddTone(std::vector<double>& out, double start, double frequency, double velocity,
             const std::vector<Partial>& partials, double attack, double length) {
    const size_t first = static_cast<size_t>(start * kSampleRate);
    const size_t count = static_cast<size_t>(length * kSampleRate);
    for (size_t i = 0; i < count && first + i < out.size(); ++i) {
        const double t = static_cast<double>(i) / kSampleRate;
        const double rise = std::min(1.0, t / attack);
        double v = 0.0;
        for (const Partial& p : partials) {
            v += p.amplitude * std::exp(-t / p.decay) * std::sin(kTwoPi * frequency * p.ratio * t);
        }
        out[first + i] += velocity * rise * v;
    }
}

void AddPad(std::vector<double>& out, double start, double length, const std::vector<int>& notes,
            double level) {
    const size_t first = static_cast<size_t>(start * kSampleRate);
    const double release = 0.6;
    const size_t count = static_cast<size_t>((length + release) * kSampleRate);
    for (int note : notes) {
        const double f = MidiFrequency(note);
        for (size_t i = 0; i < count && first + i < out.size(); ++i) {
            const double t = static_cast<double>(i) / kSampleRate;
            double envelope = std::min(1.0, t / 0.35);
            if (t > length) envelope *= std::max(0.0, 1.0 - (t - length) / release);
            // Two slightly detuned voices give the pad its slow shimmer.
            const double v = std::sin(kTwoPi * f * 1.0015 * t) + std::sin(kTwoPi * f * 0.9985 * t) +
                             0.25 * std::sin(kTwoPi * f * 2.0 * t);
            out[first + i] += level * envelope * v;
        }
    }
}

// A small Schroeder reverberator: four damped combs into two all-passes.
std::vector<double> Reverberate(const std::vector<double>& dry, double wet) {
    const size_t combDelays[] = {557, 593, 638, 677};
    std::vector<double> sum(dry.size(), 0.0);
    for (size_t delay : combDelays) {
        std::vector<double> buffer(delay, 0.0);
        double damped = 0.0;
        size_t at = 0;
        for (size_t i = 0; i < dry.size(); ++i) {
            const double y = buffer[at];
            damped = y * 0.7 + damped * 0.3;
            buffer[at] = dry[i] + damped * 0.8;
            at = (at + 1) % delay;
            sum[i] += y * 0.25;
        }
    }
    for (size_t delay : {size_t{225}, size_t{341}}) {
        std::vector<double> buffer(delay, 0.0);
        size_t at = 0;
        for (double& v : sum) {
            const double delayed = buffer[at];
            const double input = v;
            v = -0.5 * input + delayed;
            buffer[at] = input + 0.5 * delayed;
            at = (at + 1) % delay;
        }
    }
    std::vector<double> out(dry.size());
    for (size_t i = 0; i < dry.size(); ++i) out[i] = dry[i] + wet * sum[i];
    return out;
}

}  // namespace

std::vector<int16_t> SynthesiseClick() {
    const double length = 0.09;
    std::vector<double> signal(static_cast<size_t>(length * kSampleRate));
    Random random(113);
    double previousNoise = 0.0;
    double phase = 0.0;
    for (size_t i = 0; i < signal.size(); ++i) {
        const double t = static_cast<double>(i) / kSampleRate;
        // A quick downward chirp is heard as a soft knock rather than a beep.
        const double frequency = 1100.0 + 800.0 * std::exp(-t / 0.012);
        phase += kTwoPi * frequency / kSampleRate;
        const double tock = std::sin(phase) * std::exp(-t / 0.016);
        const double body = 0.35 * std::sin(kTwoPi * 620.0 * t) * std::exp(-t / 0.028);
        const double noise = random.Unit() * 2.0 - 1.0;
        const double crisp = 0.3 * (noise - previousNoise) * std::exp(-t / 0.0025);
        previousNoise = noise;
        signal[i] = tock + body + crisp;
    }
    return Finish(std::move(signal), 0.55, 0.001, 0.015);
}

std::vector<int16_t> SynthesiseStartupMusic() {
    const double length = 5.6;
    std::vector<double> music(static_cast<size_t>(length * kSampleRate), 0.0);
    const std::vector<Partial> harp = {
        {1.0, 1.0, 0.55}, {2.0, 0.45, 0.3}, {3.0, 0.2, 0.18}, {4.0, 0.1, 0.12}};
    const std::vector<Partial> bell = {
        {1.0, 1.0, 1.1}, {2.0, 0.35, 0.6}, {3.0, 0.12, 0.35}, {4.07, 0.08, 0.2}};
    const std::vector<Partial> bass = {{1.0, 1.0, 1.2}, {2.0, 0.3, 0.5}};

    const int flourish[] = {62, 66, 69, 74, 78, 81};
    for (int i = 0; i < 6; ++i) {
        AddTone(music, 0.02 + 0.085 * i, MidiFrequency(flourish[i]), 0.32 + 0.03 * i, harp, 0.004,
                2.0);
    }
    struct Note {
        double start;
        int note;
        double velocity;
    };
    const Note melody[] = {
        {0.70, 81, 0.55}, {1.15, 83, 0.42}, {1.37, 81, 0.42}, {1.59, 78, 0.5},  {2.04, 74, 0.5},
        {2.49, 76, 0.5},  {2.94, 78, 0.42}, {3.16, 79, 0.42}, {3.38, 81, 0.55},
    };
    for (const Note& n : melody)
        AddTone(music, n.start, MidiFrequency(n.note), n.velocity, bell, 0.003, 2.2);
    const Note closing[] = {{3.62, 74, 0.32}, {3.69, 78, 0.3}, {3.76, 81, 0.3}, {3.83, 86, 0.34}};
    for (const Note& n : closing)
        AddTone(music, n.start, MidiFrequency(n.note), n.velocity, harp, 0.004, 2.0);
    AddTone(music, 3.83, MidiFrequency(86), 0.25, bell, 0.003, 1.77);

    AddPad(music, 0.6, 1.8, {62, 66, 69}, 0.035);
    AddPad(music, 2.4, 0.7, {55, 59, 62}, 0.035);
    AddPad(music, 3.1, 0.5, {57, 61, 64}, 0.035);
    AddPad(music, 3.6, 1.4, {50, 57, 62, 66}, 0.035);
    AddTone(music, 0.6, MidiFrequency(50), 0.3, bass, 0.02, 1.8);
    AddTone(music, 2.4, MidiFrequency(43), 0.3, bass, 0.02, 0.7);
    AddTone(music, 3.1, MidiFrequency(45), 0.3, bass, 0.02, 0.5);
    AddTone(music, 3.6, MidiFrequency(38), 0.34, bass, 0.02, 2.0);

    return Finish(Reverberate(music, 0.35), 0.7, 0.005, 0.7);
}

}  // namespace discart
