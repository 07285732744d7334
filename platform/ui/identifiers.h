#pragma once

/// How a front end finds the views that it mirrors without knowing who built them: the builder names them,
/// `Screen::view` looks them up. Until the views are built each lookup is null.
namespace wp::ui::identifiers {

inline constexpr const char* title = "title";              ///< `Label`: the screen's title
inline constexpr const char* description = "description";  ///< `Label`: explanatory text
inline constexpr const char* status = "status";            ///< `Label`: one line under the progress bar
inline constexpr const char* progress = "progress";        ///< `ProgressView`
inline constexpr const char* image = "image";              ///< `ImageView`
inline constexpr const char* table = "table";              ///< `SettingsTableView`

}  // namespace wp::ui::identifiers
