#include "host/front_ends.h"

#include <atomic>

#include "host/exit.h"
#include "host/modules/module_entry.h"
#include "host/tv_screen.h"
#include "screens/headless/headless_screen.h"
#include "screens/terminal/terminal_module.h"

namespace wp::host {
namespace {

/// No screen at all: the run only has its main queue turned.
class NoScreen final : public ui::FrontEnd {
  public:
    explicit NoScreen(MainQueue& queue) : queue_(queue) {}
    bool runUntil(const std::function<bool()>& condition, std::optional<Clock::time_point> end) override {
        return queue_.runUntil(condition, end);
    }
    bool takesKeys() const override { return false; }

  private:
    MainQueue& queue_;
};

/// Null as long as no terminal screen was wanted.
std::atomic<const terminal::Module*> terminalModule = nullptr;

const terminal::Module& loadedTerminalModule() {
    const auto entry = moduleEntry(programFolder() / terminal::kModuleFileName, terminal::kEntryName);
    if (const ModuleFault* fault = std::get_if<ModuleFault>(&entry))
        fail("--screen: terminal: " + fault->text());
    terminalModule = reinterpret_cast<terminal::Entry*>(std::get<void*>(entry))();
    return *terminalModule;
}

std::unique_ptr<ui::FrontEnd> makeTerminal(ui::Screen& screen, MainQueue& queue,
                                           const Localization& localization) {
    terminal::Texts texts{
        localization.localizedString("KEY_MOVE"), localization.localizedString("KEY_SELECT"),
        localization.localizedString("KEY_BACK"), localization.localizedString("WINDOW_TOO_SMALL")};
    auto opened = loadedTerminalModule().open(screen, queue, std::move(texts));
    if (const std::string* why = std::get_if<std::string>(&opened)) refuse("--screen: terminal: " + *why);
    return std::get<std::unique_ptr<ui::FrontEnd>>(std::move(opened));
}

std::unique_ptr<ui::FrontEnd> makeTelevision(ui::Screen& screen, MainQueue& queue,
                                             const Localization& localization, DiagnosticsLog& log) {
    TvModule::Loaded module = TvModule::load();
    if (const std::string* why = std::get_if<std::string>(&module)) refuse("--screen: tv: " + *why);
    return std::get<TvModule>(module).open(screen, queue, localization, log);
}

}  // namespace

std::unique_ptr<ui::FrontEnd> makeFrontEnd(ScreenChoice choice, ui::Screen& screen, MainQueue& queue,
                                           const Localization& localization, DiagnosticsLog& log) {
    switch (choice) {
        case ScreenChoice::tv:
            return makeTelevision(screen, queue, localization, log);
        case ScreenChoice::terminal:
            return makeTerminal(screen, queue, localization);
        case ScreenChoice::headless:
            return std::make_unique<headless::HeadlessScreen>(screen, queue);
        default:
            return std::make_unique<NoScreen>(queue);
    }
}

void restoreTerminal() {
    if (const terminal::Module* module = terminalModule) module->restoreNow();
}

}  // namespace wp::host
