#pragma once

// Shared by the *_bench.cpp programs: timing over repetitions and the one-line report.

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <string>
#include <utility>
#include <vector>

namespace bench {

// Milliseconds per repetition.
struct Samples {
    std::vector<double> ms;

    double median() const {
        std::vector<double> sorted = ms;
        std::sort(sorted.begin(), sorted.end());
        const std::size_t n = sorted.size();
        return n % 2 ? sorted[n / 2] : (sorted[n / 2 - 1] + sorted[n / 2]) / 2;
    }
    double min() const { return *std::min_element(ms.begin(), ms.end()); }
    double max() const { return *std::max_element(ms.begin(), ms.end()); }
};

// Runs `work` once to warm up, then `repetitions` times, timing each run.
template <class Work> Samples measure(int repetitions, Work&& work) {
    work();
    Samples samples;
    for (int i = 0; i < repetitions; ++i) {
        const auto start = std::chrono::steady_clock::now();
        work();
        const auto end = std::chrono::steady_clock::now();
        samples.ms.push_back(std::chrono::duration<double, std::milli>(end - start).count());
    }
    return samples;
}

// Times `ours` and `baseline` alternately, so that a busy machine slows both alike.
template <class Ours, class Baseline>
std::pair<Samples, Samples> measurePair(int repetitions, Ours&& ours, Baseline&& baseline) {
    ours();
    baseline();
    std::pair<Samples, Samples> samples;
    auto time = [](auto& work, Samples& into) {
        const auto start = std::chrono::steady_clock::now();
        work();
        const auto end = std::chrono::steady_clock::now();
        into.ms.push_back(std::chrono::duration<double, std::milli>(end - start).count());
    };
    for (int i = 0; i < repetitions; ++i) {
        time(ours, samples.first);
        time(baseline, samples.second);
    }
    return samples;
}

// One line: the figure's name, our median, the baseline's median, their ratio, the aim
// (the largest acceptable ratio) and the spread of both.
inline void report(const std::string& name, const Samples& ours, const std::string& baseline,
                   const Samples& base, double aim) {
    const double ratio = ours.median() / base.median();
    std::printf("%-34s ours %9.3f ms | %s %9.3f ms | ratio %5.2f | aim <= %4.2f %s | "
                "ours min/max %.3f/%.3f ms, baseline min/max %.3f/%.3f ms\n",
                name.c_str(), ours.median(), baseline.c_str(), base.median(), ratio, aim,
                ratio <= aim ? "met" : "MISSED", ours.min(), ours.max(), base.min(), base.max());
    std::fflush(stdout);
}

} // namespace bench
