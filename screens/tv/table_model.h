#pragma once

#include <QAbstractListModel>
#include <cstdint>
#include <optional>
#include <vector>

#include "screens/tv/flat_table.h"

namespace wp::tv {

/// Whether what changes moves to its new place or is there at once.
enum class Motion { none, full };

/// The lines near the visible part of the table, as the scene paints them: those of the list as it is now,
/// and those that are gone and still fade away. *Main*.
class TableModel final : public QAbstractListModel {
    Q_OBJECT
  public:
    enum Role {
        idRole = Qt::UserRole,
        textRole,
        detailRole,
        isBlockRole,
        isHeaderRole,
        isEnabledRole,
        isFirstRole,
        isLastRole,
        topRole,
        heightRole,
        isFocusedRole,
        isNewRole,      ///< to fade in
        isLeavingRole,  ///< to fade away, and to be given to `release` then
    };

    int rowCount(const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role) const override;
    QHash<int, QByteArray> roleNames() const override;

    /// What part of the table is to be seen, in points of its content.
    void setWindow(double top, double height);
    /// Takes over the lines after the changes that led to them.
    void play(const std::vector<Line>& lines, const LineChanges& changes, Motion motion);
    void setFocused(std::optional<ui::IndexPath> focused);

    /// A line has faded away.
    Q_INVOKABLE void release(int id);
    /// Whether lines that are gone are still there to fade.
    bool hasLeaving() const;

  private:
    struct Entry {
        int id = 0;
        Line line;
        bool isFocused = false;
        bool isNew = false;
        bool isLeaving = false;
    };

    bool isInWindow(const Line& line) const;
    bool isFocused(const Line& line) const;
    void stage(const std::vector<int>& newIds);
    void leave(int id, Motion motion);
    void removeEntry(std::size_t position);
    void update(std::size_t position, const Line& line);

    std::vector<Line> lines_;
    std::vector<int> ids_;  ///< of the lines, position by position
    std::vector<Entry> entries_;
    std::optional<ui::IndexPath> focused_;
    double windowTop_ = 0;
    double windowHeight_ = 0;
    int lastId_ = 0;
};

}  // namespace wp::tv
