#pragma once

namespace wp::tv {

/// Tells screen readers of the scene's rows, buttons and bars what the toolkit's own interface of an item keeps: whether
/// the select key works on it, from its property `isUsable`, and how far a bar is, from `percentage`. Everything
/// else comes from the item's attached `Accessible`. Items of this kind have no children. *Main*.
void installReading();

}  // namespace wp::tv
