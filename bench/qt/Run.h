#pragma once

#include <benchmark/benchmark.h>
#include <malloc.h>

#include <QApplication>

namespace tessel::bench {

/// The program of the benchmarks that need the toolkit: without a screen unless `QT_QPA_PLATFORM` names one, in a look that every
/// machine has.
template <class Application = QApplication>
int Run(int count, char** arguments) {
    mallopt(M_ARENA_MAX, 1);  // what other threads hold is counted too
    if (!qEnvironmentVariableIsSet("QT_QPA_PLATFORM")) qputenv("QT_QPA_PLATFORM", "offscreen");
    Application program(count, arguments);
    QApplication::setStyle("Fusion");
    benchmark::Initialize(&count, arguments);
    benchmark::RunSpecifiedBenchmarks();
    return 0;
}

}  // namespace tessel::bench
