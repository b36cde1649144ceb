#pragma once

#include "frame/host.h"

namespace tessel::frame {

/// The code page Windows-1252: what a host offers unless its program asks for another.
class Windows1252 final : public CodePage {
  public:
    std::optional<std::string> ToNarrow(std::string_view text) override;
    std::string FromNarrow(std::string_view bytes) override;
};

}  // namespace tessel::frame
