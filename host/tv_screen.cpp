#include "host/tv_screen.h"

#include <dlfcn.h>
#include <unistd.h>

#include <atomic>

#include "host/exit.h"
#include "host/modules/module_entry.h"

namespace wp::host {
namespace {

std::string loaderReason() {
    const char* reason = dlerror();
    return reason ? reason : "no reason given";
}

tv::Texts textsOf(const Localization& localization) {
    auto text = [&](const char* key) { return localization.localizedString(key); };
    return {
        text("KEYBOARD_SHIFT"), text("KEYBOARD_SYMBOLS"), text("KEYBOARD_LETTERS"), text("KEYBOARD_BLANK"),
        text("KEYBOARD_LEFT"),  text("KEYBOARD_RIGHT"),   text("KEYBOARD_ERASE"),   text("DONE")};
}

}  // namespace

TvModule::Loaded TvModule::load() {
    std::filesystem::path file = programFolder() / tv::kModuleFileName;
    std::error_code error;
    if (!std::filesystem::exists(file, error))
        return "this build has no television screen (there is no " + std::string(tv::kModuleFileName) +
               " beside the program)";
    void* handle = dlopen(file.c_str(), RTLD_NOW | RTLD_LOCAL | RTLD_NODELETE);
    if (!handle) return "the television screen cannot be loaded: " + loaderReason();
    auto* open = reinterpret_cast<tv::Open*>(dlsym(handle, tv::kOpenName));
    if (!open) return file.string() + ": is no television screen";
    return TvModule(open);
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
