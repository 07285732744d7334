#pragma once

#include <memory>
#include <optional>
#include <string>
#include <variant>

#include "host/diagnostics_log.h"
#include "platform/localization.h"
#include "screens/tv/tv_module.h"

namespace wp::host {

/// The television screen's module, loaded for the rest of the process. No run that does without that screen
/// touches the module or its toolkit.
class TvModule {
  public:
    using Loaded = std::variant<TvModule, std::string>;

    /// Loads the module beside the program. The text says why there is none. *Main*.
    static Loaded load();

    /// The front end, which mirrors the screen from now on. Throws `Exit` (status 2) with the reason where it
    /// cannot be had. Nothing is kept alive. *Main*.
    std::unique_ptr<ui::FrontEnd> open(ui::Screen& screen, MainQueue& queue, const Localization& localization,
                                       DiagnosticsLog& log) const;

  private:
    explicit TvModule(tv::Open* entry) : open_(entry) {}

    tv::Open* open_;
};

}  // namespace wp::host
