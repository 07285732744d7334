#include "screens/tv/key_map.h"

namespace wp::tv {
namespace {

/// From the kernel's number of a key to the one that X and Wayland use.
constexpr std::uint32_t kOffset = 8;
constexpr std::uint32_t kOk = 352 + kOffset;
constexpr std::uint32_t kSelect = 353 + kOffset;
constexpr std::uint32_t kBack = 158 + kOffset;
constexpr std::uint32_t kExit = 174 + kOffset;

std::optional<ui::Key> byScanCode(std::uint32_t scanCode) {
    if (scanCode == kOk || scanCode == kSelect) return ui::Key::select;
    if (scanCode == kBack || scanCode == kExit) return ui::Key::back;
    return std::nullopt;
}

}  // namespace

std::optional<ui::Key> keyOf(Qt::Key key, std::uint32_t scanCode) {
    switch (key) {
        case Qt::Key_Up:
            return ui::Key::up;
        case Qt::Key_Down:
            return ui::Key::down;
        case Qt::Key_Left:
            return ui::Key::left;
        case Qt::Key_Right:
            return ui::Key::right;
        case Qt::Key_Return:
        case Qt::Key_Enter:
        case Qt::Key_Select:
            return ui::Key::select;
        case Qt::Key_Back:
        case Qt::Key_Escape:
        case Qt::Key_Exit:
        case Qt::Key_Close:
        case Qt::Key_Cancel:
            return ui::Key::back;
        case Qt::Key_Backspace:
            return ui::Key::backspace;
        case Qt::Key_Delete:
            return ui::Key::deleteForward;
        case Qt::Key_Home:
            return ui::Key::home;
        case Qt::Key_End:
            return ui::Key::end;
        default:
            return byScanCode(scanCode);
    }
}

}  // namespace wp::tv
