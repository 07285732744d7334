// What the host finds in the module by name.

#include "screens/tv/tv_module.h"
#include "screens/tv/tv_screen.h"

extern "C" __attribute__((visibility("default"))) void wifiProfileOpenTvScreen(wp::tv::Opening& opening) {
    using namespace wp::tv;
    if (opening.version != kInterfaceVersion) {
        opening.problem = "built for version " + std::to_string(kInterfaceVersion) +
                          " of the interface; this program has version " + std::to_string(opening.version);
        return;
    }
    TvScreen::Opened opened =
        TvScreen::open(opening.screen, opening.queue, opening.texts, {opening.note, opening.leave});
    if (std::string* why = std::get_if<std::string>(&opened)) {
        opening.problem = std::move(*why);
    } else {
        opening.frontEnd = std::move(std::get<std::unique_ptr<TvScreen>>(opened));
    }
}
