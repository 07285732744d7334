#include "screens/terminal/terminfo.h"

#define NCURSES_NOMACROS 1
#include <curses.h>
#include <term.h>

#include <cstdint>
#include <cstdlib>

#include "platform/ui/display_text.h"

namespace wp::terminal {
namespace {

const char* capability(const char* name) {
    const char* value = tigetstr(name);
    bool isMissing = value == nullptr || reinterpret_cast<std::intptr_t>(value) == -1;
    return isMissing ? nullptr : value;
}

std::string leavingSequence() {
    std::string sequence;
    for (const char* name : {"sgr0", "rmkx", "cnorm", "rmcup"})
        if (const char* value = capability(name)) sequence += withoutPadding(value);
    return sequence;
}

}  // namespace

TerminalDescription describeTerminal(int descriptor) {
    const char* term = std::getenv("TERM");
    if (term == nullptr || *term == '\0') return {"TERM is not set, so nothing is known of the terminal", ""};
    std::string name = "\"" + ui::displayForm(term) + "\"";
    int status = 0;
    if (setupterm(term, descriptor, &status) != OK)
        return {"nothing is known of a terminal " + name + " (TERM)", ""};
    TerminalDescription description{std::nullopt, leavingSequence()};
    if (capability("cup") == nullptr || capability("clear") == nullptr)
        description.unfit = "a terminal " + name + " (TERM) cannot place text on its screen";
    del_curterm(cur_term);
    return description;
}

std::string withoutPadding(std::string capability) {
    for (std::size_t begin = 0; (begin = capability.find("$<", begin)) != std::string::npos;) {
        std::size_t end = capability.find('>', begin);
        if (end == std::string::npos) break;
        capability.erase(begin, end + 1 - begin);
    }
    return capability;
}

}  // namespace wp::terminal
