#include "host/tv_screen.h"

#include <unistd.h>

#include <atomic>

#include "host/exit.h"
#include "host/modules/module_entry.h"

namespace wp::host {
namespace {

std::string described(const ModuleFault& fault, const std::filesystem::path& file) {
    switch (fault.kind) {
        case ModuleFault::Kind::absent:
            return "this build has no television screen (there is no " + std::string(tv::kModuleFileName) +
                   " beside the program)";
        case ModuleFault::Kind::notLoadable:
            return "the television screen cannot be loaded: " + fault.reason;
        default:
            return file.string() + ": is no television screen";
    }
}

tv::Texts textsOf(const Localization& localization) {
    auto text = [&](const char* key) { return localization.localizedString(key); };
    return {
        text("KEYBOARD_SHIFT"), text("KEYBOARD_SYMBOLS"), text("KEYBOARD_LETTERS"), text("KEYBOARD_BLANK"),
        text("KEYBOARD_LEFT"),  text("KEYBOARD_RIGHT"),   text("KEYBOARD_ERASE"),   text("DONE")};
}

}  // namespace

TvModule::Loaded TvModule::load() {
    const std::filesystem::path file = programFolder() / tv::kModuleFileName;
    const auto entry = moduleEntry(file, tv::kOpenName);
    if (const ModuleFault* fault = std::get_if<ModuleFault>(&entry)) return described(*fault, file);
    return TvModule(reinterpret_cast<tv::Open*>(std::get<void*>(entry)));
}

std::unique_ptr<ui::FrontEnd> TvModule::open(ui::Screen& screen, MainQueue& queue,
                                             const Localization& localization, DiagnosticsLog& log) const {
    tv::Opening opening{.screen = screen, .queue = queue, .texts = textsOf(localization)};
    opening.note = [&log](std::string_view line) { log.note(line); };
    // The toolkit ends the process where it loses its display; only our line comes first.
    auto isOpen = std::make_shared<std::atomic<bool>>(false);
    opening.leave = [isOpen, &log](std::string_view reason) {
        log.eraseProgress();
        log.message((*isOpen ? "the display is gone: " : "--screen: tv: ") + std::string(reason));
        _exit(*isOpen ? exit_status::failure : exit_status::unusable);
    };
    open_(opening);
    if (!opening.frontEnd) refuse("--screen: tv: " + opening.problem);
    *isOpen = true;
    return std::move(opening.frontEnd);
}

}  // namespace wp::host
