#include "host/screen_choice.h"

#include "host/exit.h"

namespace wp::host {
namespace {

std::optional<std::string> televisionFault(const ScreenSurroundings& surroundings) {
    return surroundings.televisionFault ? surroundings.televisionFault() : std::nullopt;
}

ScreenChoice automaticScreen(const ScreenSurroundings& surroundings) {
    if (!surroundings.hasList) return ScreenChoice::none;
    if (surroundings.hasDisplay && !televisionFault(surroundings)) return ScreenChoice::tv;
    if (surroundings.hasTerminal) return ScreenChoice::terminal;
    refuse(
        "--screen: the list needs a screen and there is no display and no terminal (over ssh: ssh -t); give "
        "--screen tv, or headless with --remote");
}

}  // namespace

ScreenChoice chooseScreen(ScreenChoice wanted, const ScreenSurroundings& surroundings) {
    ScreenChoice choice = wanted == ScreenChoice::automatic ? automaticScreen(surroundings) : wanted;
    if (wanted == ScreenChoice::tv)
        if (std::optional<std::string> fault = televisionFault(surroundings))
            refuse("--screen: tv: " + *fault + "; give terminal" +
                   (surroundings.hasList ? " or headless" : ", headless or none"));
    if (choice == ScreenChoice::none && surroundings.hasList)
        refuse("--screen: none shows no list; give tv, terminal or headless, or a request without the list");
    if (choice == ScreenChoice::none && surroundings.hasScript)
        refuse("--remote: screen none takes no keys; give --screen headless, terminal or tv");
    if (choice == ScreenChoice::terminal && !surroundings.hasTerminal)
        refuse("--screen: there is no terminal (over ssh: ssh -t); give headless" +
               std::string(surroundings.hasList ? "" : " or none"));
    return choice;
}

}  // namespace wp::host
