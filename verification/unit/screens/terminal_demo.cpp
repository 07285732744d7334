// A program that shows a sample list on the terminal, for the tests that look at it from outside.
//
//   terminal_demo [NAMES]     NAMES: a file of network names, each ended by a NUL byte
//
// "Yes" shows the progress screen, "Refresh" turns selection off and on, back ends it with status 3.

#include <cstdio>
#include <fstream>
#include <iterator>

#include "screens/terminal/terminal_screen.h"
#include "verification/unit/screens/sample_controller.h"

namespace {

std::vector<std::string> readNames(const char* file) {
    std::ifstream stream(file, std::ios::binary);
    std::vector<std::string> names;
    for (std::string name; std::getline(stream, name, '\0');) names.push_back(name);
    return names;
}

}  // namespace

int main(int argc, char** argv) {
    wp::Activity activity;
    wp::MainQueue queue(activity);
    wp::ui::Screen screen;
    auto controller = std::make_shared<wp::SampleController>();
    if (argc > 1) controller->names = readNames(argv[1]);
    bool isOver = false;
    screen.setBackHandler([&] { isOver = true; });

    auto opened = wp::terminal::TerminalScreen::open(screen, queue);
    if (auto* why = std::get_if<std::string>(&opened)) {
        std::fprintf(stderr, "%s\n", why->c_str());
        return 2;
    }
    auto& frontEnd = *std::get<std::unique_ptr<wp::terminal::TerminalScreen>>(opened);
    controller->buildViews();
    screen.setRootViewController(controller);
    screen.focusPreferredView();
    frontEnd.runUntil([&] { return isOver || !controller->chosen.empty(); });
    if (!isOver) controller->showProgress(4, 11);
    frontEnd.runUntil([&] { return isOver; });
    opened = "";  // gives the terminal back before anything else is written to it
    std::printf("left\n");
    return 3;
}
