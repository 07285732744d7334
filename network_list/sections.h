#pragma once

/// The table's sections, by their numbers.
namespace wp::sections {

inline constexpr int kSelectedNetwork = 0;
inline constexpr int kChoosableNetworks = 1;
inline constexpr int kOtherNetwork = 2;
inline constexpr int kRefresh = 3;
inline constexpr int kCount = 4;

}  // namespace wp::sections
