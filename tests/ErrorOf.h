#pragma once

#include "frame/Error.h"

namespace tessel::test {

/// The number of the error that `run` ends with; 0 for none.
template <class F>
int ErrorOf(F&& run) {
    try {
        run();
    } catch (const frame::ControlError& error) {
        return error.Number();
    }
    return 0;
}

}  // namespace tessel::test
