#pragma once

#include <string>

#include "platform/ui/screen.h"
#include "screens/terminal/canvas.h"

namespace wp::terminal {

/// The words that are the terminal screen's own, in the viewer's language.
struct Texts {
    std::string move = "Move";
    std::string select = "Select";
    std::string back = "Back";
    /// Shown alone in a window below `kFewestColumns` by `kFewestRows`.
    std::string tooSmall = "Please make this window larger: at least 60 by 16.";
};

inline constexpr int kFewestColumns = 60;
inline constexpr int kFewestRows = 16;

/// Draws what the view tree holds, by the roles and the order of its views; their points play no part.
/// Updates the list's first line. *Main*.
Canvas draw(const ui::Screen& screen, int rows, int columns, Charset charset, const Texts& texts,
            int& firstLine);

/// How many rows of the list a picture of that height shows at most, for keys that turn a page.
int rowsPerPage(int rows);

}  // namespace wp::terminal
