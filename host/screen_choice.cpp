#include "host/screen_choice.h"

#include "host/exit.h"

namespace wp::host {
namespace {

ScreenChoice automaticScreen(const ScreenSurroundings& surroundings) {
    if (!surroundings.hasList) return ScreenChoice::none;
    if (surroundings.hasTerminal) return ScreenChoice::terminal;
    refuse(
        "--screen: the list needs a screen and there is no terminal; give --screen headless with --remote");
}

}  // namespace

ScreenChoice chooseScreen(ScreenChoice wanted, const ScreenSurroundings& surroundings) {
    ScreenChoice choice = wanted == ScreenChoice::automatic ? automaticScreen(surroundings) : wanted;
    if (choice == ScreenChoice::tv)
        refuse("--screen: this build has no television screen; give terminal, headless or none");
    if (choice == ScreenChoice::none && surroundings.hasList)
        refuse("--screen: none shows no list; give terminal or headless, or a request without the list");
    if (choice == ScreenChoice::none && surroundings.hasScript)
        refuse("--remote: screen none takes no keys; give --screen headless or terminal");
    if (choice == ScreenChoice::terminal && !surroundings.hasTerminal)
        refuse("--screen: there is no terminal; give headless or none");
    return choice;
}

}  // namespace wp::host
