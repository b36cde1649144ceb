#pragma once

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdint>
#include <map>
#include <string>
#include <utility>
#include <vector>

#include "bench/FilePeers.h"

namespace tessel::bench {

/// Several ways to do the same, one after the other in each round, so that whatever slows the machine slows all of them. The report
/// has the median of each in milliseconds of processor time, and how many times as long the library takes: "ratio_to_bare".
class Contest {
  public:
    explicit Contest(benchmark::State& state) : state_(state) {}
    Contest(const Contest&) = delete;
    Contest& operator=(const Contest&) = delete;
    ~Contest() {
        const double own = Median(own_);
        for (auto& [name, times] : peers_) {
            const double peer = Median(times);
            state_.counters[name + "_ms"] = peer;
            if (peer > 0 && own > 0) state_.counters["ratio_to_" + name] = own / peer;
        }
        for (auto& [name, values] : others_) state_.counters[name] = Median(values);
        if (own > 0) state_.counters["own_ms"] = own;
    }

    /// What the library does; it is the time of the round.
    template <class F>
    void Own(F&& run) {
        const double time = Time(run);
        own_.push_back(time);
        state_.SetIterationTime(time / 1e3);
    }
    template <class F>
    void Peer(const std::string& name, F&& run) {
        peers_[name].push_back(Time(run));
    }
    /// A program of the system; one that is missing or fails has no figures.
    void Program(const std::string& name, const std::vector<std::string>& words) {
        const double start = ProcessorTimeOfChildren();
        if (RunProgram(words)) peers_[name].push_back(ProcessorTimeOfChildren() - start);
    }
    /// Another figure, of which the median is reported.
    void Figure(const std::string& name, double value) { others_[name].push_back(value); }

    template <class F>
    static double Time(F&& run) {
        const double start = ProcessorTime();
        run();
        return ProcessorTime() - start;
    }

  private:
    static double Median(std::vector<double>& values) {
        if (values.empty()) return 0;
        const auto middle = values.begin() + static_cast<std::ptrdiff_t>(values.size() / 2);
        std::nth_element(values.begin(), middle, values.end());
        return *middle;
    }

    benchmark::State& state_;
    std::vector<double> own_;
    std::map<std::string, std::vector<double>> peers_, others_;
};

/// Ends a benchmark as failed that has not done its work.
inline void Expect(benchmark::State& state, std::int64_t found, std::int64_t expected) {
    if (found != expected) state.SkipWithError(("found " + std::to_string(found) + " of " + std::to_string(expected)).c_str());
}

}  // namespace tessel::bench
