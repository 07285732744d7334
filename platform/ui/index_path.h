#pragma once

#include <compare>

namespace wp::ui {

/// A place in a table: row by section, both from 0.
struct IndexPath {
    int row = 0;
    int section = 0;

    /// In the order in which a table shows its rows.
    friend constexpr auto operator<=>(IndexPath left, IndexPath right) {
        auto bySection = left.section <=> right.section;
        return bySection != 0 ? bySection : left.row <=> right.row;
    }
    friend constexpr bool operator==(IndexPath, IndexPath) = default;
};

}  // namespace wp::ui
