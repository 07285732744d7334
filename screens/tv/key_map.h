#pragma once

#include <QtCore/qnamespace.h>

#include <cstdint>
#include <optional>

#include "platform/ui/screen.h"

namespace wp::tv {

/// The remote control's key that the toolkit's key stands for; nothing for one that only types.
///
/// Remote controls reach the toolkit in several ways: as Enter and Escape, as the media keys Select, Back and
/// Exit, and where the keyboard map has no name for the kernel's `KEY_OK` (352), `KEY_SELECT` (353),
/// `KEY_BACK` (158) and `KEY_EXIT` (174), by their scan codes alone, which are eight higher. The blank is no
/// select key: it is text.
std::optional<ui::Key> keyOf(Qt::Key key, std::uint32_t scanCode);

}  // namespace wp::tv
