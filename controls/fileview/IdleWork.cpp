#include "controls/fileview/IdleWork.h"

#include <utility>

namespace tessel::controls {

void IdleWork::Start() {
    constexpr int pause = 20;  // milliseconds
    if (!std::exchange(runs_, true)) host_.Clock().Start(*this, pause);
}

void IdleWork::Stop() {
    if (std::exchange(runs_, false)) host_.Clock().Stop(*this);
}

void IdleWork::Tick() {
    frame::Entry::Run(host_, where_, [&] {
        if (!step_()) Stop();
    });
}

}  // namespace tessel::controls
