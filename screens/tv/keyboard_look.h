#pragma once

#include <QVariantList>

#include "screens/tv/tv_module.h"
#include "screens/tv/typist.h"

namespace wp::tv {

/// The keyboard's keys as the scene paints them, a list of `KeyLook`. The done key can be pressed while `isDone`.
QVariantList keyboardLook(const Typist& typist, const Texts& texts, bool isDone);

}  // namespace wp::tv
