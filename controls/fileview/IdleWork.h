#pragma once

#include <functional>
#include <string>

#include "frame/host.h"

namespace tessel::controls {

/// Has work done in small steps while the program has nothing else to do.
class IdleWork final : private frame::TimerClient {
  public:
    /// `step` does some of the work and gives false when nothing is left. `where` names the place for error reports.
    IdleWork(frame::Host& host, std::function<std::string()> where, std::function<bool()> step)
        : host_(host), where_(std::move(where)), step_(std::move(step)) {}
    IdleWork(const IdleWork&) = delete;
    IdleWork& operator=(const IdleWork&) = delete;
    ~IdleWork() override { Stop(); }

    void Start();

  private:
    void Stop();
    void Tick() override;

    frame::Host& host_;
    std::function<std::string()> where_;
    std::function<bool()> step_;
    bool runs_ = false;
};

}  // namespace tessel::controls
